#include "framework/controls/scrolling/scrollerGeometry.h"

#include "framework/controls/drawTools.h"

#include <algorithm>

namespace Sarnik
{

CScrollerGeometry CScrollerGeometry::Arrange(CLayoutSize room, std::uint32_t attributes, std::int32_t barThickness,
                                             const gaps &gap, bool x, bool y)
{
    CScrollerGeometry g;
    CRect inside{0, 0, std::max(0, room.width), std::max(0, room.height)};
    const auto shrink = [](const CRect &r, std::int32_t by) {
        const std::int32_t left = std::min(r.left + by, r.right), top = std::min(r.top + by, r.bottom);
        return CRect{left, top, std::max(left, r.right - by), std::max(top, r.bottom - by)};
    };
    if ((attributes & kScroller_WellFrame) != 0)
    {
        g.frame = shrink(inside, CDrawTools::ringRoom);
        inside = shrink(g.frame, 1);
    }
    const std::int32_t right = y ? std::max(inside.left, inside.right - barThickness) : inside.right;
    const std::int32_t bottom = x ? std::max(inside.top, inside.bottom - barThickness) : inside.bottom;
    g.well = {inside.left, inside.top, right, bottom};

    std::int32_t cornerLeft = right, cornerTop = bottom;
    // The bar and its gaps share the edge of the well; a gap gets what it wants as long as there is something.
    const bool box = (attributes & kScroller_SizeBox) != 0;
    if (x)
    {
        const std::int32_t end = box && !y ? std::max(inside.left, inside.right - barThickness) : right;
        const std::int32_t from = std::min(inside.left + std::max(0, gap.left), end);
        const std::int32_t to = std::max(from, end - std::max(0, gap.right));
        g.gapLeft = {inside.left, bottom, from, inside.bottom};
        g.xBar = {from, bottom, to, inside.bottom};
        g.gapRight = {to, bottom, end, inside.bottom};
        cornerLeft = end;
    }
    if (y)
    {
        const std::int32_t end = box && !x ? std::max(inside.top, inside.bottom - barThickness) : bottom;
        const std::int32_t from = std::min(inside.top + std::max(0, gap.top), end);
        const std::int32_t to = std::max(from, end - std::max(0, gap.bottom));
        g.gapTop = {right, inside.top, inside.right, from};
        g.yBar = {right, from, inside.right, to};
        g.gapBottom = {right, to, inside.right, end};
        cornerTop = end;
    }
    if (x || y)
        g.corner = {cornerLeft, cornerTop, inside.right, inside.bottom};
    return g;
}

} // namespace Sarnik
