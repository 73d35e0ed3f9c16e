#include "host/plugin/pluginHost.h"

#include "host/plugin/pluginLibrary.h"
#include "platform/error.h"
#include "tests/host/hostFixture.h"
#include "tests/host/memoryPicture.h"
#include "tests/host/portPluginTasks.h"

#include <filesystem>
#include <gmock/gmock.h>

namespace Stillmark
{
namespace
{

using ::testing::AllOf;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

constexpr int columns = 37, rows = 50, bands = 4;

std::string cannotLoad(const std::string &path)
{
    try
    {
        pluginLibrary library(path);
    }
    catch (const Platform::fileError &error)
    {
        return error.what();
    }
    return "";
}

class PluginHost : public hostTest
{
protected:
    PluginHost()
    {
        options.alert = [](const hostAlert &) {};
        options.version = std::nullopt;
    }

    hostOutcome run(int task, faultScript *faults = nullptr)
    {
        options.properties[portPluginKey] = task;
        return runPlugin(plugin.entry(), picture, options, faults);
    }
    hostOutcome run(int task, const char *faults)
    {
        faultScript script = faultScript::parse(faults);
        return run(task, &script);
    }
    std::vector<std::string> told(int task)
    {
        std::vector<std::string> texts;
        for (const hostAlert &alert : run(task).alerts)
            texts.push_back(alert.first);
        return texts;
    }
    static std::vector<std::uint8_t> inverted(std::vector<std::uint8_t> samples)
    {
        for (std::uint8_t &sample : samples)
            sample = static_cast<std::uint8_t>(255 - sample);
        return samples;
    }

    pluginLibrary plugin{STILLMARK_PORT_PLUGIN};
    memoryPicture picture{columns, rows};
    const std::vector<std::uint8_t> before = picture.samples;
    hostOptions options;
};

TEST_F(PluginHost, TellsWhyALibraryCannotBeLoaded)
{
    writeBytes(file("text.tnf"), "no library");
    writeBytes(file("empty.tnf"), "");
    EXPECT_THAT(cannotLoad(file("none.tnf")), AllOf(HasSubstr("none.tnf"), HasSubstr("No such file")));
    EXPECT_THAT(cannotLoad(folder.path().string()), HasSubstr("is not a file"));
    EXPECT_THAT(cannotLoad(file("text.tnf")), HasSubstr("text.tnf: cannot be loaded as a plug-in: "));
    EXPECT_THAT(cannotLoad(file("empty.tnf")), HasSubstr("empty.tnf: cannot be loaded as a plug-in: "));

    const std::string elf = bytesOf(STILLMARK_PORT_PLUGIN);
    writeBytes(file("cut.tnf"), elf.substr(0, elf.size() / 3));
    EXPECT_THAT(cannotLoad(file("cut.tnf")),
                HasSubstr("cut.tnf: cannot be loaded as a plug-in: the file is cut short"));
    std::string renamed = elf; // the same library, but its entry has another name
    for (std::size_t at = 0; (at = renamed.find("EntryFI", at)) != std::string::npos;)
        renamed.replace(at, 7, "EntryXX");
    writeBytes(file("other.tnf"), renamed);
    EXPECT_THAT(cannotLoad(file("other.tnf")), HasSubstr("other.tnf: is not a filter plug-in: it has no EntryFI"));
}

TEST_F(PluginHost, SendsTheSelectorsAndTheBoundsThatFit)
{
    const std::string small = " 16: 37x50 1,2,30,40";
    picture.rect = {1, 2, 30, 40};
    EXPECT_THAT(told(taskTell), ElementsAre("2" + small + " 32: 0x0 0,0,0,0", "3" + small + " 32: 37x50 1,2,30,40",
                                            "5" + small + " 32: 37x50 1,2,30,40"));
    options.interactive = options.continues = true;
    options.bounds32 = false;
    EXPECT_THAT(told(taskTell), ElementsAre("1" + small, "2" + small, "3" + small, "4" + small, "5" + small));

    options.interactive = options.continues = false;
    options.bounds32 = true;
    picture.size = {40000, 10};
    EXPECT_EQ(told(taskTell)[1], "3 16: 0x0 1,2,30,40 32: 40000x10 1,2,30,40");
    picture.rect = {0, 0, 40000, 10};
    EXPECT_EQ(told(taskTell)[1], "3 16: 0x0 0,0,0,0 32: 40000x10 0,0,40000,10");
}

TEST_F(PluginHost, EndsTheRunWhereASelectorFails)
{
    options.interactive = options.continues = true;
    const struct
    {
        TNSelector selector;
        std::size_t calls; ///< that the plug-in saw
    } cases[] = {{TNSelectorParameters, 1},
                 {TNSelectorPrepare, 2},
                 {TNSelectorStart, 3},
                 {TNSelectorContinue, 5},
                 {TNSelectorFinish, 5}};
    for (const auto &[selector, calls] : cases)
    {
        const hostOutcome outcome = run(int{taskFailAt} + selector);
        EXPECT_EQ(outcome.result, TNErrDiskFull);
        EXPECT_EQ(outcome.failedAt, selector);
        EXPECT_EQ(outcome.alerts.size(), calls) << selectorName(selector);
        EXPECT_EQ(outcome.hostSentence(), "The disk is full (error -34).");
    }
    const hostOutcome silent = run(taskNoResult);
    EXPECT_FALSE(silent.done());
    EXPECT_THAT(silent.misuse, ElementsAre("Start gave no result"));
}

TEST_F(PluginHost, GivesAPluginAllThatItNeedsAndTakesItsResult)
{
    std::int64_t lastDone = -1;
    options.progress = [&](std::int64_t done, std::int64_t total) {
        EXPECT_GT(done, lastDone);
        EXPECT_EQ(total, rows);
        lastDone = done;
    };
    picture.onPixels = [&] { EXPECT_TRUE(picture.autoMask && *picture.autoMask == 1); };
    const hostOutcome outcome = run(taskInvert);
    EXPECT_EQ(picture.autoMask, nullptr); // its place has gone
    EXPECT_TRUE(outcome.done()) << outcome.result;
    EXPECT_TRUE(outcome.wrote);
    EXPECT_EQ(picture.samples, inverted(before));
    EXPECT_EQ(lastDone, 48);
    EXPECT_EQ(outcome.leaks.text(), "");
    EXPECT_THAT(outcome.misuse, IsEmpty());
    ASSERT_TRUE(outcome.recorded);
    const recordedAction first = *outcome.recorded;
    EXPECT_EQ(keyText(first.entries()[0].key), "smpl");
    EXPECT_EQ(std::get<std::int32_t>(first.entries()[0].content), columns * rows);
    EXPECT_EQ(std::get<bool>(first.entries()[1].content), true);
    EXPECT_EQ(std::get<2>(first.entries()[2].content), (std::vector<std::uint8_t>{1, 2, 3, 4, 5}));

    // Played, in a poorer host: the plug-in finds what it recorded, and the block's functions for the pixels.
    options.action = &first;
    options.progress = {};
    options.withheldSuites = {TN_CHANNEL_PORTS_SUITE, TN_COLOR_SPACE_SUITE};
    const hostOutcome again = run(taskInvert);
    EXPECT_TRUE(again.done());
    EXPECT_EQ(picture.samples, before);
    EXPECT_EQ(std::get<std::int32_t>(again.recorded.value().entries()[0].content), 2 * columns * rows);

    options.scripting = false;
    EXPECT_FALSE(run(taskInvert).recorded);
    options.bufferLimit = columns * 16;
    EXPECT_TRUE(run(taskInvert).done());
    options.bufferLimit = columns * 16 - 1;
    EXPECT_EQ(run(taskInvert).hostSentence(), "There is not enough memory (error -108).");
    options.suites = false;
    EXPECT_EQ(run(taskInvert).result, TNErrMemoryFull);
}

TEST_F(PluginHost, KeepsAccountOfWhatIsNotGivenBackOrGivenBackTwice)
{
    const hostOutcome leaky = run(taskLeak);
    EXPECT_TRUE(leaky.done());
    EXPECT_EQ(leaky.leaks.text(), "1 handle (100 bytes), 1 buffer (1000 bytes), 1 descriptor, suite " TN_BUFFER_SUITE
                                  ", version 1, suite " TN_DESCRIPTOR_SUITE ", version 5");
    const hostOutcome twice = run(taskTwice);
    EXPECT_TRUE(twice.leaks.empty());
    EXPECT_THAT(twice.misuse,
                ElementsAre("free of a descriptor that does not live", "dispose of a buffer that does not live",
                            "dispose of a handle that does not live",
                            "release of " TN_DESCRIPTOR_SUITE ", version 5, which is not held",
                            "release of " TN_BUFFER_SUITE ", version 1, which is not held"));
}

TEST_F(PluginHost, RefusesAndNotesOtherMisuse)
{
    const recordedAction action;
    options.action = &action;
    const struct
    {
        int task;
        std::vector<std::string> notes;
        TNError result;
    } cases[] = {
        {taskBadRead, {"readPixels of an empty rectangle", "readPixels with strides that hold no samples"}, -50},
        {taskBadThread, {"readPixels was called on another thread than the run's"}, 0},
        {taskBadHandleRecorded, {"the recorded action is no handle that lives"}, 0},
        {taskJunkRecorded, {"what was recorded is not a recorded action"}, 0},
        {taskDisposeRecorded, {"the host's recorded action was disposed of"}, 0},
    };
    for (const auto &[task, notes, result] : cases)
    {
        const hostOutcome outcome = run(task);
        EXPECT_EQ(outcome.misuse, notes);
        EXPECT_EQ(outcome.result, result) << task;
        EXPECT_FALSE(outcome.recorded) << task;
        EXPECT_EQ(outcome.leaks.text(), "") << task;
    }
}

TEST_F(PluginHost, ShowsAlertsAndAnswersThem)
{
    int shown = 0;
    options.alert = [&](const hostAlert &) { shown++; };
    EXPECT_EQ(run(taskAsk).result, TNUserHasBeenTold); // No, where nobody answers
    options.answers = {TNAnswerOk};
    const hostOutcome yes = run(taskAsk);
    EXPECT_TRUE(yes.done());
    EXPECT_EQ(yes.alerts.at(0).first + yes.alerts.at(0).second, "Really?Think.");
    const hostOutcome odd = run(taskAsk, "alert:1=nonsense");
    EXPECT_EQ(odd.result, TNUserHasBeenTold);
    EXPECT_EQ(odd.hostSentence(), "");
    EXPECT_EQ(shown, 3);

    options.alert = {};
    ::testing::internal::CaptureStderr();
    const hostOutcome about = runAbout(plugin.entry(), options);
    EXPECT_TRUE(about.done());
    EXPECT_EQ(::testing::internal::GetCapturedStderr(), "about: A plug-in\n");
}

TEST_F(PluginHost, ThrowsWhatItsOwnFunctionsThrew)
{
    int calls = 0;
    picture.onPixels = [&] {
        if (++calls == 3)
            throw Platform::fileError("scratch: cannot be read: Input/output error");
    };
    EXPECT_THROW(run(taskInvert), Platform::fileError);
    EXPECT_EQ(calls, 3);
    picture.onPixels = [] { throw std::bad_alloc(); };
    EXPECT_THROW(run(taskInvert), std::bad_alloc);
    picture.onPixels = {};

    options.progress = [&](std::int64_t done, std::int64_t) {
        if (done > 0)
            throw Platform::cancelled();
    };
    EXPECT_THROW(run(taskInvert), Platform::cancelled);
    options.progress = {};
    int polls = 0;
    options.abort = [&] { return ++polls == 2; };
    EXPECT_EQ(run(taskInvert).result, TNUserHasBeenTold);
    options.abort = {};
    options.alert = [](const hostAlert &) { throw std::logic_error("no sink"); };
    EXPECT_THROW(run(taskAsk), std::logic_error);
}

/// Whether portPlugin answers a failure of the nth call with the failure's own code.
bool handsCodeOn(hostCall call, std::uint64_t n)
{
    return call == hostCall::read || call == hostCall::write || call == hostCall::colour ||
           // of the descriptor suite's calls only create, three puts and toHandle; it reads and frees before and after
           (call == hostCall::descriptor && n >= 6 && n <= 10);
}

/// Each call of a good run fails, then raves, one after the other: the plug-in and the host clean up every time.
TEST_F(PluginHost, LiesAtEachCall)
{
    const recordedAction action = run(taskInvert).recorded.value();
    options.action = &action;
    faultScript none;
    EXPECT_TRUE(run(taskInvert, &none).done());
    const struct
    {
        const char *name;
        hostCall call;
        std::uint64_t calls;
        bool fatal; ///< for this plug-in, where the call fails
    } kinds[] = {{"read", hostCall::read, bands, true},      {"write", hostCall::write, bands, true},
                 {"suite", hostCall::suite, 4, false},       {"release", hostCall::release, 4, false},
                 {"buffer", hostCall::buffer, 1, true},      {"space", hostCall::space, 1, true},
                 {"handle", hostCall::handle, 1, true},      {"descriptor", hostCall::descriptor, 11, false},
                 {"property", hostCall::property, 2, false}, {"colour", hostCall::colour, 1, true},
                 {"abort", hostCall::abort, bands, true}};
    for (const auto &[name, call, calls, fatal] : kinds)
    {
        ASSERT_EQ(none.calls(call), calls) << name;
        for (std::uint64_t n = 1; n <= calls; n++)
            for (const char *how : {"", "=-37", "=nonsense"})
            {
                const std::string text = name + (":" + std::to_string(n)) + how;
                faultScript script = faultScript::parse(text);
                const hostOutcome outcome = run(taskInvert, &script);
                EXPECT_GE(script.calls(call), n) << text;
                EXPECT_EQ(outcome.leaks.text(), "") << text;
                EXPECT_THAT(outcome.misuse, IsEmpty()) << text;
                EXPECT_FALSE(fatal && how != std::string("=nonsense") && outcome.done()) << text;
                EXPECT_EQ(outcome.result == -37, how == std::string("=-37") && handsCodeOn(call, n)) << text;
            }
    }
    EXPECT_EQ(run(taskInvert, "suite(Buffer):1").result, TNErrMemoryFull);
    EXPECT_TRUE(run(taskInvert, "suite(Buffer):2,read:5").done());
    EXPECT_EQ(run(taskInvert, "descriptor(putData):*=-43").result, TNErrFileNotFound);

    picture.samples = before;
    const hostOutcome unwritten = run(taskInvert, "write:1+=nonsense");
    EXPECT_TRUE(unwritten.done());
    EXPECT_FALSE(unwritten.wrote);
    EXPECT_EQ(picture.samples, before);
    run(taskInvert, "read:2=nonsense"); // all bits set, so 0 is written
    EXPECT_EQ(std::vector<std::uint8_t>(picture.samples.begin() + 16 * columns, picture.samples.begin() + 32 * columns),
              std::vector<std::uint8_t>(16 * columns));
}

TEST(FaultScript, RefusesTextThatIsNone)
{
    for (const char *text : {"reed:1", "read", "read:0", "read:x", "read:1=0", "read:1=40000", "read:1=sense",
                             "read:-1", "read:+", ":1", "read(:1", "read:1,,write:1", "suite:99999999999999999999"})
    {
        EXPECT_THROW(faultScript::parse(text), std::invalid_argument) << text;
    }
    try
    {
        faultScript::parse("read:1,bufer:2");
    }
    catch (const std::invalid_argument &error)
    {
        EXPECT_STREQ(error.what(), "\"bufer:2\" is no fault: there is no call \"bufer\"");
    }
}

} // namespace
} // namespace Stillmark
