#include "framework/controls/tools/zoomTracker.h"

#include "framework/views/damage.h"
#include "framework/views/view.h"

#include <algorithm>
#include <cmath>

namespace Sarnik
{

Platform::rectangle CZoomTracker::Marquee() const
{
    const CPoint a = StartPoint(), b = CurrentPoint();
    return {std::min(a.x, b.x), std::min(a.y, b.y), std::max(a.x, b.x), std::max(a.y, b.y)};
}

bool CZoomTracker::IsMarquee() const
{
    const Platform::rectangle r = Marquee();
    return r.width() >= threshold || r.height() >= threshold;
}

void CZoomTracker::Draw(CPort &port) const
{
    if (!Running() || !IsMarquee())
        return;
    const Platform::rectangle r = port.Canvas().sharp(Marquee());
    const Platform::rectangle line{r.left + 0.5, r.top + 0.5, r.right + 0.5, r.bottom + 0.5};
    constexpr double dash = 4;
    port.Canvas().drawRectangle(line, {.ink = {0, 0, 0}, .dashes = {dash, dash}});
    port.Canvas().drawRectangle(line, {.ink = {255, 255, 255}, .dashes = {dash, dash}, .dashOffset = dash});
}

void CZoomTracker::Mark()
{
    if (View() == nullptr)
        return;
    const Platform::rectangle r = Marquee();
    const auto whole = [](double v) { return static_cast<std::int32_t>(v); };
    const CRect now{whole(std::floor(r.left)) - 1, whole(std::floor(r.top)) - 1, whole(std::ceil(r.right)) + 2,
                    whole(std::ceil(r.bottom)) + 2};
    View()->Invalidate(joined(std::exchange(marked, now), now));
}

void CZoomTracker::Track()
{
    Mark();
}

void CZoomTracker::End(bool)
{
    Mark();
}

} // namespace Sarnik
