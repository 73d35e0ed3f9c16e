#include "framework/controls/fields/editString.h"
#include "framework/controls/scrolling/scrollBar.h"

#include <algorithm>
#include <cmath>

namespace Sarnik
{
namespace
{

const CViewID barId("Sarnik/EditString/Bar");

constexpr EScrollbarStyle barStyle = kScrollbarStyle_FernwayMini;
/// The bar is not shown where it would be shorter: its thumb could hardly be moved.
constexpr std::int32_t shortestBar = 36;

} // namespace

/// From the field's edge: clear of the frame's rounded corners.
std::int32_t CEditString::BarEdge() const
{
    return Has(kEdit_NoFrame) ? 0 : CDrawTools::ringRoom + 2;
}

std::int32_t CEditString::BarThickness()
{
    return CScrollBar::Thickness(barStyle);
}

CPoint CEditString::Largest() const
{
    const Platform::rectangle room = TextRoom();
    if (SeveralLines())
        return {0, std::max(0.0, Lines().Height() - room.height())};
    return {std::max(0.0, Lines().Width() + 1 - room.width()), 0};
}

void CEditString::ScrollTo(CPoint to)
{
    const CPoint most = Largest();
    to = {std::clamp(to.x, 0.0, most.x), std::clamp(to.y, 0.0, most.y)};
    if (!(to == scroll))
    {
        scroll = to;
        Invalidate();
    }
    PlaceBar();
}

void CEditString::PlaceBar()
{
    const CPoint most = Largest();
    const std::int32_t edge = BarEdge();
    const CRect all = Bounds();
    const CRect frame{all.right - edge - BarThickness(), all.top + edge, all.right - edge, all.bottom - edge};
    const bool shown = SeveralLines() && most.y > 0 && frame.Height() >= shortestBar;
    if (bar == nullptr && shown)
    {
        bar = &Make<CScrollBar>();
        bar->SetId(barId);
        bar->SetStyle(barStyle);
    }
    if (bar == nullptr)
        return;
    bar->Show(shown);
    bar->SetFrame(frame);
    const double seen = TextRoom().height();
    bar->SetRange(most.y + seen, seen);
    bar->SetSteps(Lines().LineHeight(), 0);
    bar->SetValue(scroll.y);
}

bool CEditString::ReceiveMessage(CMessage &message)
{
    const auto *const scrolled = dynamic_cast<const CScrollMessage *>(&message);
    if (scrolled == nullptr || message.Id() != barId)
        return CControl::ReceiveMessage(message);
    ScrollTo({0, scrolled->Y()});
    return true;
}

bool CEditString::MouseWheel(const CMouseEvent &e)
{
    if (!SeveralLines() || Largest().y <= 0 || e.wheelY == 0)
        return false;
    ScrollTo({0, scroll.y - e.wheelY * 3 * Lines().LineHeight()});
    return true;
}

bool CEditString::CursorAt(CPoint at, Platform::cursor &cursor)
{
    const bool overBar = bar != nullptr && bar->IsVisible() && at.x >= bar->Frame().left;
    if (!IsEnabled() || overBar)
        return false;
    cursor.shape = Platform::cursorShape::text;
    return true;
}

void CEditString::FrameChanged()
{
    HasFocus() ? Reveal() : ScrollTo(scroll);
}

void CEditString::Reveal()
{
    const Platform::rectangle caret = Lines().Caret(editor.Caret()), room = TextRoom();
    const auto moved = [](double from, double low, double high, double size) {
        return std::clamp(from, std::max(0.0, high - size), std::max(0.0, low));
    };
    if (SeveralLines())
        ScrollTo({0, moved(scroll.y, caret.top, std::max(caret.top, caret.bottom),
                           std::max(room.height(), caret.height()))});
    else
        ScrollTo({moved(scroll.x, caret.left, caret.left + 1, std::max(1.0, room.width())), 0});
    ShowCaret();
    Invalidate();
}

} // namespace Sarnik
