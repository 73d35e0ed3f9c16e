#include "framework/controls/panes/progressBar.h"

#include "framework/controls/drawTools.h"
#include "framework/views/application.h"
#include "framework/views/window.h"

#include <algorithm>
#include <cmath>

namespace Sarnik
{
namespace
{

constexpr double frameTime = 1.0 / 30, wayTime = 1.5; ///< seconds: of a picture, and of the light from end to end
constexpr double highest = 8, lightShare = 0.3;

} // namespace

CProgressBar::CProgressBar(const CRect &viewFrame) : CLayoutPane(viewFrame), timer(frameTime, Tick, this, this)
{
}

Platform::rectangle CProgressBar::Track() const
{
    const Platform::rectangle r = toCanvas(Bounds());
    const double height = std::min(highest, r.height()), top = std::floor((r.height() - height) / 2);
    // In line with the faces of other controls.
    constexpr double inset = CDrawTools::ringRoom;
    return {r.left + inset, top, std::max(r.left + inset, r.right - inset), top + height};
}

double CProgressBar::FilledTo(double share) const
{
    const Platform::rectangle inner = Track();
    return inner.left + inner.width() * share;
}

void CProgressBar::SetValue(double to)
{
    to = to > 0 ? std::min(to, 1.0) : 0;
    SetIndeterminate(false);
    if (to == value)
        return;
    const double from = std::exchange(value, to);
    // The rounded end reaches some units back.
    const double low = FilledTo(std::min(from, to)) - highest, high = FilledTo(std::max(from, to)) + 1;
    Invalidate(
        {static_cast<std::int32_t>(std::floor(low)), 0, static_cast<std::int32_t>(std::ceil(high)), Bounds().bottom});
    Update();
}

void CProgressBar::SetIndeterminate(bool is)
{
    if (is == indeterminate)
        return;
    indeterminate = is;
    began = CApplication::Now();
    Invalidate();
    Update();
}

void CProgressBar::SetAutoHide(bool hides)
{
    autoHide = hides;
    if (!hides)
        Show(true);
    Update();
}

void CProgressBar::Update()
{
    if (autoHide)
        Show(indeterminate || (value > 0 && value < 1));
    UpdateTimer();
}

void CProgressBar::StateChanged()
{
    UpdateTimer();
    Invalidate();
}

void CProgressBar::UpdateTimer()
{
    const bool runs = indeterminate && IsVisible() && IsEnabled();
    if (runs && !timer.IsRunning())
        timer.Start();
    else if (!runs)
        timer.Stop();
}

void CProgressBar::Tick(void *bar)
{
    static_cast<CProgressBar *>(bar)->Invalidate();
}

void CProgressBar::Draw(CPort &port)
{
    const CPalette &c = CDrawTools::Colours();
    const Platform::rectangle track = port.Canvas().sharp(Track());
    const double pixel = 1 / port.Scale(), radius = track.height() / 2;
    Platform::path outline;
    outline.addRoundedRectangle(track, radius);
    port.Canvas().fill(outline, c.edge);
    const Platform::rectangle inner{track.left + pixel, track.top + pixel, track.right - pixel, track.bottom - pixel};
    port.Canvas().fillRounded(inner, radius - pixel, IsEnabled() ? c.field : c.window);
    if (!IsEnabled())
        return;

    Platform::rectangle filled = inner;
    if (indeterminate)
    {
        const double width = inner.width() * lightShare, way = inner.width() + width;
        const double part = std::fmod(CApplication::Now() - began, wayTime) / wayTime;
        filled.left = inner.left - width + way * part;
        filled.right = filled.left + width;
    }
    else
        filled.right = std::min(inner.right, FilledTo(value));
    if (filled.empty())
        return;
    Platform::path inside;
    inside.addRoundedRectangle(inner, radius - pixel);
    port.Canvas().save();
    port.Canvas().clip(inside);
    port.Canvas().fillRounded(filled, std::min(radius - pixel, filled.width() / 2), c.accentHot);
    port.Canvas().restore();
}

void CProgressBar::ReadProperties(const CLayoutPlacement &, const CWyraVariablePropertyList &properties)
{
    SetAutoHide(properties.Boolean("progress_auto_hide"));
}

} // namespace Sarnik
