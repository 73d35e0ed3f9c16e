#include "framework/controls/scrolling/scrollBar.h"

#include "framework/views/tracker.h"

#include <algorithm>
#include <cmath>

namespace Sarnik
{
namespace
{

/// The thumb never gets shorter, so that it can be grasped.
constexpr double shortestThumb = 24;
/// Between the thumb and the bar's sides.
constexpr double cushion = 2;
/// Before a held press repeats, and from then on; seconds.
constexpr double firstRepeat = 0.35, nextRepeat = 0.05;

} // namespace

/// Moves the thumb with the pointer. Far beside the bar it springs back to where it was.
class CScrollBar::thumbTracker final : public CTracker
{
public:
    explicit thumbTracker(CScrollBar &scrollBar) : CTracker(scrollBar), bar(scrollBar), start(scrollBar.value)
    {
        const Platform::rectangle thumb = bar.Thumb();
        const double length = bar.IsVertical() ? thumb.height() : thumb.width();
        perUnit = bar.Largest() / std::max(1.0, bar.Track() - 2 * cushion - length);
    }

protected:
    bool Begin() override
    {
        bar.dragging = true;
        bar.Invalidate();
        return true;
    }
    void Track() override
    {
        if (View() == nullptr)
            return;
        constexpr double farAway = 150;
        const CRect room = bar.Bounds();
        const double beside = bar.IsVertical() ? std::max(-CurrentPoint().x, CurrentPoint().x - room.right)
                                               : std::max(-CurrentPoint().y, CurrentPoint().y - room.bottom);
        const double moved = beside > farAway ? 0 : bar.Along(CurrentPoint()) - bar.Along(StartPoint());
        bar.GoTo(start + moved * perUnit);
    }
    void End(bool wasAborted) override
    {
        if (View() == nullptr)
            return;
        bar.dragging = false;
        bar.Invalidate();
        if (wasAborted)
            bar.GoTo(start);
    }

private:
    CScrollBar &bar;
    double start, perUnit;
};

/// Pages towards the pointer as long as the button is held.
class CScrollBar::pageTracker final : public CTracker
{
public:
    explicit pageTracker(CScrollBar &scrollBar)
        : CTracker(scrollBar), bar(scrollBar), timer(
                                                   firstRepeat,
                                                   [](void *tracker) {
                                                       auto &self = *static_cast<pageTracker *>(tracker);
                                                       self.timer.SetPeriod(nextRepeat);
                                                       self.Page();
                                                   },
                                                   this)
    {
    }

protected:
    bool Begin() override
    {
        direction = Towards(StartPoint());
        timer.Start();
        Page();
        return true;
    }
    void End(bool) override { timer.Stop(); }

private:
    int Towards(CPoint p) const
    {
        const Platform::rectangle thumb = bar.Thumb();
        const double at = bar.Along(p);
        return at < (bar.IsVertical() ? thumb.top : thumb.left)        ? -1
               : at >= (bar.IsVertical() ? thumb.bottom : thumb.right) ? 1
                                                                       : 0;
    }
    void Page()
    {
        // Once the thumb has come to the pointer it stays.
        if (View() != nullptr && direction != 0 && Towards(CurrentPoint()) == direction)
            bar.GoTo(bar.value + direction * bar.PageStep());
    }

    CScrollBar &bar;
    CTimer timer;
    int direction = 0;
};

CLayoutSize CScrollBar::NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &)
{
    const std::int32_t thick = Thickness(static_cast<EScrollbarStyle>(properties.Integer("scrollbar_style")));
    return {thick, thick};
}

void CScrollBar::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CControl::ReadProperties(placement, properties);
    SetStyle(static_cast<EScrollbarStyle>(properties.Integer("scrollbar_style")));
    page = std::max(0.0, properties.Number("scroll_page"));
    SetSteps(properties.Number("scroll_button_increment"), properties.Number("scroll_page_increment"));
}

void CScrollBar::SetStyle(EScrollbarStyle to)
{
    style = to;
    Invalidate();
}

void CScrollBar::SetRange(double newTotal, double newPage)
{
    newTotal = std::max(0.0, newTotal);
    newPage = std::max(0.0, newPage);
    if (newTotal == total && newPage == page)
        return;
    total = newTotal;
    page = newPage;
    value = std::clamp(value, 0.0, Largest());
    Invalidate();
}

void CScrollBar::SetSteps(double line, double newPage)
{
    lineStep = std::max(0.0, line);
    pageStep = std::max(0.0, newPage);
}

double CScrollBar::LineStep() const
{
    return lineStep > 0 ? lineStep : std::max(1.0, std::round(page / 10));
}

double CScrollBar::PageStep() const
{
    return pageStep > 0 ? pageStep : std::max(LineStep(), page - LineStep());
}

void CScrollBar::SetValue(double newValue)
{
    newValue = std::clamp(std::isnan(newValue) ? 0 : newValue, 0.0, Largest());
    if (newValue == value)
        return;
    value = newValue;
    Invalidate();
}

void CScrollBar::GoTo(double newValue)
{
    const double old = value;
    SetValue(std::round(newValue));
    if (value == old)
        return;
    CScrollMessage message(Id(), IsVertical() ? 0 : value, IsVertical() ? value : 0);
    Dispatch(message);
}

Platform::rectangle CScrollBar::Thumb() const
{
    if (Largest() <= 0)
        return {};
    const Platform::rectangle room = toCanvas(Bounds());
    const double track = std::max(0.0, Track() - 2 * cushion);
    const double length = std::min(track, std::max(shortestThumb, track * page / total));
    const double start = cushion + (track - length) * value / Largest();
    return IsVertical() ? Platform::rectangle{cushion, start, room.right - cushion, start + length}
                        : Platform::rectangle{start, cushion, start + length, room.bottom - cushion};
}

bool CScrollBar::MouseDown(const CMouseEvent &e)
{
    const Platform::rectangle thumb = Thumb();
    if (thumb.empty())
        return true;
    const double at = Along(e.at);
    // Beside the thumb's sides is on it as well.
    if (at >= (IsVertical() ? thumb.top : thumb.left) && at < (IsVertical() ? thumb.bottom : thumb.right))
        thumbTracker(*this).Run(e);
    else
        pageTracker(*this).Run(e);
    return true;
}

bool CScrollBar::MouseWheel(const CMouseEvent &e)
{
    const double notches = e.wheelX != 0 && !IsVertical() ? -e.wheelX : e.wheelY;
    if (Largest() <= 0 || notches == 0)
        return false;
    GoTo(value - notches * 3 * LineStep());
    return true;
}

void CScrollBar::Draw(CPort &port)
{
    const CPalette &c = CDrawTools::Colours();
    const Platform::rectangle room = toCanvas(Bounds());
    port.Canvas().fillRectangle(room, {70, 70, 70});
    Platform::rectangle thumb = Thumb();
    if (thumb.empty() || !IsEnabled())
        return;
    const double s = port.Scale();
    for (double *const edge : {&thumb.left, &thumb.top, &thumb.right, &thumb.bottom})
        *edge = std::round(*edge * s) / s;
    const double radius = std::min(thumb.width(), thumb.height()) / 2;
    const Platform::colour fill = dragging  ? Platform::colour{168, 168, 168}
                                  : IsHot() ? Platform::colour{146, 146, 146}
                                            : c.edgeLight;
    port.Canvas().fillRounded(thumb, radius, fill);
}

} // namespace Sarnik
