#include "cli/commandLine.h"
#include "cli/traceRegion.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <iterator>
#include <sstream>
#include <string>
#include <variant>

using namespace Stillmark;
using CorvaneDeblur::deconvolutionMethod;
using CorvaneDeblur::noiseMode;
using testing::HasSubstr;

namespace
{

/// Keeps what it was asked for.
class recordingDelegate : public commandDelegate
{
public:
    std::variant<std::monostate, removeOptions, batchOptions, estimateOptions, deconvolveOptions, suggestOptions,
                 measureOptions, lineOptions, inspectOptions>
        asked;

    int remove(const removeOptions &o) override { return keep(o); }
    int removeAll(const batchOptions &o) override { return keep(o); }
    int estimate(const estimateOptions &o) override { return keep(o); }
    int deconvolve(const deconvolveOptions &o) override { return keep(o); }
    int suggest(const suggestOptions &o) override { return keep(o); }
    int measure(const measureOptions &o) override { return keep(o); }
    int line(const lineOptions &o) override { return keep(o); }
    int inspect(const inspectOptions &o) override { return keep(o); }

private:
    template <typename Options> int keep(const Options &o)
    {
        asked = o;
        return exitDone;
    }
};

struct parsed
{
    int status;
    std::string out, err;
    recordingDelegate delegate;
};

/// Runs the words of a line.
parsed parse(const std::string &line)
{
    std::istringstream in("stillmark " + line);
    const std::vector<std::string> words{std::istream_iterator<std::string>(in), {}};
    std::vector<const char *> pointers;
    for (const std::string &word : words)
        pointers.push_back(word.c_str());
    parsed result{};
    std::ostringstream out, err;
    result.status = runCommandLine(static_cast<int>(pointers.size()), pointers.data(), result.delegate, out, err);
    result.out = out.str();
    result.err = err.str();
    return result;
}

template <typename Options> Options optionsOf(const std::string &line)
{
    const parsed result = parse(line);
    EXPECT_EQ(result.status, exitDone) << result.err;
    return std::get<Options>(result.delegate.asked);
}

TEST(CommandLine, MainJobTakesItsDefaults)
{
    const auto o = optionsOf<removeOptions>("photo.jpg -o sharp.jpg");
    EXPECT_EQ(o.photo, "photo.jpg");
    EXPECT_EQ(o.output, "sharp.jpg");
    EXPECT_FALSE(o.size);
    EXPECT_EQ(o.noise, noiseMode::automatic);
    EXPECT_TRUE(o.regions.empty());
    EXPECT_EQ(o.traces, 1);
    EXPECT_FLOAT_EQ(o.strength.smoothing, 0.3f);
    EXPECT_FLOAT_EQ(o.strength.suppression, 0.3f);
    EXPECT_TRUE(o.artifactSuppression);
    EXPECT_FALSE(o.force || o.common.json || o.common.quiet);
    EXPECT_EQ(o.common.threads, 0);
}

// The photo stands after a repeatable option, whose second value it must not become.
TEST(CommandLine, MainJobTakesEveryOption)
{
    const auto o = optionsOf<removeOptions>(
        "--output o.tif --size 45 --noise high --region 1,2,300,400 --region=5,6,700,800 photo.jpg --traces 3 "
        "--smoothing 0 --suppression 87.5 --no-artifact-suppression --kernel-picture k.png --threads 2 --quiet --json "
        "--force");
    EXPECT_EQ(o.photo, "photo.jpg");
    EXPECT_EQ(o.size, 45);
    EXPECT_EQ(o.noise, noiseMode::high);
    ASSERT_EQ(o.regions.size(), 2u);
    EXPECT_EQ(regionText(o.regions[0]), "1,2,300,400");
    EXPECT_EQ(regionText(o.regions[1]), "5,6,700,800");
    EXPECT_EQ(o.traces, 3);
    EXPECT_FLOAT_EQ(o.strength.smoothing, 0.0f);
    EXPECT_FLOAT_EQ(o.strength.suppression, 0.875f);
    EXPECT_FALSE(o.artifactSuppression);
    EXPECT_EQ(o.kernelPicture, "k.png");
    EXPECT_TRUE(o.force && o.common.json && o.common.quiet);
    EXPECT_EQ(o.common.threads, 2);
}

TEST(CommandLine, FirstWordChoosesTheCommand)
{
    EXPECT_EQ(optionsOf<removeOptions>("estimate.jpg -o a.png").photo, "estimate.jpg");
    EXPECT_EQ(optionsOf<removeOptions>("./estimate -o a.png").photo, "./estimate");
    EXPECT_EQ(optionsOf<measureOptions>("measure measure").photo, "measure");

    const auto e = optionsOf<estimateOptions>("estimate p.png -o k.pfm --mask-threshold 250 --seed-levels 2 "
                                              "--skip-levels 1 --second-order --noise low");
    EXPECT_EQ(e.maskThreshold, 250);
    EXPECT_EQ(e.seedLevels, 2);
    EXPECT_EQ(e.skipLevels, 1);
    EXPECT_TRUE(e.secondOrder);
    EXPECT_EQ(e.noise, noiseMode::low);

    const auto d = optionsOf<deconvolveOptions>("deconvolve p.png --kernel a.pfm --kernel b.pfm -o o.png "
                                                "--region-of-kernel 0,0,9,9 --region-of-kernel 9,0,9,9 "
                                                "--method wiener --tile 64");
    EXPECT_EQ(d.kernels, (std::vector<std::string>{"a.pfm", "b.pfm"}));
    EXPECT_EQ(d.kernelRegions.size(), 2u);
    EXPECT_EQ(d.method, deconvolutionMethod::wiener);
    EXPECT_EQ(d.tile, 64);

    EXPECT_EQ(optionsOf<suggestOptions>("suggest p.png --near 12,34").near, std::make_pair(12, 34));

    const auto l = optionsOf<lineOptions>("line --length 12.5 --angle -30 -o k.pfm");
    EXPECT_EQ(l.length, 12.5);
    EXPECT_EQ(l.angle, -30);
}

TEST(CommandLine, ManyPhotosShareTheOptions)
{
    const auto o = optionsOf<batchOptions>("a.jpg b.jpg --out-dir out --shard 2/3 --smoothing 50 c.jpg");
    EXPECT_EQ(o.photos, (std::vector<std::string>{"a.jpg", "b.jpg", "c.jpg"}));
    EXPECT_EQ(o.folder, "out");
    EXPECT_EQ(std::make_pair(o.shard, o.shards), std::make_pair(2, 3));
    EXPECT_FLOAT_EQ(o.job.strength.smoothing, 0.5f);
    EXPECT_EQ(optionsOf<inspectOptions>("inspect a.dbw --image-size 30x20").imageSize, std::make_pair(30, 20));
}

TEST(CommandLine, WrongUsageIsToldInOneLineAndAnswersTwo)
{
    const std::string whole = "p.jpg -o o.jpg ";
    const std::pair<std::string, const char *> cases[] = {
        {"", "PHOTO"},
        {"p.jpg", "--output"},
        {"p.jpg q.jpg -o o.jpg", "--out-dir"},
        {whole + "--out-dir d", "--out-dir"},
        {whole + "--shard 1/2", "--shard"},
        {"p.jpg --out-dir d --shard 3/2", "3"},
        {"p.jpg --out-dir d --record r", "--record"},
        {whole + "--replay r --size 9", "--replay"},
        {whole + "--replay r --workspace w.dbw", "--workspace"},
        {"inspect a.dbw --image-size 30", "30"},
        {"p.jpg -o", "--output"},
        {whole + "--sizes 9", "--sizes"},
        {whole + "--size 44", "44"},
        {whole + "--size 201", "201"},
        {whole + "--size -5", "--size"},
        {whole + "--size 45x", "45x"},
        {whole + "--size 99999999999", "--size"},
        {whole + "--noise loud", "loud"},
        {whole + "--smoothing 101", "--smoothing"},
        {whole + "--suppression nan", "nan"},
        {whole + "--region 1,2,3", "1,2,3"},
        {whole + "--region 1,2,3,4,5", "--region"},
        {whole + "--region 1,2,3,", "--region"},
        {whole + "--region 1,2,0,4", "--region"},
        {whole + "--region -1,2,3,4", "--region"},
        {whole + "--threads 0", "--threads"},
        {whole + "--kernel-picture k.jpg", "k.jpg"},
        {whole + "--json=false", "json"},
        {"estimate p.jpg -o k.pfm --mask-threshold 256", "256"},
        {"deconvolve p.jpg -o o.jpg", "--kernel"},
        {"deconvolve p.jpg -o o.jpg --kernel a --kernel b", "--region-of-kernel"},
        {"suggest p.jpg --near 1,2 --count 1", "--near"},
        {"line --length inf --angle 0 -o k.pfm", "inf"},
    };
    for (const auto &[arguments, hint] : cases)
    {
        const parsed result = parse(arguments);
        EXPECT_EQ(result.status, exitUsage) << result.err;
        EXPECT_THAT(result.err, HasSubstr(hint));
        EXPECT_EQ(std::count(result.err.begin(), result.err.end(), '\n'), 1) << result.err;
        EXPECT_EQ(result.out, "");
        EXPECT_EQ(result.delegate.asked.index(), 0u) << "carried out all the same: " << result.err;
    }
}

TEST(CommandLine, HelpAndVersionAnswerZero)
{
    for (const auto &[line, text] :
         {std::pair("--help", "Usage: stillmark PHOTO -o OUT"), std::pair("deconvolve -h", "--region-of-kernel"),
          std::pair("--version", "stillmark ")})
    {
        const parsed result = parse(line);
        EXPECT_EQ(result.status, exitDone);
        EXPECT_THAT(result.out, HasSubstr(text));
    }
}

} // namespace
