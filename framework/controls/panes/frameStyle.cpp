#include "framework/controls/panes/frameStyle.h"

#include "framework/controls/drawTools.h"

namespace Sarnik
{
namespace
{

enum side : unsigned
{
    left = 1,
    top = 2,
    right = 4,
    bottom = 8
};

/// Lines along some sides, `in` pixels away from the edge.
void sides(CPort &port, const Platform::rectangle &r, unsigned which, Platform::colour ink, int in = 0)
{
    const double pixel = 1 / port.Scale(), away = in * pixel;
    const Platform::rectangle at{r.left + away, r.top + away, r.right - away, r.bottom - away};
    if (which & left)
        port.Canvas().fillRectangle({at.left, at.top, at.left + pixel, at.bottom}, ink);
    if (which & top)
        port.Canvas().fillRectangle({at.left, at.top, at.right, at.top + pixel}, ink);
    if (which & right)
        port.Canvas().fillRectangle({at.right - pixel, at.top, at.right, at.bottom}, ink);
    if (which & bottom)
        port.Canvas().fillRectangle({at.left, at.bottom - pixel, at.right, at.bottom}, ink);
}

void rounded(CPort &port, const Platform::rectangle &r, double radius, Platform::colour ink, double width)
{
    const double half = width / 2;
    port.Canvas().drawRounded({r.left + half, r.top + half, r.right - half, r.bottom - half}, radius - half,
                              {.ink = ink, .width = width});
}

void divider(CPort &port, const Platform::rectangle &r, EFrameStyle style)
{
    const CPalette &c = CDrawTools::Colours();
    const auto lines = [&](unsigned which) { sides(port, r, which, c.groove); };
    const auto shades = [&](side at) {
        sides(port, r, at, c.edge);
        sides(port, r, at, c.edgeLight.faded(0.5), 1);
    };
    switch (style)
    {
    case kDividerLeft:
        return lines(left);
    case kDividerTop:
        return lines(top);
    case kDividerRight:
        return lines(right);
    case kDividerBottom:
        return lines(bottom);
    case kDividerLeftRight:
        return lines(left | right);
    case kDividerTopBottom:
        return lines(top | bottom);
    case kDividerLeftUIB:
        return shades(left);
    case kDividerTopUIB:
        return shades(top);
    case kDividerRightUIB:
        return shades(right);
    case kDividerBottomUIB:
        return shades(bottom);
    default:
        return;
    }
}

} // namespace

EFrameStyle frameStyleOf(std::int32_t number)
{
    const bool known = (number >= kFrameEmpty && number <= kFramePlacard) ||
                       (number >= kDividerLeft && number <= kDividerTopBottom) ||
                       (number >= kDividerLeftUIB && number <= kDividerBottomUIB);
    return known ? static_cast<EFrameStyle>(number) : kFrameEmpty;
}

void drawFrame(CPort &port, const Platform::rectangle &place, EFrameStyle style, bool marked)
{
    const Platform::rectangle r = port.Canvas().sharp(place);
    const CPalette &c = CDrawTools::Colours();
    const double pixel = 1 / port.Scale();
    constexpr unsigned all = left | top | right | bottom;
    switch (style)
    {
    case kFramePrimaryGroup:
        port.Canvas().fillRounded(r, CDrawTools::corner, c.panel);
        return rounded(port, r, CDrawTools::corner, c.groove, pixel);
    case kFrameSecondaryGroup:
        return rounded(port, r, CDrawTools::corner, c.groove, pixel);
    case kFrameSolidDark:
        return sides(port, r, all, c.edge);
    case kFrameSolidGray:
    case kFrameDimBorder:
        return sides(port, r, all, c.groove);
    case kFrameSolidLight:
        return sides(port, r, all, c.edgeLight);
    case kFrameActiveBorder:
        return sides(port, r, all, c.accent);
    case kFrameOut3D:
        sides(port, r, left | top, c.edgeLight);
        return sides(port, r, right | bottom, c.edge);
    case kFrameIn3D:
        sides(port, r, left | top, c.edge);
        return sides(port, r, right | bottom, c.edgeLight);
    case kFrameScrollerWell:
        port.Canvas().fillRectangle(r, c.field);
        return sides(port, r, all, c.edge);
    case kFrameEtched:
        sides(port, r, all, c.groove);
        return sides(port, r, all, c.edgeLight.faded(0.5), 1);
    case kFrameTargetRing:
        if (marked)
            rounded(port, r, CDrawTools::corner, c.ring, 1.5);
        return;
    case kFramePlacard:
        port.Canvas().fillRectangle(r, c.face);
        return sides(port, r, all, c.edge);
    default:
        return divider(port, r, style);
    }
}

} // namespace Sarnik
