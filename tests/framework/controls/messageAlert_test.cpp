#include "framework/controls/alerts/messageAlert.h"
#include "framework/views/timer.h"
#include "tests/framework/views/stage.h"

namespace Sarnik::Test
{
namespace
{

using Platform::key;

struct MessageAlert : stage
{
    const std::vector<CAlertButton> saveSet = {
        {CAlertButton::Ok, "Save"}, {CAlertButton::Other, "Don't Save"}, {CAlertButton::Cancel, "Cancel"}};
};

TEST_F(MessageAlert, KeysAnswer)
{
    const auto ask = [&](const std::vector<CAlertButton> &buttons, key k, CObjID preset = {}) {
        CMessageAlert alert(&window, CAlertIcon::question, buttons, "Save?", "Or not.", "Title", preset);
        alert.Open(&window);
        display.to(*alert.Screen()).tap(k);
        return alert.Run();
    };
    EXPECT_EQ(ask(saveSet, key::enter), CAlertButton::Ok);
    EXPECT_EQ(ask(saveSet, key::enter, CAlertButton::Other), CAlertButton::Other);
    EXPECT_EQ(ask(saveSet, key::escape), CAlertButton::Cancel);
    EXPECT_EQ(ask(alertOk(), key::escape), CAlertButton::Ok);
    EXPECT_EQ(ask({{CAlertButton::Ok, "A"}, {CAlertButton::Other, "B"}}, key::escape), CAlertButton::Other);

    CMessageAlert alert(&window, CAlertIcon::none, alertYesNo(), "First", "Second");
    alert.Open(&window);
    display.to(*alert.Screen()).with(Platform::ctrlModifier).tap(key::c).with(Platform::altModifier).tap(key::n);
    EXPECT_EQ(alert.Run(), CAlertButton::Cancel);
    EXPECT_EQ(display.clipboard(), "First\nSecond");
    display.with(0);
}

TEST_F(MessageAlert, EveryButtonCanBeClickedAndClosingCancels)
{
    for (const CAlertButton &wanted : saveSet)
    {
        CMessageAlert alert(&window, CAlertIcon::warning, saveSet, "Save?");
        alert.Open(&window);
        const CRect at = alert.FindView(wanted.answer)->Frame();
        display.to(*alert.Screen()).click(at.left + 5, at.top + 5);
        EXPECT_EQ(alert.Run(), wanted.answer);
    }
    CMessageAlert alert(&window, CAlertIcon::error, saveSet, "Save?");
    alert.Open(&window);
    display.to(*alert.Screen()).close();
    EXPECT_EQ(alert.Run(), CAlertButton::Cancel);
}

TEST_F(MessageAlert, AnyTextFitsTheScreen)
{
    for (const std::string &text :
         {std::string(), std::string("short"), std::string(4'000, 'W'), std::string(900, '\n')})
    {
        CMessageAlert alert(&window, CAlertIcon::information, saveSet, text, text);
        const CRect frame = alert.Settings().frame;
        EXPECT_LE(frame.Width(), 1920);
        EXPECT_LE(frame.Height(), 1080);
        for (const auto &a : alert.Children())
        {
            EXPECT_TRUE(alert.Bounds().Contains(a->Frame()));
            for (const auto &b : alert.Children())
                EXPECT_TRUE(a == b || a->Frame().Intersected(b->Frame()).Empty());
        }
        alert.Open(&window);
        display.to(*alert.Screen()).tap(key::escape);
        alert.Run();
    }
}

TEST_F(MessageAlert, StandsForTheProgramsAlerts)
{
    CWindowAlerts port;
    // Pressed in the window that is open by then.
    struct presser
    {
        Platform::memoryDisplay &display;
        key k;
        CTimer timer{0.5, [](void *p) { static_cast<presser *>(p)->Press(); }, this};
        void Press()
        {
            timer.Stop();
            display.to(*display.windows().back()).tap(k);
        }
    };
    const auto answer = [&](key k) {
        presser pressing{display, k};
        pressing.timer.Start();
        return port.Show({CAlertKind::YesNo, "Title", "Really?", ""});
    };
    EXPECT_EQ(answer(key::escape), CAlertAnswer::No);
    EXPECT_EQ(answer(key::enter), CAlertAnswer::Ok);
    port.Beep();
    EXPECT_EQ(display.beeps(), 1);
}

} // namespace
} // namespace Sarnik::Test
