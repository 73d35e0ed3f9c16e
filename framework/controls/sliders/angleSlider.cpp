#include "framework/controls/sliders/angleSlider.h"

#include "framework/layout/layoutFlags.h"

#include <algorithm>
#include <cmath>
#include <numbers>
#include <utility>

namespace Sarnik
{
namespace
{

constexpr double degree = std::numbers::pi / 180;

/// Into 0 to 360, without 360.
double turned(double angle)
{
    const double rest = std::fmod(angle, 360);
    return rest < 0 ? rest + 360 : rest;
}

/// The way between two angles, -180 to 180.
double way(double from, double to)
{
    const double d = turned(to - from);
    return d > 180 ? d - 360 : d;
}

} // namespace

CAngleSlider::CAngleSlider(const CRect &viewFrame, std::uint32_t viewOptions) : CSliderBase(viewFrame, viewOptions)
{
    SetRange(0, 359.9);
    SetQuantum(0.1);
}

void CAngleSlider::SetDialOptions(std::uint32_t bits)
{
    dialBits = bits;
    Invalidate();
}

void CAngleSlider::SetScale(double offset, double sweep)
{
    angleOffset = std::isfinite(offset) ? std::clamp(offset, -3600.0, 3600.0) : 0;
    angleRange = std::isfinite(sweep) ? std::clamp(sweep, 0.0, 360.0) : 0;
    Invalidate();
}

double CAngleSlider::MajorIncrement() const
{
    return std::max(snap / Slope(), MinorIncrement());
}

double CAngleSlider::Slope() const
{
    const double length = Range().Length();
    return angleRange > 0 && length > 0 ? angleRange / length : 1;
}

/// The last step of a full circle is the first place again: 359.9 and the quantum are as good as 360.
bool CAngleSlider::IsFullCircle() const
{
    return (Range().Length() + std::max(Quantum(), 0.0)) * Slope() >= 360 - 1e-6;
}

double CAngleSlider::AngleOf(double atValue) const
{
    const double along = angleOffset + Range().least + (atValue - Range().least) * Slope();
    return turned(Has(kAngleSlider_CW) ? -along : along);
}

double CAngleSlider::ValueOf(double angle) const
{
    const double along = (Has(kAngleSlider_CW) ? -angle : angle) - angleOffset - Range().least;
    return Range().least + turned(along) / Slope();
}

double CAngleSlider::Limited(double wanted) const
{
    if (Has(kAngleSlider_PinValue) || !IsFullCircle())
        return Range().Cut(wanted);
    if (Range().Contains(wanted))
        return wanted;
    const double circle = 360 / Slope();
    double beyond = std::fmod(wanted - Range().least, circle);
    if (beyond < 0)
        beyond += circle;
    // Rounding may have left a trace of a whole turn.
    if (circle - beyond < 1e-9)
        beyond = 0;
    const double inside = Range().least + beyond;
    if (inside <= Range().most)
        return inside;
    // Between the last value and the first.
    return inside - Range().most < circle - beyond ? Range().most : Range().least;
}

CPoint CAngleSlider::Middle() const
{
    const Platform::rectangle room = Room();
    return {room.width() / 2, room.height() / 2};
}

double CAngleSlider::Radius() const
{
    const Platform::rectangle room = Room();
    return std::max(1.0, std::floor(std::min(room.width(), room.height()) / 2) - CDrawTools::ringRoom);
}

double CAngleSlider::PointerAngle(CPoint at) const
{
    const CPoint middle = Middle();
    return turned(std::atan2(middle.y - at.y, at.x - middle.x) / degree);
}

void CAngleSlider::DragBegins(const CMouseEvent &e)
{
    turning = false;
    otherEnd = Has(kAngleSlider_BiDirectional) && std::abs(way(AngleOf(Value()), PointerAngle(e.at))) > 90;
}

double CAngleSlider::DraggedTo(CPoint at, std::uint32_t modifiers)
{
    const CPoint middle = Middle();
    // Too near to the middle to mean a direction.
    if (std::hypot(at.x - middle.x, at.y - middle.y) < 2)
        return Value();
    double angle = PointerAngle(at) + (otherEnd ? 180 : 0);
    if ((modifiers & Platform::shiftModifier) != 0)
        angle = std::round(angle / snap) * snap;
    const double wanted = ValueOf(angle), circle = 360 / Slope();
    const bool wasTurning = std::exchange(turning, true);
    if (!Has(kAngleSlider_PinValue) && IsFullCircle())
        return wanted;
    // In the gap between the ends, or across them: the end that is nearer to where the hand is.
    if (wanted <= Range().most)
    {
        const bool across = wasTurning && Has(kAngleSlider_PinValue) && std::abs(wanted - Value()) > circle / 2;
        return !across ? wanted : wanted > Value() ? Range().least : Range().most;
    }
    return wanted - Range().most < Range().least + circle - wanted ? Range().most : Range().least;
}

void CAngleSlider::Draw(CPort &port)
{
    const CPalette &colours = CDrawTools::Colours();
    Platform::canvas &canvas = port.Canvas();
    const bool enabled = IsEnabled();
    const CPoint middle = Middle();
    const double radius = Radius();
    const auto disc = [&](double r, Platform::colour ink) {
        canvas.fillEllipse({middle.x - r, middle.y - r, middle.x + r, middle.y + r}, ink);
    };
    if (ShowsRing())
        disc(radius + 1.75, colours.ring);
    disc(radius, enabled && IsHot() && !ShowsRing() ? colours.edgeLight : enabled ? colours.edge : colours.groove);
    disc(radius - 1, enabled ? colours.field : Platform::colour{78, 78, 78});

    const auto at = [&](double angle, double distance) {
        return CPoint{middle.x + distance * std::cos(angle * degree), middle.y - distance * std::sin(angle * degree)};
    };
    // Marks at quarters of a turn.
    for (int quarter = 0; quarter < 4; ++quarter)
        canvas.drawLine(at(quarter * 90, radius - 2), at(quarter * 90, radius - 4),
                        {.ink = colours.edgeLight, .width = 1});

    const double angle = AngleOf(Value()), reach = radius - 3.5;
    const Platform::colour ink = !enabled ? colours.textDim : colours.text;
    const CPoint tail = Has(kAngleSlider_BiDirectional) ? at(angle + 180, reach) : middle;
    canvas.drawLine(tail, at(angle, reach), {.ink = ink, .width = 1.5, .roundEnds = true});
    disc(2, ink);
    const auto grip = [&](CPoint p) {
        canvas.fillEllipse({p.x - 2, p.y - 2, p.x + 2, p.y + 2}, !enabled      ? colours.textDim
                                                                 : IsDragged() ? colours.ring
                                                                               : colours.accentLight);
    };
    grip(at(angle, reach));
    if (Has(kAngleSlider_BiDirectional))
        grip(tail);
}

void CAngleSlider::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CSliderBase::ReadProperties(placement, properties);
    SetDialOptions(static_cast<std::uint32_t>(ReadFlags(properties, "angle_slider")));
    SetScale(properties.Number("angle_offset"), properties.Number("angle_range"));
    CNumberFormat format;
    format.bits = kNumber_Decimal;
    format.decimals = std::clamp(properties.Integer("decimal_digits", 1), 0, 9);
    SetQuantum(format.Quantum());
}

} // namespace Sarnik
