// Menus: what they show and send, by pointer and by keyboard, where they open, and that they go.

#include "framework/controls/menus/contextMenu.h"
#include "framework/controls/menus/menuBar.h"
#include "framework/controls/menus/menuPopup.h"
#include "framework/controls/menus/radioPopup.h"
#include "tests/framework/views/stage.h"

#include <optional>
#include <random>
#include <stdexcept>

namespace Sarnik::Test
{
namespace
{

using Platform::key;
using testing::ElementsAre;
using testing::IsEmpty;

const CBlockID numbers("test/menu/base", 4);

/// A bar of three menus, the second without items, over a pane that knows the commands.
struct menus : stage
{
    struct knowingPane : CPane
    {
        explicit knowingPane(menus &m) : CPane({0, 0, 200, 120}, kView_Target | kView_ContextClick), test(m) {}

        bool UpdateCommand(CCommandMessage &m) override
        {
            if (m.Id() == CObjID("test/unknown"))
                return false;
            m.enabled = m.Id() != CObjID("test/off");
            m.checked = m.Id() == CObjID("test/checked");
            if (m.Id() == CObjID("test/renamed"))
                m.text = "$$$/Test/Renamed=Other Name";
            return true;
        }
        bool ReceiveCommand(CCommandMessage &m) override
        {
            test.log.push_back(m.Id().Name());
            if (test.onCommand)
                test.onCommand();
            return true;
        }
        bool ReceiveMenu(CMenuMessage &m) override
        {
            if (m.Purpose() == CMenuMessage::purpose::opening)
                test.log.push_back("opens " + m.Id().Name());
            return false;
        }
        bool ReceiveValue(CValueMessage &m) override
        {
            if (const auto *const value = dynamic_cast<CValMsg<unsigned> *>(&m))
                test.log.push_back("value " + std::to_string(value->Value()) + " phase " + std::to_string(m.Phase()));
            if (test.onCommand)
                test.onCommand();
            return true;
        }
        bool ContextClick(const CMouseEvent &e) override { return context.Open(*test.context, e); }

        menus &test;
        CContextMenu context{*this};
    };

    menus()
    {
        auto bar = std::make_unique<CMenuBar>();
        CMenu &first = bar->Add(std::make_unique<CMenu>("test/first", "$$$/Test/First=First"));
        first.Add("$$$/Test/Load=Load...", "test/load", {key::o, Platform::ctrlModifier});
        first.AddSeparator();
        first.Add("Off", "test/off", {key::i, Platform::ctrlModifier});
        first.Add("Renamed", "test/renamed");
        first.Add("Checked", "test/checked");
        first.Add("Unknown", "test/unknown");
        first.AddSeparator();
        bar->Add(std::make_unique<CMenu>("test/empty", "Fruitless"));
        CMenu &third = bar->Add(std::make_unique<CMenu>("test/third", "Fi&nd", numbers));
        third.AddNumbered("One");
        third.AddNumbered("&Two");
        third.AddNumbered("Three", 3);
        EXPECT_THROW(third.AddNumbered("Five"), std::out_of_range);
        pane.SetFocus();
        barPane.SetMenuBar(std::move(bar));
        Run();
        log.clear();
    }
    Platform::memoryWindow &ScreenOf(CMenuWindow *popup) { return *display.find(popup->Screen()->id()); }
    /// A row of the open menu, in the coordinates of its window.
    static CPoint RowPoint(const CMenuWindow &popup, int row)
    {
        const CRect r = popup.List().RowRect(row);
        return {r.left + 30.0, r.top + 5.0};
    }
    CPoint Title(std::size_t i) const { return {barPane.TitleRect(i).left + 5.0, barPane.TitleRect(i).top + 5.0}; }
    /// The place of a row in the stage's window.
    CPoint RowInWindow(const CMenuWindow &popup, int row) const
    {
        const CPoint p = popup.ToScreen(RowPoint(popup, row)), corner = window.ToScreen({});
        return {p.x - corner.x, p.y - corner.y};
    }

    knowingPane &pane = window.Make<knowingPane>(*this);
    CMenuBarPane &barPane = window.Make<CMenuBarPane>(CRect{0, 0, 200, 24});
    std::optional<CMenu> context;
    std::function<void()> onCommand;
};

TEST_F(menus, RowsAskForStateAndName)
{
    const auto rows = barPane.MenuBar()->Menus()[0]->Rows(pane);
    std::vector<std::string> texts;
    for (const CMenuRow &row : rows)
        texts.push_back((row.separator ? "-" : row.text.text) + (row.enabled ? "+" : "") + (row.checked ? "!" : "") +
                        row.keys);
    EXPECT_THAT(texts, ElementsAre("Load...+Ctrl+O", "-", "OffCtrl+I", "Other Name+", "Checked+!", "Do it+"))
        << "the last is the window's";
    EXPECT_EQ(barPane.MenuBar()->Menus()[2]->Items()[2].command, numbers + 3);
}

TEST_F(menus, BarByPointer)
{
    // Click and click.
    display.click(Title(0).x, Title(0).y);
    EXPECT_THAT(Told(), ElementsAre("opens test/first"));
    ASSERT_EQ(barPane.Opened(), 0u);
    CPoint row = RowPoint(*barPane.Popup(), 3);
    display.to(ScreenOf(barPane.Popup())).move(row.x, row.y).click(row.x, row.y);
    EXPECT_THAT(Told(), ElementsAre("test/renamed"));
    EXPECT_EQ(barPane.Popup(), nullptr);

    // Press, along to another title, to a row; what is disabled is not chosen, and a title without items not opened.
    display.to(Screen()).press(Title(0).x, Title(0).y).move(Title(1).x, Title(1).y);
    Run();
    EXPECT_EQ(barPane.Opened(), 0u);
    display.move(Title(2).x, Title(2).y);
    Run();
    ASSERT_EQ(barPane.Opened(), 2u);
    row = RowInWindow(*barPane.Popup(), 2);
    display.move(row.x, row.y).release(row.x, row.y);
    EXPECT_THAT(Told(), ElementsAre("opens test/first", "opens test/third", "test/menu/base+3"));

    display.press(Title(0).x, Title(0).y);
    Run();
    row = RowInWindow(*barPane.Popup(), 2);
    display.move(row.x, row.y).release(row.x, row.y);
    EXPECT_THAT(Told(), ElementsAre("opens test/first"));
    EXPECT_EQ(barPane.Opened(), 0u);
    // The display may give what follows a press to the window under the pointer.
    display.click(Title(0).x, Title(0).y).press(Title(2).x, Title(2).y);
    Run();
    row = RowPoint(*barPane.Popup(), 0);
    display.to(ScreenOf(barPane.Popup())).move(row.x, row.y).release(row.x, row.y).to(Screen());
    EXPECT_THAT(Told(), ElementsAre("opens test/third", "test/menu/base"));
    display.click(Title(0).x, Title(0).y);
    EXPECT_THAT(Told(), ElementsAre("opens test/first"));
    // The second press on the title closes it.
    display.click(Title(0).x, Title(0).y);
    EXPECT_THAT(Told(), IsEmpty());
    EXPECT_EQ(barPane.Popup(), nullptr);
}

TEST_F(menus, BarByKeyboard)
{
    // F10, past what cannot be chosen, around the end, and sideways past the menu without items.
    display.tap(key::f10);
    EXPECT_THAT(Told(), ElementsAre("opens test/first"));
    ASSERT_NE(barPane.Popup(), nullptr);
    EXPECT_EQ(barPane.Popup()->List().Lit(), 0);
    // It has opened under a pointer that rests.
    const CPoint under = RowPoint(*barPane.Popup(), 4);
    display.to(ScreenOf(barPane.Popup())).move(under.x, under.y).to(Screen()).tap(key::down);
    Run();
    EXPECT_EQ(barPane.Popup()->List().Lit(), 3);
    display.tap(key::end).tap(key::down);
    Run();
    EXPECT_EQ(barPane.Popup()->List().Lit(), 0);
    display.tap(key::right);
    Run();
    EXPECT_EQ(barPane.Opened(), 2u);
    display.tap(key::right).tap(key::left).tap(key::up).tap(key::enter);
    EXPECT_THAT(Told(), ElementsAre("opens test/third", "opens test/first", "opens test/third", "test/menu/base+3"));

    // First letters light, an access key chooses.
    display.with(Platform::altModifier).tap(key::n).with(0).type("th");
    EXPECT_THAT(Told(), ElementsAre("opens test/third", "test/menu/base+1")) << "t is Two's own";
    display.with(Platform::altModifier).tap(key::f).with(0).type("o");
    Run();
    EXPECT_EQ(barPane.Popup()->List().Lit(), 3);
    display.tap(key::escape);
    EXPECT_THAT(Told(), ElementsAre("opens test/first"));
    EXPECT_EQ(barPane.Popup(), nullptr);

    // Shortcuts work without the menu, as far as the command can be carried out.
    display.with(Platform::ctrlModifier).tap(key::o).tap(key::i);
    EXPECT_THAT(Told(), ElementsAre("test/load"));
}

TEST_F(menus, GoWithWhateverTheyDependOn)
{
    const auto opens = [&] {
        display.click(Title(0).x, Title(0).y);
        Run();
        return barPane.Popup() != nullptr;
    };
    ASSERT_TRUE(opens());
    display.press(150, 100).release(150, 100);
    Run();
    EXPECT_EQ(barPane.Popup(), nullptr);
    ASSERT_TRUE(opens());
    barPane.Enable(false);
    EXPECT_EQ(barPane.Popup(), nullptr);
    barPane.Enable(true);
    ASSERT_TRUE(opens());
    CWindow other;
    other.Open();
    Run();
    EXPECT_EQ(barPane.Popup(), nullptr) << "the keyboard went elsewhere";
    window.Activate();
    Run();
    ASSERT_TRUE(opens());
    other.EndModal({});
    window.Close();
    Run();
    EXPECT_EQ(barPane.Popup(), nullptr);
    EXPECT_EQ(display.windows().size(), 1u);

    // While the press goes on that has opened it.
    window.Open();
    Run();
    display.to(Screen()).press(Title(0).x, Title(0).y);
    Run();
    const CPoint row = RowInWindow(*barPane.Popup(), 0);
    window.Remove(barPane);
    display.move(row.x, row.y).release(row.x, row.y);
    EXPECT_THAT(Told(), testing::Not(testing::Contains("test/load")));
    EXPECT_EQ(display.windows().size(), 2u);
}

TEST_F(menus, ContextMenuSendsFromItsViewThatMayGo)
{
    context.emplace("test/context");
    context->Add("Delete", "test/delete");
    display.click(150, 100, 3);
    EXPECT_THAT(Told(), ElementsAre("opens test/context"));
    ASSERT_TRUE(pane.context.IsOpen());
    EXPECT_EQ(pane.context.Popup()->Frame().left, 160);
    EXPECT_EQ(pane.context.Popup()->Frame().top, 110);
    display.tap(key::escape).tap(key::menu);
    EXPECT_THAT(Told(), ElementsAre("opens test/context"));
    EXPECT_EQ(pane.context.Popup()->List().Lit(), 0);
    EXPECT_EQ(pane.context.Popup()->Frame().left, 110) << "in the middle";
    context.reset(); // an open menu does not need it
    onCommand = [this] { window.Remove(pane); };
    display.tap(key::enter);
    EXPECT_THAT(Told(), ElementsAre("test/delete"));
    EXPECT_EQ(display.windows().size(), 1u);
}

TEST_F(menus, RadioPopup)
{
    auto &popup = pane.Make<CRadioPopup>(CRect{10, 40, 110, 64});
    popup.SetItems({"$$$/Test/Auto=Auto", "Low", "Medium", "High"});
    popup.EnableItem(1, false);
    popup.SetFocus();
    display.tap(key::down).tap(key::end).tap(key::down).type("m").tap(key::home).tap(key::home);
    EXPECT_THAT(Told(), ElementsAre("value 2 phase 2", "value 3 phase 2", "value 2 phase 2", "value 0 phase 2"));

    display.tap(key::space).tap(key::down).tap(key::enter);
    EXPECT_THAT(Told(), ElementsAre("value 2 phase 2"));
    display.tap(key::space).tap(key::home).tap(key::escape);
    EXPECT_THAT(Told(), IsEmpty());
    EXPECT_EQ(popup.Value(), 2u);

    // What is chosen already is told only on demand.
    display.tap(key::f4).tap(key::enter);
    EXPECT_THAT(Told(), IsEmpty());
    popup.SetRadioOptions(kRadio_ReportAll);
    display.tap(key::f4).tap(key::enter);
    EXPECT_THAT(Told(), ElementsAre("value 2 phase 2"));

    // Press, drag, release; and a receiver that removes the control.
    display.press(20, 50);
    Run();
    ASSERT_TRUE(popup.IsOpen());
    const CPoint row = RowInWindow(*popup.Popup(), 0);
    onCommand = [&] { pane.Remove(popup); };
    display.move(row.x, row.y).release(row.x, row.y);
    EXPECT_THAT(Told(), ElementsAre("value 0 phase 2"));
    EXPECT_THAT(pane.Children(), IsEmpty());
}

TEST_F(menus, FlyoutOpensItsMenu)
{
    auto &flyout = pane.Make<CFlyoutPopup>(CRect{10, 40, 32, 62});
    display.click(20, 50);
    Run();
    EXPECT_FALSE(flyout.IsOpen()) << "it has no menu";
    auto menu = std::make_shared<CMenu>("test/kernel", "", numbers);
    menu->AddNumbered("Load...");
    menu->AddNumbered("Save...");
    flyout.SetMenu(menu);
    display.click(20, 50).tap(key::up).tap(key::enter);
    EXPECT_THAT(Told(), ElementsAre("opens test/kernel", "test/menu/base+1"));
}

TEST_F(menus, LongMenusScroll)
{
    auto &popup = pane.Make<CRadioPopup>(CRect{10, 40, 110, 64});
    for (int i = 0; i < 200; ++i)
        popup.AddItem("Item " + std::to_string(i));
    popup.SetFocus();
    display.tap(key::space);
    Run();
    CMenuList &list = popup.Popup()->List();
    const auto within = [&](int row) {
        const CRect r = list.RowRect(row);
        return r.top >= 0 && r.bottom <= list.Bounds().bottom && list.RowAt({20, r.top + 1.0}) == row &&
               list.RowAt({20, r.bottom - 1.0}) == row;
    };
    EXPECT_LE(popup.Popup()->Frame().bottom, 1080);
    for (const key k : {key::end, key::pageUp, key::up, key::home, key::pageDown, key::pageDown, key::down, key::up})
    {
        display.tap(k);
        Run();
        EXPECT_TRUE(within(list.Lit())) << list.Lit();
    }
    // The arrow at the end scrolls as long as the pointer is on it.
    display.to(ScreenOf(popup.Popup()))
        .move(20, 50)
        .move(20, list.Bounds().bottom - 5)
        .after(20)
        .move(21, list.Bounds().bottom - 5);
    Run();
    EXPECT_TRUE(within(199));
}

TEST(PopupFrame, LiesWithinTheScreenBesideItsAnchor)
{
    std::mt19937 random(1);
    const CRect area{-200, 20, 1000, 700};
    const auto any = [&](int low, int high) { return std::uniform_int_distribution(low, high)(random); };
    for (int i = 0; i < 5000; ++i)
    {
        const CRect anchor = CRect{0, 0, any(0, 200), any(0, 40)}.Moved(any(-300, 1100), any(-50, 750));
        const int width = any(10, 1500), height = any(10, 900);
        const CRect f = popupFrame(anchor, width, height, area, 60);
        ASSERT_TRUE(area.Contains(f) && !f.Empty());
        ASSERT_EQ(f.Width(), std::min(width, 1200));
        const bool inside = anchor.top >= area.top && anchor.bottom <= area.bottom;
        const bool room = std::max(anchor.top - area.top, area.bottom - anchor.bottom) >= 60;
        ASSERT_TRUE(!inside || !room || f.top >= anchor.bottom || f.bottom <= anchor.top) << "covers its anchor";
        const bool fitsBelow = anchor.top >= area.top && anchor.bottom + height <= area.bottom;
        ASSERT_TRUE(!fitsBelow || (f.top == anchor.bottom && f.Height() == height));
        const bool fitsRight = anchor.left >= area.left && anchor.left + width <= area.right;
        ASSERT_TRUE(!fitsRight || f.left == anchor.left);
    }
}

} // namespace
} // namespace Sarnik::Test
