#include "framework/base/alerts.h"
#include "framework/controls/fields/editNumber.h"
#include "framework/controls/scrolling/scrollBar.h"
#include "tests/framework/controls/valueStage.h"

#include <random>

using namespace Sarnik;
using namespace Sarnik::Test;
using Platform::ctrlModifier;
using Platform::key;
using Platform::shiftModifier;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{

struct fields : valueStage
{
    CEditString &Field(const char *text, std::uint32_t options = 0, CRect frame = {10, 10, 160, 32})
    {
        auto &field = panel.Make<CEditString>(frame);
        field.SetEditOptions(options);
        field.SetValue(text);
        field.SetFocus();
        Told();
        return field;
    }
    CEditNumber &Number(double least, double most, std::uint32_t bits, double value)
    {
        auto &field = panel.Make<CEditNumber>(CRect{10, 40, 80, 62});
        field.SetFormat({bits, 1, 0});
        field.SetRange(least, most);
        field.SetNumber(value);
        field.SetFocus();
        Told();
        return field;
    }
    void Press(key k, std::uint32_t modifiers = 0)
    {
        display.with(modifiers).tap(k).with(0);
        Run();
    }
};

TEST_F(fields, EditsBeginOnceGoOnAndEnd)
{
    CEditString &field = Field("old");
    display.type("ab");
    EXPECT_THAT(Told(), ElementsAre("EditBegin old", "Edit a", "Edit ab"));
    display.tap(key::enter);
    EXPECT_THAT(Told(), ElementsAre("EditEnd ab"));
    display.tap(key::end).type("c").tap(key::escape);
    EXPECT_THAT(Told(), ElementsAre("EditBegin ab", "Edit abc", "EditEnd ab"));
    // Nothing under way: these keys are somebody else's.
    auto &other = Pane("other", {10, 100, 50, 140}, kView_Target | kView_TabStop, &panel);
    panel.SetDefaultView(&other);
    panel.SetCancelView(&other);
    display.tap(key::enter).tap(key::escape);
    EXPECT_THAT(Told(), ElementsAre("other press", "other press"));
    display.tap(key::end).tap(key::backspace).tap(key::tab);
    EXPECT_THAT(Told(), ElementsAre("EditBegin ab", "Edit a", "EditEnd a", "other focus"));
    field.SetValue("by program");
    EXPECT_THAT(Told(), IsEmpty());
    // A handler may delete the control in any phase.
    for (const EValuePhase phase : {kValue_EditBegin, kValue_Edit, kValue_EditEnd})
    {
        CEditString *gone = &Field("x", 0, {10, 40, 160, 62});
        panel.onValue = [&](CValueMessage &m) {
            if (m.Phase() == phase && gone != nullptr)
                panel.Remove(*std::exchange(gone, nullptr));
        };
        display.type("y").tap(key::enter);
        Run();
        EXPECT_EQ(gone, nullptr);
        panel.onValue = nullptr;
    }
}

TEST_F(fields, LettersAreNoShortcutsWhileTyping)
{
    const CObjID command("test/command/letter"), undo("sarnik/command/undo");
    panel.AddShortcut({key::e, 0}, command);
    panel.AddShortcut({key::backspace, 0}, command);
    panel.AddShortcut({key::z, ctrlModifier}, undo);
    CEditString &field = Field("");
    display.type("e").tap(key::backspace).with(ctrlModifier).tap(key::z).tap(key::z).with(0);
    // First the field's own undos, then those of whoever else has some.
    EXPECT_THAT(Told(), ElementsAre("EditBegin ", "Edit e", "Edit ", "Edit e", "Edit "));
    Press(key::z, ctrlModifier);
    EXPECT_THAT(Told(), ElementsAre("command sarnik/command/undo"));
    field.SetEditOptions(kEdit_ReadOnly);
    display.type("e");
    EXPECT_THAT(Told(), ElementsAre("command test/command/letter"));
}

TEST_F(fields, KeysMoveSelectAndUseTheClipboard)
{
    CEditString &field = Field("one two  three");
    const auto places = [&] { return std::pair(field.Editor().Anchor(), field.Editor().Caret()); };
    EXPECT_EQ(places(), std::pair(std::size_t{0}, std::size_t{14})) << "all is selected with the focus";
    Press(key::left);
    EXPECT_EQ(field.Editor().Caret(), 0u);
    Press(key::right, ctrlModifier | shiftModifier);
    EXPECT_EQ(places(), std::pair(std::size_t{0}, std::size_t{4}));
    Press(key::x, ctrlModifier);
    EXPECT_EQ(display.clipboard(), "one ");
    Press(key::end);
    Press(key::v, ctrlModifier);
    EXPECT_EQ(field.Value(), "two  threeone ");
    Press(key::backspace, ctrlModifier);
    EXPECT_EQ(field.Value(), "two  ");
    Press(key::home);
    Press(key::del, ctrlModifier);
    EXPECT_EQ(field.Value(), "");
    for (int i = 0; i < 4; ++i)
        Press(key::z, ctrlModifier);
    EXPECT_EQ(field.Value(), "one two  three");
    Press(key::z, ctrlModifier | shiftModifier);
    EXPECT_EQ(field.Value(), "two  three");

    // By commands, and only what can be done.
    const auto can = [&](const char *name) {
        return panel.QueryCommand(CObjID(std::string("sarnik/command/") + name)).enabled;
    };
    EXPECT_FALSE(can("cut"));
    EXPECT_TRUE(can("paste"));
    panel.SendCommand("sarnik/command/selectAll");
    EXPECT_TRUE(can("cut") && can("copy") && can("clear"));
    field.SetEditOptions(kEdit_Password);
    EXPECT_FALSE(can("copy"));
    field.SetEditOptions(kEdit_ReadOnly);
    EXPECT_TRUE(can("copy"));
    EXPECT_FALSE(can("paste") || can("clear"));
    const std::string before = field.Value();
    panel.SendCommand("sarnik/command/cut");
    EXPECT_EQ(field.Value(), before);
}

TEST_F(fields, ThePointerSelectsCharactersWordsAndAll)
{
    CEditString &field = Field("some words here, and more of them than fit in");
    const auto x = [&](std::size_t offset) {
        field.Select(offset, offset);
        return double(field.Frame().left + field.CaretRect().left);
    };
    field.Select(0, 0);
    const double w = x(5), h = x(11);
    display.press(w + 2, 20, 1, 2).release(w + 2, 20);
    Run();
    EXPECT_EQ(field.Editor().Selected(), "words");
    display.press(w + 2, 20, 1, 2).move(h + 4, 20).release(h + 4, 20);
    Run();
    EXPECT_EQ(field.Editor().Selected(), "words here");
    display.press(w, 20, 1, 3).release(w, 20);
    Run();
    EXPECT_EQ(field.Editor().Selected(), field.Value());
    display.click(w, 20).with(shiftModifier).click(h, 20).with(0);
    Run();
    EXPECT_EQ(field.Editor().Selected(), "words ");
    // Held outside, the text comes in by itself.
    display.press(h, 20).move(165, 20).after(3).release(165, 20);
    Run();
    EXPECT_EQ(field.Editor().Caret(), field.Value().size());
    EXPECT_EQ(display.shownCursor().shape, Platform::cursorShape::arrow) << "outside";
    display.move(100, 20);
    Run();
    EXPECT_EQ(display.shownCursor().shape, Platform::cursorShape::text);
}

TEST_F(fields, HighTextsAreScrolledByWheelBarAndSelection)
{
    std::string text;
    for (int i = 0; i < 60; ++i)
        text += "line " + std::to_string(i) + "\n";
    for (const std::uint32_t options : {unsigned{kEdit_MultiLine}, unsigned{kEdit_MultiLine | kEdit_ReadOnly}})
    {
        CEditString &field = Field("short", options, {10, 10, 160, 110});
        EXPECT_THAT(field.Children(), IsEmpty());
        field.SetValue(text);
        Press(key::home, ctrlModifier);
        ASSERT_THAT(field.Children(), testing::SizeIs(1));
        auto &bar = dynamic_cast<CScrollBar &>(*field.Children().front());
        ExpectFreshScreen();
        // What a click selects tells which part of the text is seen.
        const auto lineAt = [&](double y) {
            display.press(20, y, 1, 2).release(20, y).tap(key::home).with(shiftModifier).tap(key::end).with(0);
            Run();
            return std::string(field.Editor().Selected());
        };
        EXPECT_EQ(lineAt(20), "line 0");
        display.wheel(50, 50, -2);
        Run();
        EXPECT_EQ(lineAt(15), "line 6");
        const auto x = double(field.Frame().left + bar.Frame().left + 4);
        const Platform::rectangle thumb = bar.Thumb();
        const double grip = field.Frame().top + bar.Frame().top + (thumb.top + thumb.bottom) / 2;
        display.press(x, grip).move(x, grip + 200).release(x, grip + 200);
        Run();
        EXPECT_EQ(bar.Value(), bar.Largest());
        EXPECT_EQ(display.shownCursor().shape, Platform::cursorShape::arrow);
        EXPECT_EQ(lineAt(90), "line 59");
        ExpectFreshScreen();
        // Held above the field, the text comes down; the selection goes with it.
        display.press(100, 60).move(100, 8).after(30).release(100, 8);
        Run();
        EXPECT_EQ(bar.Value(), 0);
        EXPECT_EQ(field.Editor().Caret(), 6u);
        EXPECT_GT(field.Editor().Anchor(), text.size() - 60);
        field.SetValue("short again");
        Run();
        EXPECT_FALSE(bar.IsVisible());
        ExpectFreshScreen();
        panel.Remove(field);
    }
}

/// Keys at random: the field stays within its limits, draws what a fresh paint would, and goes back all the way.
TEST_F(fields, RandomKeysCanAllBeUndone)
{
    constexpr key keys[] = {key::left,      key::right, key::up,    key::down, key::home,   key::end,
                            key::del,       key::a,     key::b,     key::x,    key::pageUp, key::pageDown,
                            key::backspace, key::space, key::enter, key::v,    key::c};
    std::mt19937 random(11);
    for (const std::uint32_t options : {0u, unsigned{kEdit_MultiLine}, unsigned{kEdit_Password}})
    {
        const char *const start = "Words, \xC3\xA4\xE2\x82\xAC and e\xCC\x81";
        CEditString &field = Field(start, options, {10, 10, 110, options == kEdit_MultiLine ? 70 : 32});
        field.SetMaxCharacters(options == 0 ? 40 : 0);
        for (int i = 0; i < 300; ++i)
        {
            const auto k = keys[random() % std::size(keys)];
            // Enter alone would end the edit, and in the first field only.
            const std::uint32_t held = (random() % 3 == 0 ? unsigned{shiftModifier} : 0u) |
                                       (random() % 4 == 0 && k != key::enter ? unsigned{ctrlModifier} : 0u);
            Press(k, held);
            const CTextEditor &editor = field.Editor();
            ASSERT_EQ(editor.Cleaned(editor.Text()), editor.Text());
            ASSERT_LE(editor.To(), editor.Text().size());
            ASSERT_LE(editor.Text().size(), options == 0 ? 100u : 4000u);
            if (i % 50 == 0)
                ExpectFreshScreen();
            if (field.Editor().Text().size() > 2000)
                Press(key::z, ctrlModifier);
        }
        const std::string end = field.Value();
        while (field.Editor().CanUndo())
            Press(key::z, ctrlModifier);
        EXPECT_EQ(field.Value(), start);
        while (field.Editor().CanRedo())
            Press(key::y, ctrlModifier);
        EXPECT_EQ(field.Value(), end);
        panel.Remove(field);
    }
}

TEST_F(fields, AHugePasteIsTakenInPieces)
{
    std::string huge;
    while (huge.size() < 100'000)
        huge += "line\n\xFF";
    display.setClipboard(huge);
    CEditString &field = Field("");
    Press(key::v, ctrlModifier);
    EXPECT_EQ(field.Value().size(), CTextEditor::mostBytes);
    EXPECT_EQ(field.Value().find('\n'), std::string::npos);
    display.type("x");
    Run();
    EXPECT_EQ(display.beeps(), 1) << "no room for more";
    display.tap(key::home).tap(key::end).tap(key::backspace).type("y");
    Run();
    EXPECT_EQ(field.Value().back(), 'y');
    CEditString &lines = Field("", kEdit_MultiLine | kEdit_AutoGrow, {10, 40, 160, 62});
    display.setClipboard("1\n2\n3");
    Press(key::v, ctrlModifier);
    EXPECT_GT(lines.Frame().Height(), 44) << "grows with its lines";
}

TEST_F(fields, TheCaretBlinksAloneAndRestsAfterAWhile)
{
    CEditString &field = Field("text");
    const auto caret = field.CaretRect().Width() * field.CaretRect().Height();
    const auto wait = [&](double seconds) { return Painted([&] { display.after(seconds).move(250, 180); }); };
    EXPECT_EQ(wait(0.6), caret);
    wait(60);
    EXPECT_EQ(wait(10), 0);
    panel.SetFocus(nullptr);
    ExpectFreshScreen();
    EXPECT_EQ(wait(2), 0);
}

TEST_F(fields, NumbersAreToldWhileTheyFitAndCutAtTheEnd)
{
    struct alerts final : CAlertPort
    {
        CAlertAnswer Show(const CAlert &alert) override
        {
            shown.push_back(alert.first);
            return CAlertAnswer::Ok;
        }
        void Beep() override {}
        void WaitCursor(bool) override {}
        Log shown;
    } port;
    CAlertPort *const old = SetAlerts(&port);
    CEditNumber &field = Number(5, 499, kNumber_Integer, 30);
    display.type("120");
    EXPECT_THAT(Told(), ElementsAre("EditBegin 30", "Edit 12", "Edit 120")) << "1 is out of range";
    display.type("0").tap(key::enter);
    EXPECT_THAT(Told(), ElementsAre("EditEnd 499"));
    EXPECT_EQ(field.Value(), "499");
    EXPECT_THAT(port.shown, ElementsAre(testing::HasSubstr("from 5 to 499")));
    field.SetEditOptions(kEdit_NoRangeAlert);
    display.type("1").tap(key::enter);
    EXPECT_THAT(Told(), ElementsAre("EditBegin 499", "EditEnd 5"));
    EXPECT_EQ(port.shown.size(), 1u);
    // No number: the one from before.
    display.type("-").tap(key::enter);
    EXPECT_THAT(Told(), ElementsAre("EditBegin 5", "EditEnd 5"));
    display.type("77q").tap(key::escape);
    EXPECT_THAT(Told(), ElementsAre("EditBegin 5", "Edit 7", "Edit 77", "EditEnd 5"));
    EXPECT_EQ(display.beeps(), 2);
    // The program's own value does not disturb what is being typed, unless it is another one.
    display.type("020");
    Told();
    field.SetNumber(20);
    EXPECT_EQ(field.Value(), "020");
    field.SetNumber(33);
    EXPECT_EQ(field.Value(), "33");
    display.tap(key::enter);
    EXPECT_THAT(Told(), ElementsAre("EditEnd 33"));
    // Digits that are not shown are kept.
    field.SetFormat({kNumber_Decimal, 1, 0});
    field.SetNumber(12.3456);
    display.tap(key::end).type("7").tap(key::backspace).tap(key::enter);
    Run();
    EXPECT_EQ(field.Number(), 12.3456);
    SetAlerts(old);
}

TEST_F(fields, NumbersStepByKeysAndWheelAndWrap)
{
    CEditNumber &field = Number(0, 360, kNumber_Decimal | kNumber_WrapAround, 359.5);
    display.keyDown(key::up).keyDown(key::up, true);
    EXPECT_THAT(Told(), ElementsAre("EditBegin 359.5", "Edit 0.5", "Edit 1.5"));
    display.keyUp(key::up);
    EXPECT_THAT(Told(), ElementsAre("EditEnd 1.5")) << "once the key is up";
    display.with(shiftModifier).tap(key::down).with(0);
    EXPECT_THAT(Told(), ElementsAre("EditBegin 1.5", "Edit 351.5", "EditEnd 351.5"));
    display.wheel(20, 50, 1).wheel(20, 50, 0.5).wheel(20, 50, 0.5);
    EXPECT_THAT(Told(), ElementsAre("EditBegin 351.5", "Edit 352.5", "Edit 353.5"));
    display.after(1).move(21, 50);
    EXPECT_THAT(Told(), ElementsAre("EditEnd 353.5"));
    display.type("-90").tap(key::enter);
    Run();
    EXPECT_EQ(field.Number(), 270);
    panel.SetFocus(nullptr);
    log.clear();
    display.wheel(20, 50, 1);
    EXPECT_THAT(Told(), IsEmpty()) << "the wheel is for the focus";
}

} // namespace
