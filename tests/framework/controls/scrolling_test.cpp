// Scroll bars, scrollers and sheets of cells: where everything lies, and what pointer, wheel and keys do.

#include "framework/controls/scrolling/listBox.h"
#include "tests/framework/views/stage.h"

#include <random>

namespace Sarnik::Test
{
namespace
{

using Platform::key;
using testing::ElementsAre;
using testing::IsEmpty;

TEST(ScrollerGeometry, PartsLieInsideAndApart)
{
    std::mt19937 random(3);
    const auto any = [&](int low, int high) { return std::uniform_int_distribution(low, high)(random); };
    for (int i = 0; i < 20000; ++i)
    {
        const CLayoutSize room{any(0, 300), any(0, 300)}, content{any(0, 600), any(0, 600)};
        const auto attributes = static_cast<std::uint32_t>(any(0, 31));
        const CScrollerGeometry::gaps gaps{any(0, 60), any(0, 60), any(0, 60), any(0, 60)};
        const auto g = CScrollerGeometry::For(room, attributes, 13, gaps, [&](CLayoutSize) { return content; });
        const CRect parts[] = {g.well, g.xBar, g.yBar, g.corner, g.gapTop, g.gapRight, g.gapLeft, g.gapBottom};
        std::int64_t covered = 0;
        for (const CRect &part : parts)
        {
            if (part.Empty())
                continue;
            covered += part.Width() * part.Height();
            ASSERT_TRUE((CRect{0, 0, room.width, room.height}).Contains(part));
            for (const CRect &other : parts)
                ASSERT_TRUE(&other == &part || other.Empty() || part.Intersected(other).Empty());
        }
        const std::int32_t edge = (attributes & kScroller_WellFrame) != 0 ? CDrawTools::ringRoom + 1 : 0;
        const std::int64_t whole =
            std::int64_t{std::max(0, room.width - 2 * edge)} * std::max(0, room.height - 2 * edge);
        ASSERT_EQ(covered, whole) << "nothing is left over";

        // A bar that hides itself is there exactly where something is out of sight.
        if ((attributes & kScroller_AutoHideScrollBars) == 0 || std::min(room.width, room.height) < 90)
            continue;
        const bool x = !g.xBar.Empty() || !g.gapLeft.Empty() || !g.gapRight.Empty();
        const bool y = !g.yBar.Empty() || !g.gapTop.Empty() || !g.gapBottom.Empty();
        ASSERT_EQ(x, (attributes & kScroller_XBar) != 0 && content.width > g.well.Width());
        ASSERT_EQ(y, (attributes & kScroller_YBar) != 0 && content.height > g.well.Height());
    }
}

struct scrolling : stage
{
    struct host : CPane
    {
        explicit host(Log &log) : CPane({0, 0, 200, 120}), entries(log) {}
        bool ReceiveMessage(CMessage &m) override
        {
            if (const auto *const to = dynamic_cast<CScrollMessage *>(&m))
                entries.push_back(m.Id().Name() + " " + std::to_string(int(to->X())) + "," +
                                  std::to_string(int(to->Y())));
            return true;
        }
        bool ReceiveValue(CValueMessage &m) override
        {
            if (const auto *const value = dynamic_cast<CValMsg<unsigned> *>(&m))
                entries.push_back("current " + std::to_string(value->Value()));
            if (onValue)
                onValue();
            return true;
        }
        bool ReceiveCommand(CCommandMessage &m) override
        {
            entries.push_back("opens " + m.Id().Name());
            return true;
        }
        Log &entries;
        std::function<void()> onValue;
    };
    struct cell : CCellSheetItem
    {
        explicit cell(std::string called) : name(std::move(called)) {}
        void Draw(CPort &, const CRect &, const state &) override {}
        std::string Text() const override { return name; }
        std::string name;
    };

    CCellSheet &Sheet(CScroller &in, std::uint32_t options, int count)
    {
        auto made = std::make_unique<CCellSheet>(CRect{}, options);
        CCellSheet &sheet = *made;
        sheet.SetId("test/sheet");
        for (int i = 0; i < count; ++i)
            sheet.Append(std::make_unique<cell>(std::string(1, static_cast<char>('a' + i % 26))));
        in.SetContent(std::move(made));
        return sheet;
    }
    static std::vector<int> Selected(const CCellSheet &sheet) { return sheet.Selection().Selected(); }

    host &pane = window.Make<host>(log);
};

TEST_F(scrolling, BarDragsPagesAndRepeats)
{
    auto &bar = pane.Make<CScrollBar>(CRect{0, 0, 100, 13});
    bar.SetId("test/bar");
    bar.SetRange(1000, 200);
    // The thumb follows the pointer, to both ends and not beyond; Escape takes it back.
    const Platform::rectangle thumb = bar.Thumb();
    EXPECT_GE(thumb.width(), 19);
    display.drag({{5, 5}, {500, 5}, {-500, 5}, {98, 5}});
    Run();
    EXPECT_EQ(bar.Value(), 800);
    EXPECT_EQ(log.back(), "test/bar 800,0");
    display.press(95, 5).move(50, 5).tap(key::escape).release(50, 5);
    Run();
    EXPECT_EQ(bar.Value(), 800);

    // A page less a line towards the pointer; held, until the thumb is under it.
    log.clear();
    display.click(3, 5);
    EXPECT_THAT(Told(), ElementsAre("test/bar 620,0"));
    display.press(20, 5).after(5).release(20, 5);
    Run();
    EXPECT_LE(bar.Thumb().left, 20);
    EXPECT_GT(bar.Thumb().right, 20);
    EXPECT_GT(bar.Value(), 0);

    bar.SetRange(100, 200);
    EXPECT_TRUE(bar.Thumb().empty());
    EXPECT_EQ(bar.Value(), 0);
    log.clear();
    display.click(50, 5).wheel(50, 5, -1);
    EXPECT_THAT(Told(), IsEmpty());
}

TEST_F(scrolling, ScrollerMovesItsContent)
{
    auto &scroller = pane.Make<CScroller>(CRect{0, 0, 113, 63});
    scroller.SetId("test/scroller");
    CView &content = scroller.SetContent(std::make_unique<notingPane>(log, "content", CRect{0, 0, 400, 300}));
    EXPECT_EQ(scroller.Largest(), (CPoint{300, 250}));
    scroller.ScrollTo({1e300, 20.4});
    EXPECT_EQ(scroller.VisibleRect(), (CRect{300, 20, 400, 70}));
    EXPECT_EQ(content.Frame(), (CRect{-300, -20, 100, 280}));
    EXPECT_THAT(Told(), IsEmpty()) << "the program did it";

    // As little as needed; of what is too large the top left.
    scroller.Reveal({310, 100, 320, 110});
    EXPECT_EQ(scroller.Position(), (CPoint{300, 60}));
    scroller.Reveal({0, 0, 400, 300});
    EXPECT_EQ(scroller.Position(), (CPoint{0, 0}));

    static_cast<notingPane &>(content).takesPress = false;
    display.move(50, 30);
    EXPECT_THAT(Told(), ElementsAre("content enter"));
    display.wheel(50, 30, -1).with(Platform::shiftModifier).wheel(50, 30, -2).with(0);
    EXPECT_THAT(Told(), ElementsAre("content wheel", "test/scroller 0,48", "content wheel", "test/scroller 96,48"));

    // Keys that the content does not want.
    content.SetOptions(kView_Target);
    content.SetFocus();
    log.clear();
    display.tap(key::right).tap(key::pageDown).tap(key::end).tap(key::home);
    Run();
    EXPECT_EQ(scroller.Position(), (CPoint{0, 0}));
    EXPECT_THAT(log, testing::Contains("test/scroller 112,250"));
    display.drag({{109, 5}, {109, 500}});
    Run();
    EXPECT_EQ(scroller.Position(), (CPoint{0, 250}));

    // A larger room shows more, and keeps the position inside.
    scroller.SetFrame({0, 0, 213, 413});
    EXPECT_EQ(scroller.Position(), (CPoint{0, 0}));
    EXPECT_EQ(content.Frame(), (CRect{0, 0, 400, 400})) << "it fills what can be seen";
    scroller.SetAttributes(kScroller_XBar | kScroller_YBar | kScroller_AutoHideScrollBars);
    EXPECT_TRUE(scroller.Geometry().yBar.Empty());
    EXPECT_FALSE(scroller.Geometry().xBar.Empty());

    // The content may go its own way.
    EXPECT_NE(content.ParentView()->Remove(content), nullptr);
    EXPECT_EQ(scroller.Content(), nullptr);
    scroller.SetFrame({0, 0, 100, 100});
    EXPECT_EQ(scroller.Largest(), (CPoint{0, 0}));
}

TEST_F(scrolling, CellsOfEveryFlowAreFoundWhereTheyLie)
{
    for (const std::uint32_t flow : {0u, 1u, 2u, 3u})
        for (const int count : {0, 1, 7, 30})
        {
            auto &scroller = pane.Make<CScroller>(CRect{0, 0, 150, 100});
            CCellSheet &sheet = Sheet(scroller, flow, count);
            sheet.SetCellSize({30, 20});
            const CRect bounds = sheet.Bounds();
            for (int i = 0; i < count; ++i)
            {
                const CRect r = sheet.CellRect(i);
                ASSERT_TRUE(bounds.Contains(r)) << flow;
                ASSERT_EQ(sheet.CellAt({r.left + 0.0, r.top + 0.0}), i);
                ASSERT_EQ(sheet.CellAt({r.right - 1.0, r.bottom - 1.0}), i);
                ASSERT_EQ(sheet.InsertionAt({r.left + 1.0, r.top + 1.0}), i);
                ASSERT_EQ(sheet.InsertionAt({r.right - 1.0, r.bottom - 1.0}), i + 1);
            }
            ASSERT_EQ(sheet.CellAt({-1, 5}), -1);
            pane.Remove(scroller);
        }
}

TEST_F(scrolling, SheetByPointer)
{
    auto &scroller = pane.Make<CScroller>(CRect{0, 0, 150, 60}, kScroller_XBar);
    CCellSheet &sheet = Sheet(scroller, kCellSheet_TrackSelect | kCellSheet_TrackRange | kCellSheet_MultiSelect, 20);
    sheet.SetCellSize({30, 40});
    display.click(15, 10).with(Platform::ctrlModifier).click(75, 10).with(0);
    EXPECT_THAT(Told(), ElementsAre("current 0", "current 2"));
    EXPECT_THAT(Selected(sheet), ElementsAre(0, 2));
    display.with(Platform::shiftModifier).click(135, 10).with(0);
    EXPECT_THAT(Told(), ElementsAre("current 4"));
    EXPECT_THAT(Selected(sheet), ElementsAre(2, 3, 4));

    // A drag selects a range, and scrolls where it goes on outside.
    display.press(45, 10).move(75, 10).move(300, 10).after(0.5).release(300, 10);
    Run();
    EXPECT_EQ(Selected(sheet).front(), 1);
    EXPECT_GT(Selected(sheet).back(), 6);
    EXPECT_GT(scroller.Position().x, 0);

    // What is told may take the sheet away, also in the middle of a drag.
    log.clear();
    scroller.ScrollTo({});
    pane.onValue = [&] {
        if (sheet.Current() == 3)
            pane.Remove(scroller);
    };
    display.press(15, 10).move(105, 10).move(135, 10).release(135, 10);
    EXPECT_THAT(Told(), ElementsAre("current 0", "current 3"));
    EXPECT_THAT(pane.Children(), IsEmpty());
}

TEST_F(scrolling, ListByKeyboard)
{
    auto &box = pane.Make<CListBox>(CRect{0, 0, 120, 90});
    box.SetId("test/box");
    CListSheet &list = box.List();
    list.SetId("test/list");
    list.SetTexts({"Alpha", "Beta", "beetle", "Gamma", "Delta", "Omega", "Psi", "Rho"});
    list.SetListOptions(kListBox_MultiSelect);
    list.SetFocus();
    const auto seen = [&] { return box.VisibleRect().Contains(list.CellRect(list.Current())); };
    display.tap(key::down).tap(key::down).type("be").after(2).type("g");
    EXPECT_THAT(Told(), ElementsAre("current 0", "current 1", "current 2", "current 3"));
    display.tap(key::end);
    Run();
    EXPECT_THAT(Selected(list), ElementsAre(7));
    EXPECT_TRUE(seen());
    display.with(Platform::shiftModifier).tap(key::pageUp).with(0);
    Run();
    EXPECT_TRUE(seen());
    EXPECT_THAT(Selected(list), ElementsAre(4, 5, 6, 7));
    display.with(Platform::ctrlModifier).tap(key::home).tap(key::space).with(0);
    Run();
    EXPECT_TRUE(seen());
    EXPECT_THAT(Selected(list), ElementsAre(0, 4, 5, 6, 7));
    display.with(Platform::ctrlModifier).tap(key::a).with(0);
    Run();
    EXPECT_EQ(Selected(list).size(), 8u);
    log.clear();
    display.tap(key::enter).tap(key::up);
    EXPECT_THAT(Told(), ElementsAre("opens test/list", "current 0"));
    display.press(20, 10, 1, 1).release(20, 10).press(20, 10, 1, 2).release(20, 10);
    EXPECT_THAT(Told(), ElementsAre("opens test/list"));

    // Only the rows that can be seen are drawn: ten thousand cost no more than eight.
    list.SetTexts(std::vector<std::string>(10000, "row"));
    EXPECT_EQ(list.Bounds().bottom, 200000);
    display.tap(key::end);
    Run();
    EXPECT_TRUE(seen());
}

} // namespace
} // namespace Sarnik::Test
