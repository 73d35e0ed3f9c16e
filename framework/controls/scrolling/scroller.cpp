#include "framework/controls/scrolling/scroller.h"

#include "framework/layout/layoutFlags.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace Sarnik
{
namespace
{

const CViewID xBarId("Sarnik/Scroller/XBar"), yBarId("Sarnik/Scroller/YBar");

CLayoutSize sizeOf(const CRect &r)
{
    return {CRect::Clamped(r.Width()), CRect::Clamped(r.Height())};
}

std::int32_t whole(double v)
{
    return std::isnan(v) ? 0 : static_cast<std::int32_t>(std::clamp(std::round(v), -2e9, 2e9));
}

} // namespace

CScroller::CScroller(const CRect &viewFrame, std::uint32_t scrollerAttributes)
    : CLayoutPane(viewFrame), well(&Make<CWell>()), xBar(&Make<CScrollBar>()), yBar(&Make<CScrollBar>()),
      attributes(scrollerAttributes)
{
    xBar->SetId(xBarId);
    yBar->SetId(yBarId);
    Arrange();
}

void CScroller::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CLayoutPane::ReadProperties(placement, properties);
    attributes =
        static_cast<std::uint32_t>(ReadFlags(properties, "scroller_attributes", static_cast<std::int32_t>(attributes)));
    gaps = {properties.Integer("scroller_gap_left"), properties.Integer("scroller_gap_top"),
            properties.Integer("scroller_gap_right"), properties.Integer("scroller_gap_bottom")};
    SetStyle(static_cast<EScrollbarStyle>(properties.Integer("scrollbar_style")));
}

void CScroller::SetAttributes(std::uint32_t bits)
{
    attributes = bits;
    Arrange();
}

void CScroller::SetStyle(EScrollbarStyle to)
{
    style = to;
    xBar->SetStyle(to);
    yBar->SetStyle(to);
    Arrange();
}

void CScroller::SetGap(EScrollerInterior where, std::int32_t size)
{
    switch (where)
    {
    case kInterior_ScrollerGapLeft:
        gaps.left = size;
        break;
    case kInterior_ScrollerGapTop:
        gaps.top = size;
        break;
    case kInterior_ScrollerGapRight:
        gaps.right = size;
        break;
    case kInterior_ScrollerGapBottom:
        gaps.bottom = size;
        break;
    case kInterior_ScrollerPane:
        return;
    }
    Arrange();
}

CView &CScroller::SetContent(std::unique_ptr<CView> view)
{
    if (content != nullptr)
        well->Remove(*content);
    content = view.get();
    informed = dynamic_cast<CScrollContent *>(content);
    natural = sizeOf(content->Frame());
    well->Add(std::move(view));
    Arrange();
    return *content;
}

void CScroller::CWell::ChildLeft(const CView &)
{
    auto &scroller = static_cast<CScroller &>(*ParentView());
    scroller.content = nullptr;
    scroller.informed = nullptr;
    scroller.Arrange();
}

void CScroller::ChildLeft(const CView &gapView)
{
    for (CView *&gap : gapViews)
        if (gap == &gapView)
            gap = nullptr;
}

void CScroller::TakeChild(std::unique_ptr<CView> child, std::int32_t interior)
{
    if (interior < kInterior_ScrollerGapLeft || interior > kInterior_ScrollerGapBottom)
    {
        SetContent(std::move(child));
        return;
    }
    CView *&gap = gapViews[interior - kInterior_ScrollerGapLeft];
    if (gap != nullptr)
        Remove(*gap);
    gap = &Add(std::move(child));
    Arrange();
}

bool CScroller::Scrolls(std::uint32_t axis, std::uint32_t bar) const
{
    const std::uint32_t said = content->Binding() & kBind_Scrollable;
    return said != 0 ? (said & axis) != 0 : (attributes & bar) != 0;
}

CLayoutSize CScroller::Wanted(CLayoutSize seen) const
{
    if (content == nullptr)
        return seen;
    const CLayoutSize own = informed != nullptr ? informed->ContentSize(seen) : natural;
    return {Scrolls(kBind_XScrollable, kScroller_XBar) ? std::max(own.width, seen.width) : seen.width,
            Scrolls(kBind_YScrollable, kScroller_YBar) ? std::max(own.height, seen.height) : seen.height};
}

CLayoutSize CScroller::Step() const
{
    return informed != nullptr ? informed->ScrollStep() : CLayoutSize{16, 16};
}

void CScroller::Arrange()
{
    // Placing the content may change what it wants, which asks for the next round.
    if (std::exchange(arranging, true))
        return;
    for (int round = 0; round < 2; ++round)
    {
        geometry = CScrollerGeometry::For(sizeOf(Bounds()), attributes, CScrollBar::Thickness(style), gaps,
                                          [this](CLayoutSize seen) { return Wanted(seen); });
        well->SetFrame(geometry.well);
        PlaceContent(Position(), Wanted(sizeOf(geometry.well)));
        if (Wanted(sizeOf(geometry.well)) == (content == nullptr ? sizeOf(geometry.well) : sizeOf(content->Frame())))
            break;
    }
    const CLayoutSize line = Step();
    for (CScrollBar *const bar : {xBar, yBar})
    {
        const bool x = bar == xBar;
        bar->SetFrame(x ? geometry.xBar : geometry.yBar);
        bar->Show(!bar->Frame().Empty());
        const CLayoutSize all = content == nullptr ? CLayoutSize{} : sizeOf(content->Frame());
        bar->SetRange(x ? all.width : all.height,
                      static_cast<double>(x ? geometry.well.Width() : geometry.well.Height()));
        bar->SetSteps(x ? line.width : line.height, 0);
        bar->SetValue(x ? Position().x : Position().y);
    }
    const CRect gapRects[] = {geometry.gapLeft, geometry.gapTop, geometry.gapRight, geometry.gapBottom};
    for (int i = 0; i < 4; ++i)
        if (gapViews[i] != nullptr)
            gapViews[i]->SetFrame(gapRects[i]);
    Invalidate();
    arranging = false;
}

CPoint CScroller::Position() const
{
    if (content == nullptr)
        return {};
    const CRect &frame = content->Frame();
    return {static_cast<double>(-frame.left), static_cast<double>(-frame.top)}; // as integers: no -0
}

CPoint CScroller::Largest() const
{
    if (content == nullptr)
        return {};
    return {static_cast<double>(std::max<std::int64_t>(0, content->Frame().Width() - geometry.well.Width())),
            static_cast<double>(std::max<std::int64_t>(0, content->Frame().Height() - geometry.well.Height()))};
}

CRect CScroller::VisibleRect() const
{
    const CRect room = sizeOf(geometry.well) == CLayoutSize{} ? CRect{} : well->Bounds();
    return room.Moved(std::llround(Position().x), std::llround(Position().y));
}

/// Cut to what can be.
void CScroller::PlaceContent(CPoint to, CLayoutSize size)
{
    if (content == nullptr)
        return;
    const CLayoutSize seen = sizeOf(geometry.well);
    const std::int32_t x = std::clamp(whole(to.x), 0, std::max(0, size.width - seen.width));
    const std::int32_t y = std::clamp(whole(to.y), 0, std::max(0, size.height - seen.height));
    const CRect frame{-x, -y, size.width - x, size.height - y};
    const bool changed = frame != content->Frame();
    content->SetFrame(frame);
    if (changed && informed != nullptr)
        informed->Scrolled();
}

bool CScroller::MoveTo(CPoint to)
{
    if (content == nullptr)
        return false;
    const CPoint old = Position();
    PlaceContent(to, sizeOf(content->Frame()));
    xBar->SetValue(Position().x);
    yBar->SetValue(Position().y);
    if (Position() == old)
        return false;
    if (CWindow *const window = Window())
        window->RefreshPointer(); // something else is under it
    return true;
}

void CScroller::UserScrollTo(CPoint to)
{
    if (!MoveTo(to))
        return;
    CScrollMessage message(Id(), Position().x, Position().y);
    Dispatch(message);
}

void CScroller::Reveal(const CRect &part)
{
    const CRect seen = VisibleRect();
    const auto along = [](std::int32_t low, std::int32_t high, std::int32_t from, std::int32_t to) {
        if (low < from || high - low > to - from)
            return low;
        return high > to ? high - (to - from) : from;
    };
    ScrollTo({static_cast<double>(along(part.left, part.right, seen.left, seen.right)),
              static_cast<double>(along(part.top, part.bottom, seen.top, seen.bottom))});
}

bool CScroller::ReceiveMessage(CMessage &message)
{
    const auto *const scrolled = dynamic_cast<const CScrollMessage *>(&message);
    if (scrolled == nullptr || (message.Id() != xBarId && message.Id() != yBarId))
        return false;
    CPoint to = Position();
    (message.Id() == xBarId ? to.x : to.y) = message.Id() == xBarId ? scrolled->X() : scrolled->Y();
    UserScrollTo(to);
    return true;
}

bool CScroller::MouseWheel(const CMouseEvent &e)
{
    const CPoint most = Largest();
    double x = e.wheelX, y = -e.wheelY;
    // A wheel of one axis scrolls the only axis that there is.
    if (e.Shift() || (most.y == 0 && x == 0))
        x = std::exchange(y, 0) + x;
    if ((x == 0 || most.x == 0) && (y == 0 || most.y == 0))
        return false;
    const CPoint at = Position();
    UserScrollTo({at.x + std::round(3 * Step().width * x), at.y + std::round(3 * Step().height * y)});
    return true;
}

bool CScroller::ReceiveKeyboard(CKeyboardMessage &message)
{
    using Platform::key;
    constexpr std::uint32_t free = Platform::ctrlModifier | Platform::altModifier | Platform::shiftModifier;
    if (!message.IsDown() || (message.Modifiers() & free) != 0)
        return false;
    const CPoint at = Position(), most = Largest();
    const CLayoutSize line = Step(), seen = sizeOf(geometry.well);
    CPoint to = at;
    switch (message.Key())
    {
    case key::left:
        to.x -= line.width;
        break;
    case key::right:
        to.x += line.width;
        break;
    case key::up:
        to.y -= line.height;
        break;
    case key::down:
        to.y += line.height;
        break;
    case key::pageUp:
    case key::pageDown:
    {
        const int sign = message.Key() == key::pageDown ? 1 : -1;
        if (most.y > 0)
            to.y += sign * std::max(line.height, seen.height - line.height);
        else
            to.x += sign * std::max(line.width, seen.width - line.width);
        break;
    }
    case key::home:
        to = {};
        break;
    case key::end:
        to = most.y > 0 ? CPoint{at.x, most.y} : CPoint{most.x, 0};
        break;
    default:
        return false;
    }
    // At an end the key still is the scroller's, so that it does not suddenly do something else.
    if ((to.x != at.x && most.x == 0) || (to.y != at.y && most.y == 0))
        return false;
    if (most.x == 0 && most.y == 0)
        return false;
    UserScrollTo(to);
    return true;
}

CScroller *CScroller::Around(const CView &view)
{
    for (CView *at = view.ParentView(); at != nullptr; at = at->ParentView())
        if (auto *const scroller = dynamic_cast<CScroller *>(at))
            return scroller;
    return nullptr;
}

void CScroller::Draw(CPort &port)
{
    const CPalette &c = CDrawTools::Colours();
    if (!geometry.frame.Empty())
    {
        const Platform::rectangle frame = toCanvas(geometry.frame);
        port.Canvas().fillRectangle(frame, c.edge);
        port.Canvas().fillRectangle({frame.left + 1, frame.top + 1, frame.right - 1, frame.bottom - 1}, c.field);
        const CWindow *const window = Window();
        if (window != nullptr && window->ShowsFocus() && window->Focus() != nullptr && window->Focus()->IsWithin(*this))
            CDrawTools::FocusRing(port, frame, 0);
    }
    for (const CRect &r : {geometry.corner, geometry.gapLeft, geometry.gapTop, geometry.gapRight, geometry.gapBottom})
        if (!r.Empty())
            port.Canvas().fillRectangle(toCanvas(r), {70, 70, 70});
}

} // namespace Sarnik
