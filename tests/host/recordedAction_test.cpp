#include "host/plugin/recordedAction.h"

#include "platform/error.h"
#include "tests/host/hostFixture.h"

#include <gmock/gmock.h>
#include <random>

namespace Stillmark
{
namespace
{

using ::testing::HasSubstr;
using bytes = std::vector<std::uint8_t>;

recordedAction sample()
{
    recordedAction action;
    action.put(0x61637456, 5);
    action.put(0x6175744B, true);
    action.put(0x696D6757, -2147483647 - 1);
    action.put(0x6B6E6C4D, bytes{1, 2, 3, 4, 5, 6, 7});
    action.put(7, bytes{});
    return action;
}

class RecordedAction : public hostTest
{
protected:
    std::string refusalOf(const std::string &content)
    {
        writeBytes(file("bad"), content);
        try
        {
            recordedAction::read(file("bad"));
        }
        catch (const Platform::fileError &error)
        {
            return error.what();
        }
        return "";
    }
};

TEST_F(RecordedAction, GoesThroughAFileAndKeepsTheOrderOfFirstPuts)
{
    recordedAction action = sample();
    action.put(0x61637456, bytes{9}); // of another type now, in its old place
    action.write(file("run"));
    expectOnly({"run"});
    const recordedAction back = recordedAction::read(file("run"));
    EXPECT_EQ(back, action);
    EXPECT_EQ(back.entries().front(), (recordedAction::entry{0x61637456, bytes{9}}));
    EXPECT_EQ(back.entries().size(), 5U);
    EXPECT_EQ(back.find(1), nullptr);
}

TEST_F(RecordedAction, RefusesWhatIsNone)
{
    sample().write(file("good"));
    const std::string good = bytesOf(file("good"));
    const auto with = [&](std::size_t place, const std::string &text) {
        return std::string(good).replace(place, text.size(), text);
    };
    const std::string ones(8, '\xFF');
    EXPECT_THAT(refusalOf(""), HasSubstr("bad: is not a recorded action"));
    EXPECT_THAT(refusalOf(with(0, "XX")), HasSubstr("is not a recorded action"));
    EXPECT_THAT(refusalOf(with(8, "\x02")), HasSubstr("unknown version 2"));
    EXPECT_THAT(refusalOf(with(12, "\xFF\xFF")), HasSubstr("65535 keys"));
    EXPECT_THAT(refusalOf(with(20, "\x09")), HasSubstr("key 'actV' has the unknown type 9"));
    EXPECT_THAT(refusalOf(with(24, ones)), HasSubstr("key 'actV' is no 32-bit number"));
    EXPECT_THAT(refusalOf(with(40, "\x02")), HasSubstr("key 'autK' is neither true nor false"));
    EXPECT_THAT(refusalOf(with(32, good.substr(16, 4))), HasSubstr("key 'actV' twice"));
    EXPECT_THAT(refusalOf(with(72, ones)), HasSubstr("ends within the data of key 'knlM'"));
    EXPECT_THAT(refusalOf(good + "x"), HasSubstr("goes on after its last key"));
    for (std::size_t length = 0; length < good.size(); length++)
        EXPECT_NE(refusalOf(good.substr(0, length)), "") << length;
}

TEST(RecordedActionBytes, HostileBytesAreRefusedOrReadAsTheyAreWritten)
{
    const bytes good = sample().bytes();
    std::mt19937 random(20);
    for (int i = 0; i < 20000; i++)
    {
        bytes spoilt = good;
        for (int changes = 1 + random() % 3; changes > 0; changes--)
            spoilt[random() % spoilt.size()] = static_cast<std::uint8_t>(random());
        try
        {
            EXPECT_EQ(recordedAction::fromBytes(spoilt).bytes(), spoilt);
        }
        catch (const recordedAction::formatError &)
        {
        }
    }
}

TEST(RecordedActionBytes, HasLimits)
{
    recordedAction action;
    for (std::uint32_t key = 0; key < recordedAction::mostKeys; key++)
        action.put(key, 1);
    action.put(3, 2);
    EXPECT_THROW(action.put(recordedAction::mostKeys, 1), std::length_error);

    recordedAction large;
    large.put(1, bytes(recordedAction::mostBytes / 2 + 1));
    EXPECT_THROW(large.put(2, bytes(recordedAction::mostBytes / 2)), std::length_error);
    large.put(1, bytes(10)); // gives its room back
    large.put(2, bytes(recordedAction::mostBytes / 2));
    EXPECT_EQ(large.entries().size(), 2U);
}

} // namespace
} // namespace Stillmark
