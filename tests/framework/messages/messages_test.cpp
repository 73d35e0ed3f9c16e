#include "framework/messages/messages.h"
#include "framework/messages/messenger.h"
#include "framework/messages/notifications.h"

#include <gmock/gmock.h>

#include <thread>

using namespace Sarnik;
using testing::ElementsAre;

namespace
{

TEST(objectId, NamesAndBlocksShareOneTable)
{
    const CViewID first("test/ids/first");
    const CBlockID block("test/ids/Base", 20);
    const CCommandID after("test/ids/after");
    EXPECT_GE(first.Number(), 65536u);
    EXPECT_EQ(block.Number(), first.Number() + 1);
    EXPECT_EQ(after.Number(), block.Number() + 20);
    EXPECT_EQ(CObjID("test/ids/first"), first);
    EXPECT_EQ(CMenuID("test/ids/Base"), block) << "asked for again as a single id";
    EXPECT_EQ(CBlockID("test/ids/Base", 7), block);
    EXPECT_THROW(CBlockID("test/ids/first", 2), std::logic_error);
    EXPECT_EQ(block.IndexOf(block + 19), 19);
    EXPECT_EQ(block.IndexOf(after), -1);
    EXPECT_EQ(block.IndexOf(first), -1);
    EXPECT_TRUE((block + 3).InRange(block, block + 19));
    EXPECT_FALSE(after.InRange(block, block + 19));
    EXPECT_EQ((block + 3).Name(), "test/ids/Base+3");
    EXPECT_EQ(CObjID("").Number(), 0u);
    EXPECT_FALSE(CObjID::Find("test/ids/unheard of"));
}

/// Writes down what it is offered, and takes what it is told to.
struct recorder : CMessenger
{
    recorder(std::vector<std::string> &log, std::string called, CMessenger *up = nullptr)
        : entries(log), name(std::move(called))
    {
        SetParent(up);
    }
    bool Note(const char *what, const CMessage &m)
    {
        entries.push_back(name + " " + what);
        return m.Id() == takes;
    }
    bool ReceiveMenu(CMenuMessage &m) override { return Note("menu", m); }
    bool ReceiveKeyboard(CKeyboardMessage &m) override { return Note("key", m); }
    bool ReceiveCommand(CCommandMessage &m) override { return Note("command", m); }
    bool UpdateCommand(CCommandMessage &m) override { return Note("update", m); }
    bool ReceiveValue(CValueMessage &m) override { return Note("value", m); }
    bool ReceiveMessage(CMessage &m) override { return Note("message", m); }

    std::vector<std::string> &entries;
    std::string name;
    CObjID takes;
};

TEST(messenger, MessagesClimbTheChainOfTheirClassUntilTaken)
{
    std::vector<std::string> log;
    recorder root(log, "root"), pane(log, "pane", &root), button(log, "button", &pane);
    const CObjID id("test/messages/id");
    const auto expect = [&](CMessage &&message, const std::string &what) {
        for (const CObjID takenByPane : {CObjID(), id})
        {
            pane.takes = takenByPane;
            log.clear();
            EXPECT_EQ(button.Dispatch(message), bool(takenByPane));
            std::vector<std::string> way{"button " + what, "pane " + what};
            if (!takenByPane)
                way.push_back("root " + what);
            EXPECT_EQ(log, way);
        }
    };
    expect(CMenuMessage(id, CMenuMessage::purpose::opening), "menu");
    expect(CKeyboardMessage(id, Platform::key::a, 'a', 0, false), "key");
    expect(CCommandMessage(id), "command");
    expect(CCommandMessage(id, CCommandMessage::purpose::update), "update");
    expect(CValMsg<CNumber>(id, kValue_Drag, {3.5}), "value");
    expect(CScrollMessage(id, 0, 0), "message");
    expect(CustomNotificationMessage(id), "message");
}

TEST(notifications, ArriveInOrderOnceAndNeverAtTheDead)
{
    std::vector<std::string> log;
    recorder stays(log, "stays");
    auto goes = std::make_unique<recorder>(log, "goes");
    const auto post = [](CMessenger &to) {
        CNotifications::Post(to, std::make_unique<CustomNotificationMessage>(CObjID("test/messages/posted")));
    };
    std::thread worker([&] {
        for (int i = 0; i < 50; ++i)
            post(i % 2 ? stays : *goes);
    });
    worker.join();
    goes.reset();
    EXPECT_TRUE(CNotifications::Deliver());
    EXPECT_EQ(log, std::vector<std::string>(25, "stays message"));
    EXPECT_FALSE(CNotifications::Deliver());

    // What a handler posts waits for the next delivery: no delivery is endless.
    struct echo : CMessenger
    {
        bool ReceiveMessage(CMessage &m) override
        {
            ++count;
            CNotifications::Post(*this, std::make_unique<CustomNotificationMessage>(m.Id()));
            return true;
        }
        int count = 0;
    } again;
    post(again);
    CNotifications::Deliver();
    CNotifications::Deliver();
    EXPECT_EQ(again.count, 2);
}

TEST(shortcut, IsWrittenAsMenusShowIt)
{
    using namespace Platform;
    EXPECT_EQ((CShortcut{key::z, ctrlModifier | shiftModifier}.Text()), "Ctrl+Shift+Z");
    EXPECT_EQ((CShortcut{key::f5, altModifier}.Text()), "Alt+F5");
    EXPECT_EQ(CShortcut{}.Text(), "");
    // Every key that writes something is found again by what it writes, the keypad's by the main ones.
    for (int k = 1; k < 140; ++k)
    {
        const char32_t c = characterOf(static_cast<key>(k));
        EXPECT_TRUE(c == 0 || keyOf(c) == static_cast<key>(k)) << k;
    }
}

} // namespace
