#pragma once

#include "framework/controls/sliders/sliderBase.h"

namespace Sarnik
{

/// How a dial turns; values are those of kAngleSlider_... in layouts.
enum EAngleSlider : std::uint32_t
{
    kAngleSlider_CCW = 0,
    kAngleSlider_CW = 1,
    kAngleSlider_BiDirectional = 2, ///< the hand has two ends; either can be taken
    kAngleSlider_PinValue = 4       ///< a drag stops at the ends of the range instead of going round
};

/// A dial with a hand. The class "CAngleSlider" of layouts. A value in degrees is an angle from the right, growing
/// counter-clockwise, unless told otherwise. With Shift a drag stops at multiples of 15 degrees. A press inside turns
/// the hand there.
class CAngleSlider : public CSliderBase
{
public:
    explicit CAngleSlider(const CRect &viewFrame = {}, std::uint32_t viewOptions = kView_Target | kView_TabStop);

    static constexpr double snap = 15;

    void SetDialOptions(std::uint32_t bits);
    /// Where the least value points, less that value, in degrees in the sense of turning; and how many degrees the
    /// whole range takes, 0 for as many as it is long.
    void SetScale(double offset, double sweep);

    /// Degrees counter-clockwise from the right.
    double AngleOf(double atValue) const;
    double ValueOf(double angle) const;

    double MajorIncrement() const override;

    void Draw(CPort &port) override;

    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &, const CTextMeasure &) { return {32, 32}; }

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;
    void DragBegins(const CMouseEvent &e) override;
    double DraggedTo(CPoint at, std::uint32_t modifiers) override;
    double Limited(double wanted) const override;

private:
    bool Has(EAngleSlider bit) const { return (dialBits & bit) != 0; }
    /// Degrees that one unit of the value takes.
    double Slope() const;
    bool IsFullCircle() const;
    CPoint Middle() const;
    double Radius() const;
    /// Degrees counter-clockwise from the right.
    double PointerAngle(CPoint at) const;

    std::uint32_t dialBits = 0;
    double angleOffset = 0, angleRange = 0;
    bool turning = false;  ///< since the press, which may have been anywhere
    bool otherEnd = false; ///< of the hand is being dragged
};

} // namespace Sarnik
