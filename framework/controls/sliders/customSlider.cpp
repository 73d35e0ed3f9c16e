#include "framework/controls/sliders/customSlider.h"

#include <algorithm>
#include <cmath>

namespace Sarnik
{
namespace
{

constexpr double grooveWidth = 4, tickLength = 4;
/// From the middle of the way to where ticks begin.
constexpr double tickDistance = CCustomSlider::knobSize / 2.0 + 2;

double between(const std::vector<CSliderResponse::knot> &knots, double at, double CSliderResponse::knot::*from,
               double CSliderResponse::knot::*to)
{
    CSliderResponse::knot low{0, 0}, high{1, 1};
    for (const CSliderResponse::knot &k : knots)
        if (k.*from <= at)
            low = k;
        else
        {
            high = k;
            break;
        }
    const double length = high.*from - low.*from;
    return length > 0 ? low.*to + (at - low.*from) * (high.*to - low.*to) / length : high.*to;
}

CRect around(CPoint centre, double radius)
{
    const auto down = [](double v) { return static_cast<std::int32_t>(std::floor(v)); };
    const auto up = [](double v) { return static_cast<std::int32_t>(std::ceil(v)); };
    return {down(centre.x - radius), down(centre.y - radius), up(centre.x + radius), up(centre.y + radius)};
}

} // namespace

CSliderResponse CSliderResponse::Linear(std::vector<knot> knots)
{
    return {[knots](double travel) { return between(knots, travel, &knot::travel, &knot::value); },
            [knots](double value) { return between(knots, value, &knot::value, &knot::travel); }};
}

void CCustomSlider::SetOrientation(orientation way)
{
    wanted = way;
    Invalidate();
}

bool CCustomSlider::IsVertical() const
{
    return wanted == orientation::vertical || (wanted == orientation::byFrame && Frame().Height() > Frame().Width());
}

void CCustomSlider::SetTicks(std::int32_t count)
{
    ticks = count;
    Invalidate();
}

void CCustomSlider::SetResponse(CSliderResponse newResponse)
{
    response = std::move(newResponse);
    Invalidate();
}

double CCustomSlider::TravelOf(double atValue) const
{
    const double length = Range().Length();
    const double share = length > 0 ? std::clamp((atValue - Range().least) / length, 0.0, 1.0) : 0;
    return response.travelOfValue ? std::clamp(response.travelOfValue(share), 0.0, 1.0) : share;
}

double CCustomSlider::ValueOf(double travel) const
{
    travel = std::clamp(travel, 0.0, 1.0);
    const double share = response.valueOfTravel ? std::clamp(response.valueOfTravel(travel), 0.0, 1.0) : travel;
    return share >= 1 ? Range().most : Range().least + share * Range().Length();
}

/// Lines of the way's middle; the rectangle has no width across.
Platform::rectangle CCustomSlider::Groove() const
{
    const Platform::rectangle room = Room();
    constexpr double end = knobSize / 2.0 + CDrawTools::ringRoom;
    const double marks = ticks >= 2 ? (tickLength + 1) / 2 : 0;
    if (IsVertical())
    {
        const double x = std::floor(room.width() / 2 - marks);
        return {x, end, x, std::max(end, room.bottom - end)};
    }
    const double y = std::floor(room.height() / 2 - marks);
    return {end, y, std::max(end, room.right - end), y};
}

CPoint CCustomSlider::Centre(double atValue) const
{
    const Platform::rectangle way = Groove();
    const double travel = TravelOf(atValue);
    if (IsVertical())
        return {way.left, way.bottom - travel * (way.bottom - way.top)};
    return {way.left + travel * (way.right - way.left), way.top};
}

CRect CCustomSlider::KnobRect(double atValue) const
{
    // With its ring, and the half pixel by which drawing may move it.
    return around(Centre(atValue), knobSize / 2.0 + CDrawTools::ringRoom + 0.5);
}

void CCustomSlider::DragBegins(const CMouseEvent &e)
{
    const CPoint centre = Centre(Value());
    const double off = IsVertical() ? e.at.y - centre.y : e.at.x - centre.x;
    const CRect knob = KnobRect(Value());
    // A press in the groove brings the knob there.
    grabbed = toCanvas(knob).contains(e.at) ? off : 0;
}

double CCustomSlider::DraggedTo(CPoint at, std::uint32_t)
{
    const Platform::rectangle way = Groove();
    const bool vertical = IsVertical();
    const double length = vertical ? way.bottom - way.top : way.right - way.left;
    const double along = vertical ? way.bottom - (at.y - grabbed) : at.x - grabbed - way.left;
    double travel = length > 0 ? std::clamp(along / length, 0.0, 1.0) : 0;
    if (std::abs(travel - TravelOf(Value())) < 1e-9)
        return Value();
    if (positions >= 2)
        travel = std::round(travel * (positions - 1)) / (positions - 1);
    return ValueOf(travel);
}

void CCustomSlider::Moved(double oldValue)
{
    const CPoint from = Centre(oldValue), to = Centre(Value());
    if (from == to)
        return;
    Invalidate(KnobRect(oldValue));
    Invalidate(KnobRect(Value()));
    const CRect a = around(from, grooveWidth / 2), b = around(to, grooveWidth / 2);
    Invalidate(
        {std::min(a.left, b.left), std::min(a.top, b.top), std::max(a.right, b.right), std::max(a.bottom, b.bottom)});
}

void CCustomSlider::Draw(CPort &port)
{
    const CPalette &colours = CDrawTools::Colours();
    Platform::canvas &canvas = port.Canvas();
    const bool enabled = IsEnabled(), vertical = IsVertical();
    const Platform::rectangle way = Groove();
    const CPoint centre = canvas.sharp(Centre(Value()));

    constexpr double half = grooveWidth / 2;
    const Platform::rectangle groove{way.left - half, way.top - half, way.right + half, way.bottom + half};
    canvas.fillRounded(groove, half, enabled ? colours.edge : colours.groove);
    Platform::rectangle filled = groove;
    (vertical ? filled.top : filled.right) = vertical ? centre.y : centre.x;
    if (enabled)
        canvas.fillRounded(
            {filled.left + 1, filled.top + (vertical ? 0 : 1), filled.right - (vertical ? 1 : 0), filled.bottom - 1},
            half - 1, colours.accentLight);

    for (std::int32_t i = 0; i < ticks && ticks >= 2; ++i)
    {
        const double t = static_cast<double>(i) / (ticks - 1);
        const CPoint at = vertical ? CPoint{way.left + tickDistance, way.bottom - t * (way.bottom - way.top)}
                                   : CPoint{way.left + t * (way.right - way.left), way.top + tickDistance};
        const CPoint end = vertical ? CPoint{at.x + tickLength - 1, at.y} : CPoint{at.x, at.y + tickLength - 1};
        CDrawTools::Line(port, at, end, enabled ? colours.textDim : colours.edgeLight);
    }

    const auto disc = [&](double radius, Platform::colour ink) {
        canvas.fillEllipse({centre.x - radius, centre.y - radius, centre.x + radius, centre.y + radius}, ink);
    };
    constexpr double radius = knobSize / 2.0;
    if (ShowsRing())
        disc(radius + 1.5, colours.ring);
    disc(radius, colours.edge);
    disc(radius - 1, !enabled      ? colours.edgeLight
                     : IsDragged() ? Platform::colour{255, 255, 255}
                     : IsHot()     ? Platform::colour{238, 238, 238}
                                   : Platform::colour{206, 206, 206});
}

CLayoutSize CCustomSlider::NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &)
{
    const std::int32_t across = knobSize + 2 * CDrawTools::ringRoom;
    const std::int32_t marks = properties.Integer("slider_ticks") >= 2 ? 6 : 0;
    constexpr std::int32_t along = 120;
    return properties.Integer("slider_orientation") == static_cast<std::int32_t>(orientation::vertical)
               ? CLayoutSize{across + marks, along}
               : CLayoutSize{along, across + marks};
}

void CCustomSlider::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CSliderBase::ReadProperties(placement, properties);
    SetOrientation(static_cast<orientation>(std::clamp(properties.Integer("slider_orientation"), 0, 2)));
    SetPositions(properties.Integer("slider_positions"));
    SetTicks(std::clamp(properties.Integer("slider_ticks"), 0, 1000));
}

} // namespace Sarnik
