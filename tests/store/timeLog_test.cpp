#include "store/timeLog.h"

#include "tests/store/storeFixture.h"

#include <csignal>
#include <gmock/gmock.h>
#include <sys/resource.h>
#include <thread>
#include <vector>

namespace Project
{

namespace
{

class settableClock final : public Platform::clock
{
public:
    Platform::calendarTime localTime() const override { return now; }
    std::uint64_t ticks() const override { return milliseconds; }

    Platform::calendarTime now{2026, 3, 9, 7, 5, 4, 8};
    std::uint64_t milliseconds = 5000;
};

class timeLogTest : public storeTest, public PTimeLogOwner
{
protected:
    timeLogTest() { SetTimeLogOwner(this); }
    ~timeLogTest() override { SetTimeLogOwner(nullptr); }

    bool OutputLog() const override { return on; }
    PTimeLogFile *GetTimeLogFile() override { return &file; }

    bool on = true;
    settableClock time;
    PTimeLogFile file{directory, time};
};

const std::string kStamp = "2026-03-09 07:05:04.008 ";

TEST_F(timeLogTest, StampsLinesAndTimesWhatLiesBetween)
{
    PTimeLogger logger("KernelEstimater 12", time);
    logger.Start();
    time.milliseconds += 1234;
    logger.Stop();
    LogLine("Visible View Area (Device): [%d, %d].", 640, -1);
    EXPECT_EQ(Get("deblur.log"), kStamp + "KernelEstimater 12 Started.\n" + kStamp +
                                     "KernelEstimater 12 Stopped. Time Cost: 1.234 seconds.\n" + kStamp +
                                     "Visible View Area (Device): [640, -1].\n");
    EXPECT_EQ(file.Position(), Get("deblur.log").size());
}

TEST_F(timeLogTest, SwitchedOffOrWithoutARunItLeavesNoFile)
{
    on = false;
    LogLine("nothing");
    on = true;
    SetTimeLogOwner(nullptr);
    LogLine("nothing");
    EXPECT_FALSE(Exists("deblur.log"));
}

TEST_F(timeLogTest, GrowsOverRuns)
{
    Put("deblur.log", "older\n");
    LogLine("first");
    EXPECT_EQ(file.Position(), Get("deblur.log").size());
    PTimeLogFile(directory, time).Append("second");
    LogLine("third");
    EXPECT_EQ(Get("deblur.log"), "older\n" + kStamp + "first\n" + kStamp + "second\n" + kStamp + "third\n");
}

TEST_F(timeLogTest, CutsAMessageAndStillEndsTheLine)
{
    LogLine("%s", std::string(2047, 'a').c_str());
    LogLine("%s", std::string(10000, 'b').c_str());
    file.Append(std::string(10000, 'c').c_str());
    EXPECT_EQ(Get("deblur.log"), kStamp + std::string(2047, 'a') + "\n" + kStamp + std::string(2047, 'b') + "\n" +
                                     kStamp + std::string(2047, 'c') + "\n");
}

TEST_F(timeLogTest, LosesLinesInSilenceAndTriesAgain)
{
    // A folder that is not there stands for one that cannot be written, which does not stop root.
    PTimeLogFile elsewhere(directory + "/later", time);
    elsewhere.Append("lost");
    std::filesystem::create_directory(directory + "/later");
    elsewhere.Append("kept");
    EXPECT_EQ(Get("later/deblur.log"), kStamp + "kept\n");
}

TEST_F(timeLogTest, GoesOnAfterAFullDisk)
{
    LogLine("first");

    // No file may grow beyond the log's present length for a while; the signal that comes with that is ignored.
    const auto handler = std::signal(SIGXFSZ, SIG_IGN);
    rlimit old{};
    ASSERT_EQ(::getrlimit(RLIMIT_FSIZE, &old), 0);
    rlimit full = old;
    full.rlim_cur = file.Position();
    ASSERT_EQ(::setrlimit(RLIMIT_FSIZE, &full), 0);
    LogLine("lost");
    ASSERT_EQ(::setrlimit(RLIMIT_FSIZE, &old), 0);
    std::signal(SIGXFSZ, handler);

    LogLine("third");
    EXPECT_EQ(Get("deblur.log"), kStamp + "first\n" + kStamp + "third\n");
    EXPECT_EQ(file.Position(), Get("deblur.log").size());
}

TEST_F(timeLogTest, LinesFromManyThreadsComeWhole)
{
    std::vector<std::jthread> threads;
    for (int t = 0; t < 4; ++t)
        threads.emplace_back([] {
            for (int i = 0; i < 100; ++i)
                LogLine("a line of one thread among others");
        });
    threads.clear();
    std::string expected;
    for (int i = 0; i < 400; ++i)
        expected += kStamp + "a line of one thread among others\n";
    EXPECT_EQ(Get("deblur.log"), expected);
}

TEST(Clock, ShowsThisCentury)
{
    const Platform::calendarTime now = Platform::systemClock().localTime();
    EXPECT_TRUE(now.year >= 2024 && now.year < 2200);
    EXPECT_TRUE(now.month >= 1 && now.month <= 12 && now.day >= 1 && now.day <= 31);
    EXPECT_TRUE(now.millisecond >= 0 && now.millisecond < 1000);
    const std::uint64_t before = Platform::systemClock().ticks();
    EXPECT_GE(Platform::systemClock().ticks(), before);
}

} // namespace

} // namespace Project
