// Tools and the set that they are chosen from, the hand and the rectangle to zoom to; a window for long works.

#include "framework/controls/alerts/progressDialog.h"
#include "framework/controls/buttons/toolButton.h"
#include "framework/controls/scrolling/scroller.h"
#include "framework/controls/tools/panner.h"
#include "framework/controls/tools/toolSet.h"
#include "framework/controls/tools/zoomTracker.h"
#include "framework/icons/iconCursor.h"
#include "framework/icons/programIcons.h"
#include "tests/framework/controls/controlStage.h"

namespace Sarnik::Test
{
namespace
{

using Platform::altModifier;
using Platform::ctrlModifier;
using testing::ElementsAre;
using testing::IsEmpty;

const CViewID setId("test/tools"), handId("test/tools/hand"), zoomId("test/tools/zoom");

struct notingTool : CTool
{
    notingTool(CObjID id, Log &log, std::string called) : CTool(id, std::move(called)), entries(log) {}
    void Note(const std::string &what) const { entries.push_back(GetName() + " " + what); }
    void Activated() override { Note("on"); }
    void Deactivated() override { Note("off"); }
    bool ButtonClicked(int clicks) override
    {
        Note("button " + std::to_string(clicks));
        return true;
    }
    Log &entries;
};

struct handTool final : notingTool
{
    using notingTool::notingTool;
    CTool *other = nullptr;

    CTool *ResolveTool(CMouseEvent &e) override
    {
        if (!e.Ctrl() && !e.Alt())
            return nullptr;
        e.modifiers &= ~std::uint32_t{ctrlModifier};
        return other;
    }
    bool MouseDown(CView &view, const CMouseEvent &e) override
    {
        CPanner(view).Run(e);
        return true;
    }
    std::uint32_t UpdateCursor(CView &view, const CMouseEvent &) override
    {
        return view.Window()->IsTracking() ? kCursor_HandClosed : kCursor_Hand;
    }
};

struct zoomTool final : notingTool
{
    using notingTool::notingTool;
    CTool *other = nullptr;
    const CZoomTracker *running = nullptr;

    CTool *ResolveTool(CMouseEvent &e) override
    {
        if (!e.Ctrl())
            return nullptr;
        e.modifiers &= ~std::uint32_t{ctrlModifier | altModifier};
        return other;
    }
    bool MouseDown(CView &view, const CMouseEvent &e) override
    {
        CZoomTracker tracker(view);
        running = &tracker;
        const bool ended = tracker.Run(e);
        running = nullptr;
        const Platform::rectangle r = tracker.Marquee();
        Note(!ended                ? "given up"
             : tracker.IsMarquee() ? "to " + std::to_string(int(r.left)) + "," + std::to_string(int(r.top)) + " " +
                                         std::to_string(int(r.width())) + "x" + std::to_string(int(r.height()))
                                   : std::string(e.Alt() ? "out" : "in"));
        return true;
    }
    void DrawOverlay(CView &, CPort &port) override
    {
        if (running != nullptr)
            running->Draw(port);
    }
    std::uint32_t UpdateCursor(CView &, const CMouseEvent &e) override
    {
        return e.Alt() ? kCursor_ZoomOut : kCursor_ZoomIn;
    }
};

struct tools : controlStage
{
    struct picture final : CPane
    {
        picture() : CPane({0, 0, 600, 400}) {}
        CToolSet *set = nullptr;
        CTool &Tool() const { return *set->Current(); }

        bool MouseDown(const CMouseEvent &e) override { return Tool().Down(*this, e); }
        bool CursorAt(CPoint at, Platform::cursor &c) override
        {
            c = Tool().CursorAt(*this, at);
            return true;
        }
        void Draw(CPort &port) override { Tool().DrawOverlay(*this, port); }
    };

    tools()
    {
        auto group = std::make_unique<CToolGroup>("test/tools/group");
        hand = &static_cast<handTool &>(group->Add(std::make_unique<handTool>(handId, log, "hand")));
        zoom = &static_cast<zoomTool &>(group->Add(std::make_unique<zoomTool>(zoomId, log, "zoom")));
        hand->other = zoom;
        zoom->other = hand;
        set = std::make_unique<CToolSet>(setId, window, std::move(group));
        set->SetTool(handId);
        content = &static_cast<picture &>(scroller.SetContent(std::make_unique<picture>()));
        content->set = set.get();
        Run();
        log.clear();
    }
    bool Shows(std::uint32_t cursor) const { return display.shownCursor() == CIconCursor(cursor); }

    CProgramIcons *icons = CProgramIcons::Get();
    CScroller &scroller = window.Make<CScroller>(CRect{0, 0, 113, 113});
    handTool *hand;
    zoomTool *zoom;
    std::unique_ptr<CToolSet> set;
    picture *content;
};

TEST_F(tools, AnotherToolServesWhileAModifierIsHeld)
{
    scroller.ScrollTo({50, 40});
    // The hand: what was taken hold of stays under the pointer, and stops at the ends.
    display.to(Screen()).drag({{60, 60}, {40, 50}, {30, 45}});
    EXPECT_THAT(Told(), IsEmpty());
    EXPECT_EQ(scroller.Position(), (CPoint{80, 55}));
    display.drag({{10, 10}, {190, 100}});
    Run();
    EXPECT_EQ(scroller.Position(), (CPoint{0, 0}));

    display.with(ctrlModifier).click(20, 20).with(altModifier).click(20, 20).with(ctrlModifier | altModifier);
    display.click(20, 20).with(0).click(20, 20);
    EXPECT_THAT(Told(), ElementsAre("zoom in", "zoom out", "zoom out"));
    set->SetTool(zoomId);
    display.with(ctrlModifier | altModifier).drag({{60, 60}, {40, 50}}).with(0).press(20, 20, 1, 2).release(20, 20);
    EXPECT_THAT(Told(), ElementsAre("hand off", "zoom on", "zoom in"));
    EXPECT_EQ(scroller.Position(), (CPoint{20, 10}));
    // Tools that would pass an event to each other for ever.
    hand->other = zoom->other = zoom;
    display.with(ctrlModifier).click(20, 20);
    EXPECT_THAT(Told(), ElementsAre("zoom in"));
}

TEST_F(tools, ThePointerFollowsGestureAndModifiers)
{
    display.to(Screen()).move(30, 30);
    Run();
    EXPECT_TRUE(Shows(kCursor_Hand));
    display.press(30, 30);
    bool closed = false;
    At(0.1, [&] { window.RefreshPointer(); });
    At(0.2, [&] { closed = Shows(kCursor_HandClosed); });
    display.after(0.5).release(30, 30);
    Run();
    EXPECT_TRUE(closed) << "a tracker that runs may change it";
    EXPECT_TRUE(Shows(kCursor_Hand)) << "and it is asked for again at the end";
    // A key changes nothing until somebody asks.
    display.with(altModifier).keyDown(Platform::key::x);
    Run();
    window.RefreshPointer();
    EXPECT_TRUE(Shows(kCursor_ZoomOut));
}

TEST_F(tools, ARectangleOfFiveUnitsIsNoClick)
{
    set->SetTool(zoomId);
    log.clear();
    display.to(Screen()).drag({{20, 30}, {24, 26}}).drag({{20, 30}, {20, 35}}).drag({{60, 50}, {22, 20}});
    display.drag({{60, 50}, {-40, 20}}).press(40, 40).move(70, 70).tap(Platform::key::escape).release(70, 70);
    EXPECT_THAT(Told(), ElementsAre("zoom in", "zoom to 20,30 0x5", "zoom to 22,20 38x30", "zoom to 0,20 60x30",
                                    "zoom given up"));

    // It is seen while it is drawn, and gone with the release.
    const Platform::raster before = Screen().screen();
    Platform::raster during;
    display.press(20, 20).move(70, 60).after(0.2);
    At(0.1, [&] { during = Screen().screen(); });
    display.after(0.2).release(70, 60);
    Run();
    EXPECT_NE(during, before);
    EXPECT_EQ(Screen().screen(), before);
}

TEST_F(tools, ButtonsAndTheSetFollowEachOther)
{
    auto &handButton = Control<CToolButton>("test/tools/hand", {120, 0, 150, 30});
    auto &zoomButton = Control<CToolButton>("test/tools/zoom", {150, 0, 180, 30});
    handButton.SetToolSet(setId);
    zoomButton.SetToolSet(setId);
    set->SetTool(zoomId);
    EXPECT_TRUE(zoomButton.IsOn() && !handButton.IsOn());
    log.clear();

    EXPECT_TRUE(set->Receive(CValMsg<CObjID>(setId, kValue_Click, handId)));
    EXPECT_TRUE(handButton.IsOn() && !zoomButton.IsOn());
    EXPECT_TRUE(set->Receive(CToolClick(handId, 2)));
    set->SetTool("test/tools/none");
    set->SetTool(handId);
    EXPECT_FALSE(set->Receive(CValMsg<CObjID>("test/other", kValue_Click, zoomId)));
    EXPECT_FALSE(set->Receive(CToolClick("test/other", 2)));
    EXPECT_THAT(Told(), ElementsAre("zoom off", "hand on", "hand button 2"));
}

struct progress : controlStage
{
    CProgressDialog dialog{"Progress", "Applying Stillmark with 3 Blur Traces."};
    Platform::memoryWindow &Shown() { return *display.find(dialog.Screen()->id()); }
};

TEST_F(progress, KeepsTheUserOutAndHearsCancel)
{
    Pane("below", {0, 0, 50, 50});
    dialog.Begin(&window);
    display.to(Screen()).click(10, 10);
    dialog.Show(1, 4);
    EXPECT_THAT(log, IsEmpty()) << "the window below takes no press";
    EXPECT_FALSE(dialog.Cancelled());
    const Platform::raster before = Shown().screen();
    dialog.Show(3, 4);
    EXPECT_NE(Shown().screen(), before) << "it is painted at once";
    display.to(Shown()).tap(Platform::key::escape);
    dialog.Show(3, 4);
    EXPECT_TRUE(dialog.Cancelled());
    EXPECT_TRUE(dialog.IsOpen()) << "until the work has noticed";
    dialog.Finish();
    EXPECT_FALSE(dialog.IsOpen());

    dialog.Begin(&window);
    EXPECT_FALSE(dialog.Cancelled());
    display.to(Shown()).close();
    dialog.Show(0, 0);
    EXPECT_TRUE(dialog.Cancelled());
    dialog.Finish();
    display.to(Screen()).click(10, 10);
    Run();
    EXPECT_FALSE(log.empty()) << "and then it takes them again";
}

} // namespace
} // namespace Sarnik::Test
