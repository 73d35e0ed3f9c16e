#pragma once

#include "framework/controls/sliders/sliderBase.h"

#include <functional>
#include <vector>

namespace Sarnik
{

/// How far a knob has travelled for a value, each as a share of its range from 0 to 1: both functions rise from 0 to 1,
/// and each is the other's inverse. Empty for the same.
struct CSliderResponse
{
    std::function<double(double)> valueOfTravel, travelOfValue;

    struct knot
    {
        double travel, value;
    };
    /// Straight between knots, and to the ends. Knots rise in both.
    static CSliderResponse Linear(std::vector<knot> knots);
};

/// A knob in a groove, lying or upright. The class "CCustomSlider" of layouts. Upright, values grow upwards.
class CCustomSlider : public CSliderBase
{
public:
    enum class orientation
    {
        byFrame,
        horizontal,
        vertical
    };

    using CSliderBase::CSliderBase;

    void SetOrientation(orientation way);
    bool IsVertical() const;
    /// Places of the knob while it is dragged, evenly along its way; fewer than 2 for any place.
    void SetPositions(std::int32_t count) { positions = count; }
    /// Marks along the way, both ends included; fewer than 2 for none.
    void SetTicks(std::int32_t count);
    /// Linear without one.
    void SetResponse(CSliderResponse newResponse);

    double TravelOf(double atValue) const;
    double ValueOf(double travel) const;
    /// Where the knob is drawn for a value.
    CRect KnobRect(double atValue) const;

    void Draw(CPort &port) override;

    static constexpr std::int32_t knobSize = 12;
    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure);

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;
    void DragBegins(const CMouseEvent &e) override;
    double DraggedTo(CPoint at, std::uint32_t modifiers) override;
    void Moved(double oldValue) override;
    void LookChanged() override { Invalidate(KnobRect(Value())); }

private:
    CPoint Centre(double atValue) const;
    /// The knob's way, and where its middle may be.
    Platform::rectangle Groove() const;

    orientation wanted = orientation::byFrame;
    std::int32_t positions = 0, ticks = 0;
    CSliderResponse response;
    double grabbed = 0; ///< from the knob's middle to the pointer, along its way
};

} // namespace Sarnik
