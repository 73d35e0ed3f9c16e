#include "tests/framework/views/stage.h"

using namespace Sarnik;
using namespace Sarnik::Test;
using Platform::key;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Not;

namespace
{

constexpr std::uint32_t field = kView_Target | kView_TabStop;

//  | window 200 x 120                          |
//  | left 10,10 80x60            right 110,10  |
//  |   inner 10,10 20x20 in left               |
struct input : stage
{
    notingPane &left = Pane("left", {10, 10, 90, 70});
    notingPane &inner = Pane("inner", {10, 10, 30, 30}, field, &left);
    notingPane &right = Pane("right", {110, 10, 190, 70}, field);
};

TEST_F(input, PressesGoToTheFrontAndUpUntilTaken)
{
    display.click(25, 25);
    EXPECT_THAT(Told(), ElementsAre("inner enter", "inner focus", "inner down 5,5", "inner up"));
    inner.takesPress = false;
    display.click(25, 25);
    EXPECT_THAT(Told(), ElementsAre("inner down 5,5", "left down 15,15", "left up")) << "focus stays";
    // The release comes to whoever took the press, wherever it is.
    display.move(15, 15).press(12, 12).move(150, 30).release(150, 30).move(151, 30);
    EXPECT_THAT(Told(),
                ElementsAre("inner leave", "left enter", "left down 2,2", "left up", "left leave", "right enter"));
    display.wheel(25, 25, 1);
    EXPECT_THAT(Told(), ElementsAre("inner wheel", "left wheel"));

    inner.takesPress = true;
    inner.Enable(false);
    display.click(25, 25);
    EXPECT_THAT(Told(), Not(testing::Contains("left down 15,15"))) << "a disabled view keeps the press";
    inner.SetOptions(inner.Options() | kView_IgnoreMouseEvents);
    display.click(25, 25);
    EXPECT_THAT(Told(), testing::Contains("left down 15,15"));
    display.click(150, 30, 3);
    EXPECT_THAT(Told(), Not(testing::Contains("right context")));
    right.SetOptions(right.Options() | kView_ContextClick);
    display.click(150, 30, 3);
    EXPECT_THAT(Told(), testing::Contains("right context"));
}

TEST_F(input, FocusFollowsTabAndLeavesWhatCannotHaveIt)
{
    notingPane &third = Pane("third", {110, 80, 190, 100}, field);
    const auto order = [&] { return window.TabOrder(); };
    EXPECT_THAT(order(), ElementsAre(&inner, &right, &third));
    for (int i = 0; i < 4; ++i)
        display.tap(key::tab);
    display.with(Platform::shiftModifier).tap(key::tab).tap(key::tab);
    Told();
    EXPECT_EQ(window.Focus(), &right) << "once around, one further, two back";
    EXPECT_EQ(window.Target(), &right);
    inner.SetFocus();
    EXPECT_EQ(window.Target(), &left);
    EXPECT_EQ(left.Target(), &inner) << "the chain of targets leads to it";

    left.Enable(false);
    EXPECT_EQ(window.Focus(), nullptr) << "with an ancestor disabled";
    EXPECT_EQ(window.Target(), nullptr);
    EXPECT_FALSE(inner.SetFocus());
    EXPECT_THAT(order(), ElementsAre(&right, &third));
    left.Enable(true);
    left.SetOptions(kView_NoTabNavigate);
    EXPECT_THAT(order(), ElementsAre(&right, &third));
    EXPECT_TRUE(inner.SetFocus()) << "by hand it can";
    window.Remove(left);
    EXPECT_EQ(window.Focus(), nullptr);
    right.SetFocus();
    window.Remove(right);
    EXPECT_EQ(window.Target(), nullptr) << "no target that is gone";
    EXPECT_EQ(window.FindView("test/pane/inner"), nullptr);
    EXPECT_EQ(window.Find<notingPane>("test/pane/third"), &third);
}

TEST_F(input, KeysGoThroughFilterFocusShortcutsAccessKeysAndDefaults)
{
    right.SetFocus();
    Told();
    int filtered = 0;
    window.filter = [&](CKeyboardMessage &m) {
        ++filtered;
        return m.Key() == key::p;
    };
    window.AddShortcut({key::x, 0}, "test/command/x");
    window.AddShortcut({key::z, Platform::ctrlModifier}, "test/command/undo");
    display.type("px");
    EXPECT_THAT(Told(), ElementsAre("right key x", "command test/command/x"))
        << "a key that was used writes no character";
    EXPECT_EQ(filtered, 4) << "both downs and ups";
    display.type("y");
    EXPECT_THAT(Told(), ElementsAre("right key y", "right char y"));
    right.takesKeys = true;
    display.type("x");
    EXPECT_THAT(Told(), ElementsAre("right key x")) << "the focus comes before shortcuts";
    right.takesKeys = false;

    window.commandEnabled = false;
    display.with(Platform::ctrlModifier).tap(key::z);
    EXPECT_THAT(Told(), ElementsAre("right key z")) << "disabled: nothing, and nothing else";
    window.commandEnabled = true;
    EXPECT_EQ(window.QueryCommand("test/command/undo").text, "Do it");

    inner.accessKey = 'S';
    window.SetDefaultView(&left);
    window.SetCancelView(&inner);
    display.with(Platform::altModifier).tap(key::s);
    display.with(0).tap(key::enter).tap(key::escape);
    EXPECT_THAT(Told(), testing::IsSupersetOf({"inner press", "left press", "inner press"}));
    left.Enable(false);
    display.with(Platform::altModifier).tap(key::s).with(0).tap(key::enter);
    EXPECT_THAT(Told(), Not(testing::Contains(testing::EndsWith("press"))));
}

TEST_F(input, ManyCharactersOfOneTextArriveOneByOne)
{
    right.SetFocus();
    Told();
    display.post({.kind = Platform::eventKind::text, .text = std::string(100'000, 'v')});
    EXPECT_EQ(Told().size(), 100'000u);
}

TEST_F(input, TipsAppearAfterARestAndHelpAtOnce)
{
    left.SetHelp("$$$/Test/Help=All of it");
    inner.SetTip("$$$/Test/Tip=Inner", "$$$/Test/TipOff=Inner is off");
    Run();
    Told();
    display.move(25, 25).move(26, 25);
    EXPECT_THAT(Told(), testing::Contains("help All of it")) << "the parent's, at once";
    EXPECT_EQ(display.windows().size(), 1u);
    display.after(CTipWatch::delay + 0.1).post({.kind = Platform::eventKind::keyUp});
    while (display.windows().size() == 1 && !display.scriptEnded())
        application.ProcessOne();
    ASSERT_EQ(display.windows().size(), 2u);
    EXPECT_EQ(display.windows()[1]->kind(), Platform::windowKind::tip);
    EXPECT_GT(display.windows()[1]->place().top, 10 + 25) << "below the pointer";
    Run();
    display.move(150, 30);
    EXPECT_THAT(Told(), testing::Contains("help "));
    EXPECT_EQ(display.windows().size(), 1u) << "gone with the pointer";

    // Where views have nothing to say the window is asked.
    window.tipAt = [](CPoint at, CTip &tip) {
        tip.help = "Window " + std::to_string(int(at.x));
        return at.x < 160;
    };
    display.move(25, 25).move(151, 30).move(165, 30);
    EXPECT_THAT(Told(), testing::AllOf(testing::Contains("help All of it"), testing::Contains("help Window 151"),
                                       testing::Not(testing::Contains("help Window 25"))));
}

struct dropTarget : notingPane, CDropTarget
{
    using notingPane::notingPane;
    bool DragEnter(const CDragData &data, CPoint) override
    {
        Note("drag enter " + std::to_string(data.files.empty() ? data.item : int(data.files.size())));
        return takes;
    }
    void DragLeave() override { Note("drag leave"); }
    void Drop(const CDragData &data, CPoint at) override
    {
        Note("drop " + std::to_string(data.files.size()) + " at " + std::to_string(int(at.x)));
    }
    bool takes = true;
};

/// Drags item 7 of itself.
struct dragSource : notingPane
{
    using notingPane::notingPane;
    bool MouseDown(const CMouseEvent &e) override
    {
        CDragTracker tracker(*this, "test/drag/item", 7);
        tracker.Run(e);
        Note(tracker.Dropped() ? "dropped" : tracker.Dragged() ? "dragged" : "clicked");
        return true;
    }
};

TEST_F(input, FilesAndItemsAreDroppedWhereTheyAreTaken)
{
    auto &target = window.Make<dropTarget>(log, "target", CRect{10, 80, 90, 110});
    target.Make<dropTarget>(log, "inside", CRect{0, 0, 20, 20}).takes = false;
    auto &source = window.Make<dragSource>(log, "source", CRect{110, 80, 190, 110});
    display.drop(60, 90, std::vector<std::string>(1000, "/a/file.knl"));
    EXPECT_THAT(Told(), ElementsAre("target drag enter 1000", "target drop 1000 at 50"));
    display.drop(15, 85, {"f"});
    EXPECT_THAT(Told(), ElementsAre("inside drag enter 1", "target drag enter 1", "target drop 1 at 5"));
    display.drop(150, 90, {"f"}).drop(-5, 700, {"f"});
    EXPECT_THAT(Told(), IsEmpty());

    display.drag({{120, 90}, {100, 90}, {60, 90}, {62, 95}});
    EXPECT_THAT(Told(), testing::IsSupersetOf({"target drag enter 7", "target drop 0 at 52", "source dropped"}));
    display.drag({{120, 90}, {60, 90}, {150, 20}});
    EXPECT_THAT(Told(), testing::IsSupersetOf({"target drag enter 7", "target drag leave", "source dragged"}));
    display.drag({{120, 90}, {122, 91}});
    EXPECT_THAT(Told(), testing::Contains("source clicked"));
    display.move(120, 90).press(120, 90).move(60, 90).tap(key::escape).release(60, 90);
    EXPECT_THAT(Told(), testing::AllOf(testing::Contains("target drag leave"), testing::Contains("source dragged")));

    // The target goes while something is over it.
    CTimer removal(
        0.5, [](void *w) { static_cast<CWindow *>(w)->FindView("test/pane/target")->Show(false); }, &window);
    display.move(120, 90).press(120, 90).move(60, 90);
    source.Invalidate();
    removal.Start();
    display.after(1).move(61, 90).release(61, 90);
    EXPECT_THAT(Told(), testing::Contains("source dragged"));
}

} // namespace
