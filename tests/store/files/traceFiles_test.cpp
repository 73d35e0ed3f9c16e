#include "store/files/inspectFile.h"
#include "tests/store/files/traceFileFixture.h"
#include "tests/support/matchers.h"

#include <gmock/gmock.h>

namespace Project
{

namespace
{

using ::testing::AnyOf;
using ::testing::StartsWith;

TEST_F(traceFileTest, WritesWhatItReads)
{
    EXPECT_TRUE(Loading(Sample("v5_three.dbw"), ".dbw"));
    const std::string three = Sample("v5_three.dbw"), active("\0\0\0\0\2\0\0\0\x1F\0\0\0", 12); // the sample has 2, 0
    ASSERT_TRUE(SaveWorkspace(traces, directory, "saved.dbw"));
    EXPECT_EQ(Get("saved.dbw"), three.substr(0, three.size() - active.size()) + active);
    for (const char *file : {"v5_estimated.knl", "v5_manual.knl", "v5_readonly.knl", "v5_no_kernel.knl"})
    {
        EXPECT_TRUE(Loading(Sample(file), ".knl"));
        traces.Select(traces.Count() - 1);
        EXPECT_TRUE(SaveTrace(traces, directory, "saved.knl"));
        EXPECT_EQ(Get("saved.knl"), Sample(file)) << file;
    }
    // Older versions are saved as the newest, with the same content.
    for (const char *file : {"v1_three.dbw", "v2_three.dbw", "v3_three.dbw", "v4_three.dbw"})
    {
        EXPECT_TRUE(Loading(Sample(file), ".dbw")) << Error();
        const std::string saved = WorkspaceBytes(traces);
        EXPECT_EQ(saved[8], 5);
        EXPECT_TRUE(Loading(saved, ".dbw"));
        EXPECT_EQ(WorkspaceBytes(traces), saved);
    }
}

TEST_F(traceFileTest, RandomCollectionsRoundTrip)
{
    std::mt19937 random(7);
    for (int round = 0; round < 50; ++round)
    {
        traces.Clear();
        for (int i = static_cast<int>(random() % 5); i > 0; --i)
            traces.Insert(RandomTrace(random, static_cast<int>(random() % 8) * 2 + 3), -1);
        for (int i = traces.Count() - 1; i >= 0; --i)
            if (random() % 2)
                traces.Activate(i);
        traces.Select(static_cast<int>(random() % 6) - 1);
        traces.SetFoundDefaultSize(random());
        const std::string saved = WorkspaceBytes(traces);

        PKernelCollection other(picture, params, events, "");
        Put("saved.dbw", saved);
        ASSERT_TRUE(LoadWorkspace(other, directory + "/saved.dbw"));
        ASSERT_EQ(other.Count(), traces.Count());
        EXPECT_EQ(other.SelectedIndex(), traces.SelectedIndex());
        EXPECT_EQ(other.FoundDefaultSize(), traces.FoundDefaultSize());
        for (int i = 0; i < traces.Count(); ++i)
        {
            EXPECT_EQ(other.At(i)->KernelType(), traces.At(i)->KernelType());
            EXPECT_EQ(other.At(i)->Settings(), traces.At(i)->Settings());
            EXPECT_EQ(other.At(i)->PreviousSettings(), traces.At(i)->Settings());
            EXPECT_EQ(other.At(i)->CommittedRegion(), traces.At(i)->Region());
            EXPECT_EQ(other.IsActive(i), traces.IsActive(i));
        }
        EXPECT_EQ(WorkspaceBytes(other), saved);
    }
}

TEST_F(traceFileTest, ACutFileIsUnrecognized)
{
    for (const char *name : {"v1_three.dbw", "v4_three.dbw", "v5_three.dbw"})
    {
        const std::string whole = Sample(name);
        for (std::size_t length = 0; length < whole.size(); ++length)
        {
            ASSERT_TRUE(Loading(Sample("v5_trailing.dbw"), ".dbw"));
            ASSERT_FALSE(Loading(whole.substr(0, length), ".dbw"));
            ASSERT_EQ(Error(), kUnrecognized) << length;
            // With a bad header nothing has been lost.
            ASSERT_TRUE(length < 18 ? traces.Count() == 1 : traces.Count() <= 3) << length;
            ASSERT_EQ(std::exchange(events.workspaces, 0), length < 18 ? 1 : 2) << length; // the first load counts, too
        }
    }
    const int before = traces.Count();
    for (const char *name : {"v1_readonly.knl", "v2_readonly.knl", "v4_line_beats_readonly.knl", "v5_manual.knl"})
        for (std::size_t length = 0; length < Sample(name).size(); ++length)
        {
            ASSERT_FALSE(Loading(Sample(name).substr(0, length), ".knl"));
            ASSERT_EQ(Error(), kUnrecognized) << length;
            ASSERT_EQ(traces.Count(), before);
        }
}

TEST_F(traceFileTest, AFlippedBitLoadsOrIsToldOf)
{
    std::mt19937 random(11);
    for (int i = 0; i < 3; ++i)
        traces.Activate(traces.IndexOf(&traces.Insert(RandomTrace(random, 3), -1)));
    traces.Select(1);
    const std::string workspace = WorkspaceBytes(traces);
    for (std::size_t bit = 0; bit < workspace.size() * 8; ++bit)
    {
        std::string file = workspace;
        file[bit / 8] = static_cast<char>(file[bit / 8] ^ 1 << bit % 8);
        const bool loaded = Loading(file, ".dbw");
        ASSERT_EQ(loaded, Error().empty());
        if (bit < 64) // the signature
        {
            ASSERT_EQ(Error(), kUnrecognized);
        }
        else if (bit >= 80 && bit < 144)
        {
            ASSERT_THAT(Error(), StartsWith("Image size doesn't match.\nValue in the loaded file: "));
        }
        else
        {
            ASSERT_THAT(Error(), AnyOf("", kUnrecognized, kSomeLeftOut)) << bit;
        }
        for (int i = 0; i < traces.Count(); ++i)
            ASSERT_TRUE(RegionFits(traces, *traces.At(i)));
        const std::string saved = WorkspaceBytes(traces);
        ASSERT_TRUE(Loading(saved, ".dbw"));
        ASSERT_EQ(WorkspaceBytes(traces), saved);
    }
}

TEST_F(traceFileTest, ExtremeNumbers)
{
    const auto with = [](std::string file, std::size_t offset, std::uint32_t value) {
        for (int i = 0; i < 4; ++i)
            file[offset + static_cast<std::size_t>(i)] = static_cast<char>(value >> 8 * i);
        return file;
    };
    const std::string workspace = Sample("v5_trailing.dbw"), trace = Sample("v5_readonly.knl");
    constexpr std::size_t count = 18, selected = 22, sizeInTrace = 18 + 4 + 16 + 57, activeCount = 26 + 565;
    for (const std::uint32_t value :
         {3u, 0x7FFFu, 0x8000u, 0xFFFFu, 0x10000u, 0x40000000u, 0x7FFFFFFFu, 0x80000000u, 0xFFFFFFFEu, 0xFFFFFFFFu})
    {
        EXPECT_FALSE(Loading(with(workspace, count, value), ".dbw"));
        EXPECT_FALSE(Loading(with(workspace, activeCount, value + 8), ".dbw"));
        EXPECT_EQ(Error(), kUnrecognized);
        EXPECT_TRUE(Loading(with(workspace, selected, value), ".dbw"));
        EXPECT_EQ(traces.SelectedIndex(), -1);
        EXPECT_EQ(Loading(with(trace, sizeInTrace, value), ".knl"), value == 3) << value; // less than there is
    }
}

TEST_F(traceFileTest, HeadersAreCheckedBeforeAnythingIsLost)
{
    std::mt19937 random(3);
    traces.Insert(RandomTrace(random, 5), 0);
    Put("wrong.dbw", Sample("wrong_size.dbw"));
    for (const bool loads : {false, true})
    {
        EXPECT_FALSE(loads ? LoadWorkspace(traces, directory + "/wrong.dbw")
                           : CheckFileHeader(traces, directory + "/wrong.dbw"));
        EXPECT_EQ(Error(), "Image size doesn't match.\nValue in the loaded file: 300x400\n"
                           "Value of the current image: 400x300");
        EXPECT_FALSE(CheckFileHeader(traces, directory + "/missing.dbw"));
        EXPECT_EQ(Error(), kUnrecognized);
        EXPECT_EQ(traces.Count(), 1);
    }
    EXPECT_EQ(events.workspaces, 0);
    Put("good.dbw", Sample("v5_empty.dbw"));
    EXPECT_TRUE(CheckFileHeader(traces, directory + "/good.dbw"));
    EXPECT_EQ(Error(), "");
    EXPECT_EQ(traces.Count(), 1);

    // Bounds need not begin at 0: the size is compared, but regions are where they are.
    testPicture moved(CorvaneDeblur::floatArray::allocate(300, 400), 150, 0);
    PKernelCollection there(moved, params, events, "");
    Put("moved.dbw", Sample("v5_three.dbw"));
    EXPECT_FALSE(LoadWorkspace(there, directory + "/moved.dbw"));
    EXPECT_EQ(there.GetLastError(), kSomeLeftOut);
    EXPECT_EQ(there.Count(), 0);
    Put("picture.png", Sample("grey8.png"));
    EXPECT_TRUE(LoadPngTrace(there, directory + "/picture.png", -1));
    EXPECT_EQ(there.At(0)->Region(), (Sarnik::CRect{345, 145, 356, 156}));
}

TEST_F(traceFileTest, LoadedTracesGoWhereTheyBelong)
{
    EXPECT_TRUE(Loading(Sample("v5_three.dbw"), ".dbw"));
    EXPECT_EQ(events.workspaces, 1);
    Put("one.knl", Sample("v5_manual.knl"));
    Put("one.png", Sample("grey16.png"));
    EXPECT_TRUE(LoadTrace(traces, directory + "/one.knl", 0));
    EXPECT_TRUE(LoadPngTrace(traces, directory + "/one.png", 1));
    EXPECT_EQ(traces.At(0)->KernelType(), PKernelKind::Manual);
    EXPECT_EQ(traces.At(1)->KernelType(), PKernelKind::ReadOnly);
    EXPECT_EQ(traces.Count(), 5);

    events.takesTraces = true; // by undoable tasks
    EXPECT_TRUE(LoadTrace(traces, directory + "/one.knl", 3));
    EXPECT_EQ(events.offeredAt, 3);
    EXPECT_EQ(traces.Count(), 5);
}

TEST_F(traceFileTest, SavingReplacesTheFileOrSaysNo)
{
    EXPECT_FALSE(SaveTrace(traces, directory, "none.knl"));
    EXPECT_FALSE(SavePngTrace(traces, directory, "none.png"));
    EXPECT_TRUE(Loading(Sample("v5_estimated.knl"), ".knl"));
    EXPECT_TRUE(Loading(Sample("v5_no_kernel.knl"), ".knl"));
    traces.Select(1);
    EXPECT_FALSE(SavePngTrace(traces, directory, "none.png")); // it has no kernel
    traces.Select(0);
    events.multiPreview = true;
    EXPECT_FALSE(SaveTrace(traces, directory, "none.knl"));
    events.multiPreview = false;
    EXPECT_FALSE(Exists("none.knl") || Exists("none.png"));

    events.undoPosition = 9;
    EXPECT_TRUE(traces.HasChanged());
    EXPECT_FALSE(SaveWorkspace(traces, directory + "/none", "a.dbw"));
    EXPECT_TRUE(traces.HasChanged());
    EXPECT_TRUE(SaveTrace(traces, directory, "one.knl"));
    EXPECT_TRUE(traces.HasChanged());
    EXPECT_TRUE(SaveWorkspace(traces, directory, "a.dbw"));
    EXPECT_FALSE(traces.HasChanged());
    EXPECT_EQ(Error(), "");

    // A picture keeps the kernel within the rounding of 16 bits.
    EXPECT_TRUE(SavePngTrace(traces, directory, "one.png"));
    EXPECT_TRUE(LoadPngTrace(traces, directory + "/one.png", -1));
    const auto &saved = traces.At(0)->KernelImage(), &loaded = traces.At(2)->KernelImage();
    for (int y = 0; y < saved.rows; ++y)
        for (int x = 0; x < saved.cols; ++x)
            EXPECT_NEAR(loaded.at(y, x), saved.at(y, x), 2e-5f * 0.15f);
}

TEST_F(traceTest, AnAutomaticRunRecordsWhatItFound)
{
    testPicture large(Blurred(700, 900, 15, 3), 7, 9);
    PKernelCollection automatic(large, params, events, "");
    ASSERT_TRUE(automatic.AutoEstimate());
    ASSERT_TRUE(automatic.WaitForEstimations());
    Sarnik::CMemoryContainer record;
    WriteCollection(automatic, record);
    record.Seek(0);
    PKernelCollection reader(large, params, events, "");
    ReadCollection(reader, record);
    ASSERT_EQ(reader.Count(), 1);
    EXPECT_TRUE(reader.IsActive(0));
    EXPECT_EQ(reader.At(0)->Region(), automatic.LoneTrace()->Region());
    EXPECT_TRUE(TestSupport::arrayIdentical(reader.At(0)->KernelImage(), automatic.LoneTrace()->KernelImage()));
    EXPECT_EQ(record.Remaining(), 0u);
}

TEST_F(traceFileTest, InspectionInWords)
{
    Put("a.dbw", Sample("v5_active_beyond.dbw"));
    EXPECT_EQ(DescribeInspection(InspectFile(directory + "/a.dbw")),
              "a.dbw: workspace, version 5, for a picture of 400 x 300 pixels\n1 trace\nSelected: 1\n"
              "Active: 1, one that is not there\nTrace 1: estimated\n    region: 200 x 200 pixels at 10,20\n"
              "    kernel: 11 x 11, sum 1, trustworthy\n    settings: size 11, noise medium, smoothing 45 %, "
              "suppression 90 %, applied in any case, bright pixels left out\n");
    PPreferences preferences;
    preferences.parameters.lastFolder = "a\n\x1b[1m";
    SavePreferences(directory, preferences);
    const PInspection found = InspectFile(directory + "/Stillmark Prefs.tnp");
    EXPECT_TRUE(found.result);
    EXPECT_THAT(DescribeInspection(found), ::testing::HasSubstr("Last folder: \"a\\u000a\\u001b[1m\"\n"));
    EXPECT_THAT(InspectionJson(found), ::testing::HasSubstr("\"overflowColour\": 4294901760"));
    Put("b.tnp", Get("Stillmark Prefs.tnp").substr(0, 100));
    EXPECT_EQ(InspectFile(directory + "/b.tnp").error, kUnrecognized);
    Put("c.txt", "text");
    EXPECT_EQ(InspectFile(directory + "/c.txt").error, "Not a Workspace file or a Blur Trace file.");
    EXPECT_ANY_THROW(InspectFile(directory + "/d.knl"));
}

} // namespace

} // namespace Project
