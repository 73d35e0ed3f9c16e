#include "cli/runRecord.h"
#include "host/document/hostDocument.h"
#include "host/plugin/pluginHost.h"
#include "host/plugin/pluginLibrary.h"
#include "tests/host/hostFixture.h"
#include "tests/module/memorySource.h"

#include <filesystem>
#include <gmock/gmock.h>

namespace Stillmark
{
namespace
{

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::SizeIs;

/// Whole runs of the real plug-in over pictures in memory, through the C interface alone.
class PluginRun : public hostTest
{
protected:
    PluginRun()
    {
        ::setenv("XDG_CONFIG_HOME", file("config").c_str(), 1);
        options.alert = [](const hostAlert &) {};
        options.action = &automatic;
        options.scratchFolders = {file("pages")};
        std::filesystem::create_directory(file("pages"));
    }

    hostOutcome run(hostDocument &document, const char *faults = "")
    {
        faultScript script = faultScript::parse(faults);
        hostOutcome outcome = runPlugin(plugin.entry(), document, options, &script);
        EXPECT_EQ(outcome.leaks.text(), "");
        EXPECT_THAT(outcome.misuse, IsEmpty());
        EXPECT_TRUE(std::filesystem::is_empty(file("pages")));
        return outcome;
    }

    static const pluginLibrary plugin; // its threads may outlive a test
    const recordedAction automatic = automaticAction(true);
    hostOptions options;
};

const pluginLibrary PluginRun::plugin{STILLMARK_PLUGIN};

struct shownCase
{
    const char *name;
    colourMode mode;
    int depth, extraPlanes;
    bool selected;
    TNPoint32 layerAt, origin;
};

void PrintTo(const shownCase &c, std::ostream *out)
{
    *out << c.name;
}

class EveryMode : public PluginRun, public ::testing::WithParamInterface<shownCase>
{
};

TEST_P(EveryMode, ChangesWhatIsSelectedAndNothingElse)
{
    const shownCase &c = GetParam();
    memorySource source(c.mode, c.depth, c.extraPlanes);
    memoryResult result(source);
    // A slanting selection with a soft edge: 0 to the left, 255 to the right.
    const int width = source.width(), height = source.height();
    std::vector<std::uint8_t> values;
    for (int y = 0; y < height; ++y)
        for (int x = 0; x < width; ++x)
            values.push_back(static_cast<std::uint8_t>(std::clamp((x - 40 - y / 10) * 20, 0, 255)));
    const selectionMask mask(width, height, values);
    documentSettings shown;
    shown.layerAt = c.layerAt;
    shown.origin = c.origin;
    shown.canvas = TNPoint32{width + 40, height + 30};
    shown.selection = c.selected ? &mask : nullptr;
    hostDocument document(source, &result, shown);

    const hostOutcome outcome = run(document);
    EXPECT_TRUE(outcome.done()) << outcome.hostSentence();
    EXPECT_THAT(outcome.alerts, IsEmpty());
    ASSERT_TRUE(outcome.recorded);
    EXPECT_THAT(tracesOf(*outcome.recorded), SizeIs(1));

    for (int plane = 0; plane < source.planes(); ++plane)
    {
        int changedInside = 0, changedOutside = 0;
        for (int y = 0; y < height; ++y)
            for (int x = 0; x < width; ++x)
                if (!result.sameAsSource(plane, x, y))
                    (!c.selected || values[static_cast<std::size_t>(y) * width + x] != 0 ? changedInside
                                                                                         : changedOutside)++;
        EXPECT_EQ(changedOutside, 0) << "plane " << plane;
        if (plane >= source.colourPlanes())
        {
            EXPECT_EQ(changedInside, 0) << "plane " << plane;
        }
        else
        {
            EXPECT_GT(changedInside, width * height / 4) << "plane " << plane;
        }
    }
}

INSTANTIATE_TEST_SUITE_P(
    All, EveryMode,
    ::testing::Values(shownCase{"grey8", colourMode::grey, 8, 0, false, {0, 0}, {0, 0}},
                      shownCase{"grey16Transparent", colourMode::grey, 16, 1, true, {12, 9}, {0, 0}},
                      shownCase{"grey32", colourMode::grey, 32, 0, true, {0, 0}, {-7, 1000}},
                      shownCase{"rgb8TransparentAndMask", colourMode::rgb, 8, 2, true, {12, 9}, {-7, 1000}},
                      shownCase{"rgb16", colourMode::rgb, 16, 0, true, {0, 0}, {0, 0}},
                      shownCase{"rgb32Transparent", colourMode::rgb, 32, 1, false, {12, 9}, {3, 3}},
                      shownCase{"lab8", colourMode::lab, 8, 1, true, {0, 0}, {0, 0}},
                      shownCase{"lab16", colourMode::lab, 16, 0, false, {12, 9}, {0, 0}},
                      shownCase{"cmyk8", colourMode::cmyk, 8, 1, false, {12, 9}, {0, 0}},
                      shownCase{"cmyk16", colourMode::cmyk, 16, 0, true, {0, 0}, {-7, 1000}}),
    [](const auto &of) { return std::string(of.param.name); });

TEST_F(PluginRun, WorksWithAsLittleAsAHostMayHave)
{
    memorySource source(colourMode::rgb, 8, 0);
    memoryResult rich(source), poor(source);
    hostDocument richDocument(source, &rich);
    ASSERT_TRUE(run(richDocument).done());

    options.suites = options.scripting = options.bounds32 = options.alerts = false;
    options.maxSpace = 1;
    hostDocument poorDocument(source, &poor);
    const hostOutcome outcome = run(poorDocument);
    EXPECT_TRUE(outcome.done());
    EXPECT_FALSE(outcome.recorded);
    EXPECT_EQ(poor.codes(), rich.codes()) << "the host's poverty shows in the picture";
}

TEST_F(PluginRun, RefusesOldHostsAndSmallPicturesInItsOwnWords)
{
    memorySource source(colourMode::grey, 8, 0), small(colourMode::grey, 8, 0, 200, 49),
        least(colourMode::grey, 8, 0, 50, 50);
    memoryResult result(source), smallResult(small), leastResult(least);
    hostDocument document(source, &result), smallDocument(small, &smallResult), leastDocument(least, &leastResult);

    const auto told = [&](hostDocument &what) {
        const hostOutcome outcome = run(what);
        EXPECT_EQ(outcome.result, TNUserHasBeenTold);
        EXPECT_EQ(outcome.failedAt, TNSelectorStart);
        EXPECT_FALSE(outcome.wrote);
        return outcome.alerts.size() == 1 ? outcome.alerts[0].title + ": " + outcome.alerts[0].first : "";
    };
    EXPECT_EQ(told(smallDocument), "Stillmark: Images/selections with dimension smaller than 50 pixels are not "
                                   "supported by Stillmark.");
    EXPECT_TRUE(run(leastDocument).done());
    for (const std::optional<std::int32_t> version :
         {std::optional<std::int32_t>(13 << 16), std::optional<std::int32_t>()})
    {
        options.version = version;
        EXPECT_EQ(told(document), "Stillmark: The plug-in is not supported by this version of Tintorel.");
    }

    // A developer's file switches the test off.
    const std::string settings = file("config/Corvane/Corvane Tintorel 14/Corvane Tintorel 14 Settings");
    writeBytes(settings + "/Corvane Stillmark Behavioral Parameters", "");
    EXPECT_TRUE(run(document).done());
}

TEST_F(PluginRun, PlaysWhatIsRecorded)
{
    memorySource source(colourMode::rgb, 16, 0), other(colourMode::rgb, 16, 0, 260, 201);
    memoryResult first(source), again(source), elsewhere(other);
    recordedAction chosen = actionWith({{{20, 10, 170, 170}, 19, CorvaneDeblur::noiseMode::low, {}, false, {}}},
                                       source.width(), source.height(), true);
    options.action = &chosen;
    hostDocument document(source, &first);
    const hostOutcome outcome = run(document);
    ASSERT_TRUE(outcome.done() && outcome.recorded);
    const auto traces = tracesOf(*outcome.recorded);
    ASSERT_THAT(traces, SizeIs(1));
    EXPECT_EQ(traces[0].kernel.rows, 19);
    EXPECT_TRUE(traces[0].active);

    options.action = &*outcome.recorded; // now with the kernel
    hostDocument repeated(source, &again);
    ASSERT_TRUE(run(repeated).done());
    EXPECT_EQ(again.codes(), first.codes());

    // Another size: the user is asked, and decides.
    for (const TNAlertAnswer answer : {TNAnswerNo, TNAnswerOk})
    {
        options.answers = {answer};
        hostDocument larger(other, &elsewhere);
        const hostOutcome asked = run(larger);
        ASSERT_THAT(asked.alerts, SizeIs(1));
        EXPECT_THAT(asked.alerts[0].first, HasSubstr("The image size stored in the action is different"));
        EXPECT_EQ(asked.done(), answer == TNAnswerOk);
    }
}

TEST_F(PluginRun, SurvivesAHostThatLies)
{
    // Each call of the host that a good run makes fails once in turn, with a code of its own, and delivers nonsense.
    memorySource source(colourMode::cmyk, 8, 1, 180, 170);
    std::vector<std::uint8_t> values(180 * 170, 255);
    const selectionMask all(180, 170, values);
    documentSettings shown;
    shown.selection = &all;
    for (const char *call : {"read:1", "read:3", "write:1", "write:2", "suite:*", "suite(Channel):1", "suite(Buffer):1",
                             "suite(Descriptor):*", "suite(ColorSpace):1", "buffer:1", "buffer:2+", "handle:*",
                             "descriptor:1", "descriptor:4", "descriptor:9+", "property:*", "colour:1", "release:1"})
        for (const char *how : {"", "=-36", "=nonsense"})
        {
            memoryResult result(source);
            hostDocument document(source, &result, shown);
            const std::string rule = std::string(call) + how;
            SCOPED_TRACE(rule);
            const hostOutcome outcome = run(document, rule.c_str());
            if (rule.starts_with("read") && std::string_view(how) != "=nonsense")
            {
                EXPECT_TRUE(outcome.result == TNUserHasBeenTold && outcome.alerts.empty());
            }
            if (rule == "write:1=-36")
            {
                EXPECT_EQ(outcome.hostSentence(), hostErrorText(-36));
            }
            if (rule.starts_with("buffer"))
            {
                EXPECT_TRUE(outcome.done()) << "memory of the process's own takes the buffer's place";
            }
        }
}

TEST_F(PluginRun, EndsWhereTheUserSaysSo)
{
    memorySource source(colourMode::rgb, 8, 0);
    memoryResult result(source);
    hostDocument document(source, &result);
    int asked = 0, limit = 0;
    options.abort = [&] { return ++asked > limit; };
    hostOutcome outcome = run(document);
    while (asked > limit) // at each chance in turn, until none is left
    {
        EXPECT_EQ(outcome.result, TNUserHasBeenTold);
        EXPECT_THAT(outcome.alerts, IsEmpty());
        EXPECT_FALSE(outcome.recorded);
        ++limit;
        asked = 0;
        outcome = run(document);
    }
    EXPECT_GT(limit, 3) << "while looking at the picture, estimating and rendering";
    EXPECT_TRUE(outcome.done());
}

} // namespace
} // namespace Stillmark
