#include "framework/controls/buttons/checkButton.h"
#include "framework/controls/buttons/iconButton.h"
#include "framework/controls/buttons/pushButton.h"
#include "framework/controls/buttons/toolButton.h"
#include "framework/controls/dialog.h"
#include "tests/framework/controls/controlStage.h"

#include <random>

using namespace Sarnik;
using namespace Sarnik::Test;
using Platform::key;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{

struct buttons : controlStage
{
};

TEST_F(buttons, APressIsAClickWhereItEndsOnTheButton)
{
    auto &check = Control<CCheckButton>("check", {10, 10, 90, 30});
    display.click(15, 15);
    EXPECT_THAT(Told(), ElementsAre("check 2 1"));
    // Away and back again: a click. Away: none, and the state on the way tells which it would be.
    std::vector<bool> seen;
    for (const double at : {0.05, 0.15, 0.25})
        At(at, [&] { seen.push_back(check.IsPressed()); });
    display.press(15, 15).after(0.1).move(150, 100).after(0.1).move(20, 20).after(0.1).release(20, 20);
    EXPECT_THAT(Told(), ElementsAre("check 2 0"));
    EXPECT_THAT(seen, ElementsAre(true, false, true));
    display.drag({{15, 15}, {20, 20}, {150, 100}});
    EXPECT_THAT(Told(), IsEmpty());
    // Escape ends a press, the program may take the button away under it.
    display.press(15, 15).tap(key::escape).release(15, 15);
    EXPECT_THAT(Told(), IsEmpty());
    At(0.05, [&] { check.Enable(false); });
    display.press(15, 15).after(0.1).release(15, 15).click(15, 15);
    EXPECT_THAT(Told(), IsEmpty());
    check.Enable(true);
    At(0.05, [&] { pane.Remove(check); });
    display.press(15, 15).after(0.1).release(15, 15);
    EXPECT_THAT(Told(), IsEmpty());
}

TEST_F(buttons, SpacePressesAndReleases)
{
    auto &check = Control<CCheckButton>("check", {10, 10, 90, 30});
    auto &other = Control<CCheckButton>("other", {10, 40, 90, 60});
    display.tap(key::tab).keyDown(key::space).keyDown(key::space, true);
    EXPECT_THAT(Told(), IsEmpty());
    EXPECT_TRUE(check.IsPressed());
    EXPECT_TRUE(window.ShowsFocus());
    display.keyUp(key::space);
    EXPECT_THAT(Told(), ElementsAre("check 2 1"));
    display.keyDown(key::space).tap(key::escape).keyUp(key::space);
    display.keyDown(key::space).tap(key::tab).keyUp(key::space);
    EXPECT_THAT(Told(), IsEmpty()) << "given up by Escape, and by leaving";
    EXPECT_TRUE(other.HasFocus());
    EXPECT_FALSE(check.IsPressed());
    display.click(15, 15);
    Told();
    EXPECT_TRUE(check.HasFocus());
    EXPECT_FALSE(window.ShowsFocus()) << "the pointer knows where it is";
}

TEST_F(buttons, ValuesGoRoundAndTheProgramTellsNobody)
{
    auto &check = Control<CCheckButton>("check", {10, 10, 90, 30});
    check.SetText("&Preview");
    check.SetValue(kNeutral);
    display.with(Platform::altModifier).tap(key::p).tap(key::p).with(0);
    EXPECT_THAT(Told(), ElementsAre("check 2 1", "check 2 0"));
    check.SetTriState(true);
    display.click(12, 12).click(12, 12).click(12, 12);
    EXPECT_THAT(Told(), ElementsAre("check 2 1", "check 2 2", "check 2 0"));
    EXPECT_EQ(PixelsShown([&] { check.SetValue(kOn); }), 80 * 20) << "its own rectangle alone";
    EXPECT_EQ(PixelsShown([&] { check.SetValue(kOn); }), 0);
}

TEST_F(buttons, OneRadioButtonOfAGroupIsOn)
{
    auto &elsewhere = pane.Make<CPane>(CRect{100, 0, 200, 100});
    std::vector<CRadioButton *> all;
    for (int i = 0; i < 4; ++i)
        all.push_back(&Control<CRadioButton>(std::to_string(i).c_str(), {0, i * 20, 90, i * 20 + 20}));
    auto &lone = Control<CRadioButton>("lone", {0, 0, 90, 20}, &elsewhere);
    lone.SetValue(kOn);
    all[1]->Enable(false);
    EXPECT_EQ(window.TabOrder(), (std::vector<CView *>{&lone, all[0]})) << "none is on: the first";
    display.click(5, 45);
    EXPECT_THAT(Told(), ElementsAre("2 2 1"));
    EXPECT_EQ(window.TabOrder(), (std::vector<CView *>{&lone, all[2]}));
    display.tap(key::down).tap(key::down).tap(key::down).tap(key::left).click(5, 45);
    EXPECT_THAT(Told(), ElementsAre("3 2 1", "0 2 1", "2 2 1", "0 2 1", "2 2 1")) << "past what is disabled";
    display.click(5, 45);
    EXPECT_THAT(Told(), IsEmpty()) << "on already";

    std::mt19937 random(3);
    for (int step = 0; step < 100; ++step)
    {
        CRadioButton &some = *all[random() % all.size()];
        if (random() % 2 != 0)
            some.SetValue(kOn);
        else
            some.Press();
        ASSERT_EQ(std::count_if(all.begin(), all.end(), [](const auto *b) { return b->IsOn(); }), 1);
        ASSERT_TRUE(lone.IsOn());
    }
}

TEST_F(buttons, PushButtonsSendACommandWhereNobodyTakesTheValue)
{
    auto &push = Control<CPushButton>("test/go", {10, 10, 90, 36});
    push.SetDefault(true);
    auto &field = Pane("field", {10, 50, 90, 70}, kView_Target | kView_TabStop, &pane);
    field.SetFocus();
    log.clear();
    display.click(20, 20);
    Run();
    EXPECT_EQ(log.back(), "test/go 2 1");
    pane.takesValues = false;
    field.SetFocus();
    log.clear();
    display.tap(key::enter);
    const Log told = Told();
    ASSERT_GE(told.size(), 2u);
    EXPECT_EQ(told.back(), "command test/go") << "from anywhere";
    // A handler that takes the value may delete the button.
    pane.takesValues = true;
    pane.onValue = [&] { pane.Remove(push); };
    display.click(20, 20);
    Run();
    EXPECT_EQ(window.Find<CPushButton>("test/go"), nullptr);
    display.tap(key::enter);
    Run();
}

TEST_F(buttons, ToolsOfASetAreOneChoice)
{
    std::vector<CToolButton *> tools;
    for (int i = 0; i < 3; ++i)
    {
        auto &holder = pane.Make<CPane>(CRect{0, i * 32, 32, i * 32 + 32});
        tools.push_back(&Control<CToolButton>(("tool" + std::to_string(i)).c_str(), {0, 0, 32, 32}, &holder));
        tools.back()->SetToolSet("set");
    }
    auto &field = Pane("field", {100, 50, 190, 70}, kView_Target | kView_TabStop, &pane);
    field.SetFocus();
    CToolButton::Choose(window, "set", "tool0");
    EXPECT_THAT(Told(), ElementsAre("field focus"));
    display.click(10, 40).press(10, 40, 1, 2).release(10, 40);
    EXPECT_THAT(Told(), ElementsAre("set 2 tool1", "Sarnik/ToolButton/Click tool1"));
    EXPECT_TRUE(field.HasFocus());
    EXPECT_FALSE(tools[0]->IsOn());
    display.tap(key::tab).tap(key::down);
    EXPECT_THAT(Told(), ElementsAre("field key \t", "field blur", "set 2 tool2"));
    EXPECT_EQ(window.TabOrder(), (std::vector<CView *>{tools[2], &field}));
    CToolButton::Choose(window, "set", {});
    EXPECT_TRUE(std::none_of(tools.begin(), tools.end(), [](const auto *t) { return t->IsOn(); }));
}

TEST(buttonLayouts, ADialogNeedsNoCodeForItsOwnButtons)
{
    Platform::memoryDisplay display;
    CApplication application(display);
    const auto answer = [&](key pressed) {
        CDialog dialog;
        dialog.LoadText("CDialog(placement: place_row, margin: 10) {"
                        "CRadioButton(view_id: 'a', text: 'A'); CRadioButton(view_id: 'b', text: 'B');"
                        "CCheckButton(view_id: 'check', text: 'Check', tri_state: true);"
                        "CIconButton(view_id: 'arrow', icon: 'none', button_kind: kCheckButton,"
                        "    button_style: kButtonStyle_Disclosure);"
                        "CPushButton(view_id: 'ok', default_button: true, ok_button: true, text: 'OK');"
                        "CPushButton(view_id: 'cancel', cancel_button: true, text: 'Cancel', width: 90); }");
        EXPECT_EQ(dialog.Find<CIconButton>("arrow")->Style(), kButtonStyle_Disclosure);
        EXPECT_EQ(dialog.Find<CIconButton>("arrow")->Bounds(), (CRect{0, 0, 16, 16}));
        EXPECT_EQ(dialog.FindView("cancel")->Bounds().right, 90);
        EXPECT_GE(dialog.FindView("check")->Bounds().bottom, 18);
        dialog.Open();
        display.to(*dialog.Screen()).tap(pressed);
        return dialog.RunModal();
    };
    EXPECT_EQ(answer(key::enter), CObjID("ok"));
    EXPECT_EQ(answer(key::escape), CObjID("cancel"));
}

} // namespace
