#include "tests/cli/programRunner.h"

#include "tests/support/matchers.h"
#include "tests/support/synthetic.h"

#include "host/kernelFile.h"

#include <gmock/gmock.h>

#include <signal.h>

#include <cmath>
#include <cstdlib>
#include <iterator>
#include <limits>
#include <sstream>

using CorvaneDeblur::floatArray;
using namespace TestSupport;
using testing::EndsWith;
using testing::HasSubstr;
using testing::MatchesRegex;
using testing::Not;
using testing::StartsWith;

namespace
{

const std::string oldOutput = "the old output";

/// A folder with an old output that a failing run must leave alone.
class Program : public testing::Test
{
protected:
    void SetUp() override { writeBytes(folder.file("out.png"), oldOutput); }

    /// Runs the program with the words of a line.
    programRun run(const std::string &line, const runRules &rules = {}) const
    {
        std::istringstream words(line);
        return runProgram(folder.path(), {std::istream_iterator<std::string>(words), {}}, rules);
    }

    /// One line that names the file, status 1, nothing else changed in the folder.
    void expectFailure(const std::string &line, const std::string &named, const runRules &rules = {})
    {
        const auto before = folder.names();
        const programRun result = run(line, rules);
        EXPECT_EQ(result.status, 1);
        EXPECT_THAT(result.err, HasSubstr(named));
        EXPECT_EQ(std::count(result.err.begin(), result.err.end(), '\n'), 1) << result.err;
        EXPECT_THAT(result.err, EndsWith("\n"));
        EXPECT_EQ(result.out, "");
        EXPECT_EQ(bytesOf(folder.file("out.png")), oldOutput);
        EXPECT_EQ(folder.names(), before);
    }

    temporaryFolder folder;
};

floatArray filled(int rows, int cols, float value)
{
    return noiseImage(rows, cols, 1, value, value);
}

/// Mean squared difference away from the edges, at the best whole-pixel shift.
double distanceBetween(const floatArray &a, const floatArray &b)
{
    constexpr int reach = 6, edge = 40;
    double best = std::numeric_limits<double>::infinity();
    for (int dy = -reach; dy <= reach; ++dy)
        for (int dx = -reach; dx <= reach; ++dx)
        {
            double sum = 0;
            for (int y = edge; y < a.rows - edge; ++y)
                for (int x = edge; x < a.cols - edge; ++x)
                    sum += std::pow(a.at(y, x) - b.at(y + dy, x + dx), 2);
            best = std::min(best, sum);
        }
    return best / ((a.rows - 2 * edge) * (a.cols - 2 * edge));
}

TEST_F(Program, AnswersHelpAndWrongUsage)
{
    const programRun help = run("--help");
    EXPECT_EQ(help.status, 0);
    EXPECT_THAT(help.out, HasSubstr("Usage: stillmark PHOTO"));
    EXPECT_THAT(help.out, HasSubstr("--workspace"));

    const programRun even = run("in.png -o out.png --size 44");
    EXPECT_EQ(even.status, 2);
    EXPECT_THAT(even.err, HasSubstr("44"));
    EXPECT_EQ(even.out, "");
    EXPECT_EQ(bytesOf(folder.file("out.png")), oldOutput);

    // Wrong only for the kernel's size.
    writeGrey(folder.file("in.png"), edgeScene(200, 200, 1));
    const programRun none = run("estimate in.png -o k.pfm --size 31 --skip-levels 30");
    EXPECT_EQ(none.status, 2) << none.err;
    EXPECT_THAT(none.err, HasSubstr("--skip-levels"));
}

TEST_F(Program, RefusesFilesThatAreNoPictures)
{
    expectFailure("missing.png -o out.png", "missing.png");
    writeBytes(folder.file("empty.png"), "");
    expectFailure("empty.png -o out.png", "empty.png");
    writeBytes(folder.file("words.png"), "these are no pixels");
    expectFailure("words.png -o out.png", "words.png");
    writeGrey(folder.file("whole.png"), edgeScene(200, 200, 1));
    const std::string whole = bytesOf(folder.file("whole.png"));
    writeBytes(folder.file("cut.png"), whole.substr(0, whole.size() / 2));
    expectFailure("cut.png -o out.png", "cut.png");
    expectFailure("measure .", ".");
    expectFailure("deconvolve whole.png --kernel words.png -o out.png", "words.png");
}

TEST_F(Program, RefusesWhatDoesNotFitThePicture)
{
    writeGrey(folder.file("dot.png"), filled(1, 1, 0.5f));
    expectFailure("dot.png -o out.png", "dot.png");
    expectFailure("estimate dot.png -o k.pfm", "dot.png");
    writeGrey(folder.file("stamp.png"), edgeScene(49, 49, 1));
    expectFailure("stamp.png -o out.png", "stamp.png");
    expectFailure("estimate stamp.png -o k.pfm --size 31 --noise low", "stamp.png");
    writeGrey(folder.file("card.png"), edgeScene(120, 160, 1));
    expectFailure("card.png -o out.png --region 100,0,100,100", "100,0,100,100");
    expectFailure("card.png -o out.png --region 2147483647,0,2147483647,9", "card.png");
    expectFailure("card.png -o out.png --size 99", "card.png");
    expectFailure("suggest card.png --near 160,0", "160,0");

    ASSERT_EQ(run("line --length 130 --angle 90 -o long.pfm").status, 0);
    expectFailure("deconvolve card.png --kernel long.pfm -o out.png", "long.pfm");
    writeGrey(folder.file("even.pfm"), filled(6, 6, 1.0f));
    expectFailure("deconvolve card.png --kernel even.pfm -o out.png", "even.pfm");
}

TEST_F(Program, LeavesNothingBehindWhereItCannotWrite)
{
    writeGrey(folder.file("in.png"), edgeScene(200, 200, 1));
    ASSERT_EQ(run("line --length 9 --angle 20 -o line.pfm").status, 0);
    expectFailure("in.png -o no/such/folder.png", "no/such/folder.png");
    expectFailure("in.png -o out.xyz", "out.xyz");
    std::filesystem::create_directory(folder.file("taken.png"));
    expectFailure("in.png -o taken.png", "taken.png");
    expectFailure("estimate in.png -o k.jpg", "k.jpg");
    expectFailure("deconvolve in.png --kernel line.pfm -o out.png", "out.png", {.largestFile = 2000});
}

TEST_F(Program, CopiesAPictureThatHasNothingToSee)
{
    writeGrey(folder.file("flat.png"), filled(200, 300, 0.5f));
    const programRun flat = run("flat.png -o out.png --json");
    EXPECT_EQ(flat.status, 0) << flat.err;
    EXPECT_THAT(flat.err, HasSubstr("no structure found"));
    EXPECT_THAT(flat.out, MatchesRegex("\\{\"traces\": \\[\\], .*\"notes\": \\[\".*\"\\]\\}\n"));
    EXPECT_TRUE(bytesOf(folder.file("out.png")) == bytesOf(folder.file("flat.png")));

    // With a region there is a trace to tell of, and still nothing to remove.
    const programRun there = run("flat.png -o out.png --region 0,0,200,200 --json --force");
    EXPECT_EQ(there.status, 0) << there.err;
    EXPECT_THAT(there.out, HasSubstr("\"good\": false, \"applied\": false, \"status\": 2"));
    EXPECT_TRUE(bytesOf(folder.file("out.png")) == bytesOf(folder.file("flat.png")));

    writeGrey(folder.file("nan.pfm"), filled(200, 200, std::numeric_limits<float>::quiet_NaN()));
    const programRun estimate = run("estimate nan.pfm -o k.pfm");
    EXPECT_EQ(estimate.status, 1);
    EXPECT_THAT(estimate.err, HasSubstr("nan.pfm"));
    EXPECT_FALSE(std::filesystem::exists(folder.file("k.pfm")));
}

TEST_F(Program, FindsAndRemovesABlur)
{
    const floatArray scene = edgeScene(360, 400, 5), kernel = shakeKernel(15, 15, 6);
    const floatArray shaken = blurred(scene, kernel, 0.002f, 7);
    writeGrey(folder.file("in.png"), shaken);
    const std::string job =
        "in.png -o out.png --size 19 --noise low --region 0,0,400,360 --json --kernel-picture k.png";
    const programRun one = run(job + " --threads 1");
    ASSERT_EQ(one.status, 0) << one.err;
    EXPECT_EQ(one.err, "");
    EXPECT_THAT(one.out, StartsWith("{\"traces\": [{\"region\": [0, 0, 400, 360], \"size\": 19, \"good\": true"));
    EXPECT_THAT(one.out, HasSubstr("\"output\": \"out.png\""));
    EXPECT_LT(distanceBetween(scene, readGrey(folder.file("out.png"))), 0.5 * distanceBetween(scene, shaken));

    const std::string bytes = bytesOf(folder.file("out.png"));
    ASSERT_EQ(run(job + " --threads 3").status, 0);
    EXPECT_EQ(bytesOf(folder.file("out.png")), bytes) << "the result depends on the threads";
    EXPECT_EQ(folder.names(), (std::vector<std::string>{"in.png", "k.png", "out.png"}));

    // The same in two steps, by the exact kernel file.
    const programRun estimate = run("estimate in.png -o k.pfm --size 19 --noise low --json");
    ASSERT_EQ(estimate.status, 0) << estimate.err;
    EXPECT_THAT(estimate.out, MatchesRegex("\\{\"status\": 0, \"size\": 19, \"sparsity\": [0-9.e+-]+, \"good\": true, "
                                           "\"region\": \\[0, 0, 400, 360\\], \"levels\": [1-9][0-9]*, "
                                           "\"seconds\": [0-9.e+-]+\\}\n"));
    const Stillmark::kernelSamples found = Stillmark::readKernel(folder.file("k.pfm"));
    floatArray foundArray = floatArray::allocate(found.rows, found.cols);
    std::copy(found.samples.begin(), found.samples.end(), foundArray.data);
    EXPECT_GT(kernelCorrelation(foundArray, kernel, 4), 0.8);
    const programRun remove = run("deconvolve in.png --kernel k.pfm -o two.png");
    ASSERT_EQ(remove.status, 0) << remove.err;
    EXPECT_EQ(remove.err, "");
    // A host gives the plug-in 15 of 16 bits.
    EXPECT_LT(distanceBetween(readGrey(folder.file("two.png")), readGrey(folder.file("out.png"))), 2e-4);
}

TEST_F(Program, MeasuresAndSuggests)
{
    const floatArray shaken = blurred(edgeScene(500, 600, 5), shakeKernel(15, 15, 6), 0.008f, 7);
    writeGrey(folder.file("in.png"), shaken);
    const programRun measured = run("measure in.png --json");
    EXPECT_EQ(measured.status, 0) << measured.err;
    EXPECT_THAT(measured.out, MatchesRegex("\\{\"noise\": 0\\.00[5-9][0-9]*, \"blurSize\": [0-9]+, "
                                           "\"patch\": \\[[0-9]+, [0-9]+, [0-9]+, [0-9]+\\]\\}\n"));
    const programRun suggested = run("suggest in.png --count 2 --json");
    EXPECT_EQ(suggested.status, 0) << suggested.err;
    EXPECT_THAT(suggested.out, MatchesRegex("\\{\"regions\": \\[(\\[[0-9]+, [0-9]+, [0-9]+, [0-9]+\\](, )?)+\\]\\}\n"));
}

TEST_F(Program, RecordsAndRepeatsARun)
{
    const floatArray kernel = shakeKernel(15, 15, 6);
    writeGrey(folder.file("in.png"), blurred(edgeScene(360, 400, 5), kernel, 0.002f, 7));
    writeGrey(folder.file("other.png"), blurred(edgeScene(300, 340, 8), kernel, 0.002f, 9));
    const auto done = [&](const std::string &line) {
        const programRun result = run(line);
        EXPECT_EQ(result.status, 0) << line << ": " << result.err;
        return result.out + result.err;
    };
    done("in.png -o out.png --size 19 --region 20,20,300,300 --record r --save-workspace w.dbw");
    const std::string bytes = bytesOf(folder.file("out.png"));
    for (const char *again : {"--replay r", "--workspace w.dbw"})
    {
        done(std::string("in.png -o again.png ") + again);
        EXPECT_TRUE(bytesOf(folder.file("again.png")) == bytes) << again;
    }

    // On another size the user is asked, and a run that found everything by itself does so again.
    const programRun asked = run("other.png -o again.png --replay r");
    EXPECT_EQ(asked.status, 1);
    EXPECT_THAT(asked.err, HasSubstr("different from the current image"));
    done("other.png -o again.png --replay r --yes");
    EXPECT_THAT(run("other.png -o again.png --workspace w.dbw").err,
                HasSubstr("Value in the loaded file: 400x360 Value of the current image: 340x300"));
    done("in.png -o out.png --record automatic");
    done("other.png -o again.png --replay automatic");

    EXPECT_THAT(done("inspect r"), HasSubstr("trace in 20,20,300,300, size 19, good"));
    EXPECT_THAT(done("inspect w.dbw --json"), HasSubstr("\"region\": [20, 20, 320, 320]"));
    EXPECT_THAT(run("inspect w.dbw --image-size 40x30").err + run("inspect w.dbw --image-size 40x30").out,
                HasSubstr("Image size doesn't match."));

    // A trace file is a kernel like any other.
    done("estimate in.png -o k.knl --size 19");
    done("estimate in.png -o k.pfm --size 19");
    done("deconvolve in.png --kernel k.knl -o a.png");
    done("deconvolve in.png --kernel k.pfm -o b.png");
    EXPECT_LT(distanceBetween(readGrey(folder.file("a.png")), readGrey(folder.file("b.png"))), 1e-9);
}

TEST_F(Program, DoesManyPhotosAndNoneTwice)
{
    for (int i = 0; i < 3; ++i)
        writeGrey(folder.file("p" + std::to_string(i) + ".png"),
                  blurred(edgeScene(200, 220, 5 + static_cast<unsigned>(i)), shakeKernel(11, 11, 6), 0.002f, 7));
    writeBytes(folder.file("p3.png"), "no picture");
    for (const char *name : {"all", "shards", "other"})
        std::filesystem::create_directory(folder.path() / name);
    const programRun all = run("p0.png p1.png p3.png p2.png --out-dir all");
    EXPECT_EQ(all.status, 1);
    EXPECT_THAT(all.out, HasSubstr("3 of 4 photos done"));
    EXPECT_THAT(all.err, HasSubstr("failed: p3.png"));

    // Two tasks of a job array do each photo once between them.
    const std::string script = STILLMARK_SAMPLES "/jobArray.sh";
    for (const char *task : {"1", "2"})
    {
        ::setenv("TASK", task, 1);
        const std::string command = "cd '" + folder.path().string() +
                                    "' && mkdir -p in && cp p[012].png in && TASKS=2 " +
                                    "STILLMARK='" STILLMARK_BINARY "' sh '" + script + "' in shards";
        EXPECT_EQ(std::system(command.c_str()), 0);
    }
    for (int i = 0; i < 3; ++i)
    {
        const std::string name = "/p" + std::to_string(i) + ".png";
        EXPECT_TRUE(bytesOf(folder.file("all" + name)) == bytesOf(folder.file("shards" + name))) << name;
    }
    expectFailure("p0.png ./p0.png --out-dir other", "p0.png");
    expectFailure("p0.png --out-dir .", "replace");
}

TEST_F(Program, KilledLeavesNoPageFile)
{
    writeGrey(folder.file("in.pfm"), edgeScene(1000, 1200, 5));
    run("--version"); // what the tests themselves need of temporary folders is made by the first run
    std::filesystem::create_directory(folder.path() / "scratch");
    ::setenv("TMPDIR", folder.file("scratch").c_str(), 1);
    const programRun killed = run("in.pfm -o out.png --size 99 --region 0,0,1000,1000",
                                  {.signalAfter = std::chrono::milliseconds(500), .signals = {SIGKILL}});
    ::unsetenv("TMPDIR");
    EXPECT_EQ(killed.status, -1);
    EXPECT_TRUE(std::filesystem::is_empty(folder.path() / "scratch"));
    EXPECT_EQ(bytesOf(folder.file("out.png")), oldOutput);
}

/// Long jobs, each in another part of the program.
class Stopped : public Program, public testing::WithParamInterface<const char *>
{
};

TEST_P(Stopped, EndsWithinASecondAndChangesNothing)
{
    const floatArray tile = edgeScene(160, 160, 5), large = floatArray::allocate(1600, 1600);
    for (int y = 0; y < large.rows; ++y)
        for (int x = 0; x < large.cols; ++x)
            large.at(y, x) = tile.at(y % 160, x % 160);
    writeGrey(folder.file("in.pfm"), large);
    ASSERT_EQ(run("line --length 61 --angle 20 -o line.pfm").status, 0);
    const auto before = folder.names();
    for (const std::vector<int> &signals : {std::vector<int>{SIGINT}, {SIGTERM, SIGINT}})
    {
        const programRun result = run(GetParam(), {.signalAfter = std::chrono::milliseconds(700), .signals = signals});
        EXPECT_EQ(result.status, 1);
        EXPECT_EQ(result.err, "Cancelled.\n");
        EXPECT_EQ(result.out, "");
        EXPECT_LT(result.seconds, 1.0);
        EXPECT_EQ(bytesOf(folder.file("out.png")), oldOutput);
        EXPECT_EQ(folder.names(), before);
    }
}

INSTANTIATE_TEST_SUITE_P(While, Stopped,
                         testing::Values("deconvolve in.pfm --kernel line.pfm --tile 16 -o out.png --json",
                                         "in.pfm -o out.png --size 199 --noise low --region 0,0,1600,1600"));

} // namespace
