#include "framework/base/exceptions.h"
#include "framework/messages/notifications.h"
#include "framework/views/idler.h"
#include "framework/views/tracker.h"
#include "tests/framework/views/stage.h"

#include <random>

using namespace Sarnik;
using namespace Sarnik::Test;
using Platform::key;
using testing::ElementsAre;
using testing::Not;

namespace
{

struct loop : stage
{
};

/// Confined, and written down.
struct notingTracker : CTracker
{
    explicit notingTracker(const notingPane &p, CView &view) : CTracker(view, confine), pane(p) {}
    bool Begin() override
    {
        pane.Note("begin");
        return true;
    }
    void Track() override
    {
        pane.Note("track " + std::to_string(int(CurrentPoint().x)) + "," + std::to_string(int(CurrentPoint().y)));
    }
    void End(bool wasAborted) override
    {
        // The pane may have gone.
        ends += wasAborted ? "aborted" : "ended";
    }
    notingPane const &pane;
    std::string ends;
};

struct trackingPane : notingPane
{
    using notingPane::notingPane;
    bool MouseDown(const CMouseEvent &e) override
    {
        Log &to = entries;
        notingTracker tracker(*this, *this);
        try
        {
            tracker.Run(e);
        }
        catch (const CError &)
        {
            to.push_back("thrown, " + tracker.ends);
            throw;
        }
        to.push_back(tracker.ends);
        return true;
    }
};

TEST_F(loop, TrackersFollowTheDragAndEndForManyReasons)
{
    auto &pane = window.Make<trackingPane>(log, "pane", CRect{10, 10, 60, 40});
    display.drag({{15, 15}, {40, 20}, {500, -9}, {30, 30}});
    EXPECT_THAT(Told(), ElementsAre("pane enter", "pane begin", "pane track 30,10", "pane track 49,0",
                                    "pane track 20,20", "pane track 20,20", "ended"));
    const auto begin = [&]() -> Platform::memoryDisplay & { return display.move(15, 15).press(15, 15).move(20, 20); };

    begin().tap(key::escape).move(30, 30).release(30, 30);
    EXPECT_THAT(Told(), testing::Contains("aborted"));
    begin().release(20, 20, 3).move(21, 21).release(21, 21);
    EXPECT_THAT(Told(), testing::Contains("ended")) << "another button's release is none";
    begin().post({.kind = Platform::eventKind::focusOut}).release(20, 20);
    EXPECT_THAT(Told(), testing::Contains("aborted"));
    window.Activate();
    Told();

    // The view goes under it; later events find their way.
    CTimer killer(
        0.5,
        [](void *w) {
            auto &self = *static_cast<CWindow *>(w);
            if (CView *const view = self.FindView("test/pane/pane"))
                self.Remove(*view);
        },
        &window);
    begin().after(1).move(25, 25).release(25, 25);
    killer.Start();
    EXPECT_THAT(Told(), testing::Contains("aborted"));
    killer.Stop();
    EXPECT_EQ(CTracker::Current(), nullptr);
    EXPECT_FALSE(Screen().hasPointer());
    EXPECT_FALSE(window.IsTracking());
    (void)pane;
}

TEST_F(loop, AWindowClosesAfterItsTracker)
{
    window.Make<trackingPane>(log, "pane", CRect{10, 10, 60, 40});
    display.move(15, 15).press(15, 15).move(20, 20).close();
    EXPECT_THAT(Told(), testing::Contains("aborted"));
    EXPECT_FALSE(window.IsOpen());

    // Deleted under it, by a timer.
    auto doomed = std::make_unique<notingWindow>(log);
    doomed->Make<trackingPane>(log, "doomed", CRect{10, 10, 60, 40});
    doomed->Open();
    CTimer killer(
        0.5, [](void *w) { static_cast<std::unique_ptr<notingWindow> *>(w)->reset(); }, &doomed);
    display.to(*doomed->Screen()).move(15, 15).press(15, 15).after(1).move(25, 25).release(25, 25);
    killer.Start();
    EXPECT_THAT(Told(), testing::Contains("aborted"));
}

/// Opens a modal window that the user closes after a second.
struct asker
{
    void Ask()
    {
        later.Stop();
        CWindow alert;
        alert.Open();
        on.to(*alert.Screen()).after(1).close();
        CTimer never(
            5, [](void *w) { static_cast<CWindow *>(w)->EndModal("test/never"); }, &alert);
        never.Start();
        log.push_back(alert.RunModal() ? "stuck" : "closed");
    }
    Platform::memoryDisplay &on;
    Log &log;
    CTimer later{0.5, [](void *self) { static_cast<asker *>(self)->Ask(); }, this};
};

struct askingPane : notingPane
{
    struct tracker : CTracker
    {
        tracker(CView &view, asker &a) : CTracker(view), asks(a) {}
        void End(bool wasAborted) override
        {
            if (!wasAborted)
                asks.Ask();
        }
        asker &asks;
    };

    using notingPane::notingPane;
    bool MouseDown(const CMouseEvent &e) override
    {
        Note(tracker(*this, *asks).Run(e) ? "ended" : "aborted");
        return true;
    }
    asker *asks = nullptr;
};

TEST_F(loop, ModalWindowsGetTheInputThatADragHad)
{
    asker asks{display, log};
    window.Make<askingPane>(log, "drags", CRect{10, 10, 60, 40}).asks = &asks;
    Pane("pressed", {70, 10, 120, 40});
    display.drag({{15, 15}, {20, 20}});
    EXPECT_THAT(Told(), ElementsAre("drags enter", "closed", "drags ended"));

    // In the middle of a drag, and of a press: they get no release, and keep no pointer.
    for (const auto &[x, told] : {std::pair{15.0, Log{"closed", "drags aborted"}},
                                  std::pair{75.0, Log{"drags leave", "pressed enter", "pressed down 5,5", "closed"}}})
    {
        display.to(*window.Screen()).move(x, 15).press(x, 15);
        asks.later.Start();
        while (asks.later.IsRunning() || !display.scriptEnded())
            application.ProcessOne();
        EXPECT_EQ(Told(), told);
        EXPECT_FALSE(Screen().hasPointer());
    }
}

TEST_F(loop, TheLostDisplayEndsEveryLoopWithAnError)
{
    window.Make<trackingPane>(log, "pane", CRect{10, 10, 60, 40});
    display.move(15, 15).press(15, 15).move(20, 20).loseDisplay().move(22, 22);
    try
    {
        window.RunModal();
        FAIL();
    }
    catch (const CError &e)
    {
        EXPECT_THAT(e.GetErrorString(), testing::HasSubstr("display was lost"));
    }
    EXPECT_THAT(log, testing::Contains("thrown, aborted"));
    EXPECT_FALSE(window.IsOpen());
    EXPECT_EQ(application.Modal(), nullptr);
    EXPECT_THROW(window.Open(), CError);
}

TEST_F(loop, ModalWindowsKeepInputFromOthersButNotFromTheirOwn)
{
    auto &below = Pane("below", {0, 0, 100, 100});
    notingWindow dialog(log);
    dialog.Make<notingPane>(log, "inside", CRect{0, 0, 100, 100});
    notingWindow palette(log);
    palette.Make<notingPane>(log, "palette", CRect{0, 0, 100, 100});
    dialog.Open(&window);
    palette.Open(&dialog);
    Told();
    display.to(*window.Screen()).click(5, 5).close().to(*palette.Screen()).click(5, 5).to(*dialog.Screen()).click(5, 5);
    CTimer end(
        3, [](void *w) { static_cast<CWindow *>(w)->EndModal("test/answer"); }, &dialog);
    end.Start();
    EXPECT_EQ(dialog.RunModal(), CObjID("test/answer"));
    EXPECT_THAT(log, testing::IsSupersetOf({"palette down 5,5", "inside down 5,5"}));
    EXPECT_EQ(below.drawn, 1);
    EXPECT_THAT(log, Not(testing::Contains("below down 5,5")));
    EXPECT_TRUE(window.IsOpen());
    EXPECT_FALSE(dialog.IsOpen());
    EXPECT_TRUE(palette.IsOpen());
    display.to(*window.Screen()).click(5, 5);
    EXPECT_THAT(Told(), testing::Contains("below down 5,5"));

    // Again, ended by its closing.
    display.to(window.Screen() ? *window.Screen() : *palette.Screen());
    CTimer close(
        1, [](void *w) { static_cast<CWindow *>(w)->CloseRequested(); }, &dialog);
    close.Start();
    EXPECT_EQ(dialog.RunModal(), CObjID());
    close.Stop();
    end.Stop();
}

TEST_F(loop, NobodyWaitsWhoseLoopHasEnded)
{
    static CObjID by; // who ends the modal window: a timer, or an idler that has no more to do
    const auto end = [](void *) { CApplication::Current()->Modal()->EndModal(by); };
    struct ender : CIdler
    {
        bool Idle() override
        {
            if (by == CObjID("test/idler"))
                CApplication::Current()->Modal()->EndModal(by);
            return false;
        }
    } idler;
    CTimer timer(1, end, nullptr);
    timer.Start();
    for (const char *const ending : {"test/timer", "test/idler"})
    {
        CWindow dialog;
        const double from = display.now();
        by = ending;
        EXPECT_EQ(dialog.RunModal(), by);
        EXPECT_LT(display.now(), from + (by == CObjID("test/idler") ? 0.5 : 1.5));
    }
}

TEST_F(loop, NegativeCornersAreSharesOfTheRoom)
{
    CWindow centred({"", Platform::windowKind::normal, 0, {-50, -33, 350, 167}, {}});
    CWindow hidden({"", Platform::windowKind::plain, kWin_OpenHidden, {-32000, -32000, -31905, -31954}, {}});
    centred.Open();
    hidden.Open();
    EXPECT_EQ(centred.Frame(), (CRect{760, 290, 1160, 490})) << "on a screen of 1920 by 1080";
    EXPECT_EQ(hidden.Frame().left, -32000);
    EXPECT_FALSE(hidden.IsVisible());
    hidden.SetFrame({300, 300, 395, 346});
    hidden.Show(true);
    Run();
    EXPECT_EQ(display.find(hidden.Screen()->id())->place().left, 300);
    EXPECT_EQ(display.find(hidden.Screen()->id())->presentedPixels(), 95 * 46);
}

TEST_F(loop, PopupsTakeKeysAndGoWithAPressOutside)
{
    auto *menu = new CWindow({"", Platform::windowKind::popup, kWin_AutoDelete, {50, 50, 90, 90}, {}});
    menu->Make<notingPane>(log, "item", CRect{0, 0, 40, 40}, kView_Target);
    auto &pane = Pane("pane", {0, 0, 100, 100}, kView_Target);
    pane.SetFocus();
    menu->Open(&window);
    application.PushPopup(*menu);
    menu->FindView("test/pane/item")->SetFocus();
    Told();
    display.to(*window.Screen()).type("a");
    EXPECT_THAT(Told(), ElementsAre("item key a", "item char a"));
    display.click(5, 5);
    EXPECT_THAT(Told(), Not(testing::Contains("pane down 5,5"))) << "the press only dismisses";
    EXPECT_EQ(display.windows().size(), 1u);
    display.click(5, 5);
    EXPECT_THAT(Told(), testing::Contains("pane down 5,5"));
}

TEST_F(loop, TimersFireAtTheirTimesWhateverTheirCallbacksDo)
{
    struct ticking
    {
        CApplication &application;
        std::vector<double> at = {};
        CTimer *stops = nullptr;
        static void Fire(void *self)
        {
            auto &t = *static_cast<ticking *>(self);
            t.at.push_back(t.application.Display().now());
            if (t.stops != nullptr)
                t.stops->Stop();
        }
    };
    ticking regular{application}, once{application}, never{application};
    CTimer fifteenth(1.0 / 15, ticking::Fire, &regular), shot(0.3, ticking::Fire, &once),
        stopped(0.3, ticking::Fire, &never);
    once.stops = &shot;
    fifteenth.Start();
    shot.Start();
    stopped.Start();
    stopped.Stop();
    const double start = display.now();
    while (display.now() < start + 2)
        application.ProcessOne();
    EXPECT_NEAR(double(regular.at.size()), 30, 1.5);
    ASSERT_EQ(once.at.size(), 1u);
    EXPECT_NEAR(once.at[0] - start, 0.3, 0.01);
    EXPECT_TRUE(never.at.empty());

    // Timers that delete, stop and start one another at random.
    struct crowd
    {
        std::vector<std::unique_ptr<CTimer>> timers;
        std::mt19937 random{5};
        int fired = 0;
        static void Fire(void *self)
        {
            auto &c = *static_cast<crowd *>(self);
            ++c.fired;
            std::unique_ptr<CTimer> &some = c.timers[c.random() % c.timers.size()];
            switch (c.random() % 4)
            {
            case 0:
                some->Stop();
                break;
            case 1:
                some->Start();
                break;
            default:
                some = std::make_unique<CTimer>((c.random() % 10) * 0.01, Fire, self);
                some->Start();
            }
        }
    } many;
    for (int i = 0; i < 20; ++i)
        many.timers.push_back(std::make_unique<CTimer>(0.01 * i, crowd::Fire, &many));
    for (auto &t : many.timers)
        t->Start();
    const double from = display.now();
    for (int i = 0; i < 100'000 && display.now() < from + 5; ++i)
        application.ProcessOne(0.02);
    EXPECT_GT(many.fired, 100);
    EXPECT_GE(display.now(), from + 5);
}

TEST_F(loop, IdlersWorkBetweenEventsAndTheirErrorsAreReported)
{
    struct worker : CIdler
    {
        explicit worker(int n) : left(n) {}
        bool Idle() override
        {
            if (left == 5)
            {
                --left;
                throw CError("", true, false);
            }
            return left > 0 && --left > 0;
        }
        int left;
    } some(40), others(10);
    int events = 0;
    window.filter = [&](CKeyboardMessage &) { return ++events, true; };
    display.after(0.005).keyDown(key::a).after(0.1).keyUp(key::a);
    Run(); // the one that failed is asked again after the next event
    EXPECT_EQ(some.left, 0);
    EXPECT_EQ(others.left, 0);
    EXPECT_EQ(events, 2);

    // Notifications from another place end the wait for the next event, also those behind one that fails.
    struct taker : CMessenger
    {
        bool ReceiveMessage(CMessage &) override
        {
            if (++got == 1)
                throw CError("", true, false);
            return true;
        }
        int got = 0;
    } taker;
    application.ProcessOne(0); // nothing to do: the next turn waits
    for (int i = 0; i < 2; ++i)
        CNotifications::Post(taker, std::make_unique<CustomNotificationMessage>(CObjID("test/loop/note")));
    const double from = display.now();
    while (taker.got < 2 && display.now() < from + 1000)
        application.ProcessOne(1000);
    EXPECT_LT(display.now(), from + 1);
}

TEST_F(loop, HandlersMayDeleteTheirWindow)
{
    struct suicidal : notingPane
    {
        using notingPane::notingPane;
        bool MouseDown(const CMouseEvent &) override
        {
            victim->reset();
            return true;
        }
        void MouseLeave() override { victim->reset(); }
        void FocusChanged(bool has) override
        {
            if (!has && diesWithoutFocus)
                victim->reset();
        }
        bool ReceiveKeyboard(CKeyboardMessage &) override
        {
            victim->reset();
            return true;
        }
        std::unique_ptr<notingWindow> *victim = nullptr;
        bool diesWithoutFocus = false;
    };
    for (int way = 0; way < 6; ++way)
    {
        auto doomed = std::make_unique<notingWindow>(log);
        auto &pane = doomed->Make<suicidal>(log, "pane", CRect{0, 0, 50, 50}, kView_Target);
        Pane("other", {60, 0, 90, 50}, kView_Target, doomed.get());
        pane.victim = &doomed;
        pane.diesWithoutFocus = way > 2;
        doomed->Open();
        pane.SetFocus();
        Told();
        display.to(*doomed->Screen());
        switch (way)
        {
        case 0:
            display.click(5, 5);
            break;
        case 1:
            display.move(5, 5).move(70, 70);
            break;
        case 2:
            display.type("ab");
            break;
        case 3:
            display.click(70, 5);
            break;
        case 4:
            EXPECT_FALSE(doomed->FindView("test/pane/other")->SetFocus());
            break;
        default:
            pane.Enable(false);
            break;
        }
        Told();
        EXPECT_EQ(doomed, nullptr) << way;
    }
}

} // namespace
