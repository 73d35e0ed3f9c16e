#pragma once

#include "framework/controls/control.h"
#include "framework/controls/editPhases.h"
#include "framework/controls/fields/numberFormat.h"

namespace Sarnik
{

/// A number within a range that the user changes by dragging, by keys and by the wheel, told by CValMsg<CNumber> in the
/// phases of dragging and of editing. Escape during a drag brings back the value from before. Classes below say where
/// a value lies and how it looks.
class CSliderBase : public CControl, protected CEditPhases
{
public:
    explicit CSliderBase(const CRect &viewFrame = {}, std::uint32_t viewOptions = kView_Target | kView_TabStop)
        : CControl(viewFrame, viewOptions)
    {
    }

    double Value() const { return value; }
    /// Cut to the range, not rounded. Tells nobody.
    void SetValue(double to);
    const CNumberRange &Range() const { return range; }
    /// Ends in the wrong order count as one.
    void SetRange(double least, double most);
    /// What the user chooses is a multiple of this; 0 for anything.
    void SetQuantum(double newQuantum) { quantum = newQuantum > 0 ? newQuantum : 0; }
    double Quantum() const { return quantum; }
    /// Of the arrow keys and the wheel, and with Shift or the page keys; 0 for steps that fit the range.
    void SetIncrements(double minor, double major);
    virtual double MinorIncrement() const;
    virtual double MajorIncrement() const;

    void FocusChanged(bool has) override;
    bool MouseDown(const CMouseEvent &e) override;
    bool MouseWheel(const CMouseEvent &e) override;
    bool ReceiveKeyboard(CKeyboardMessage &message) override;

protected:
    /// slider_minimum, slider_maximum, slider_value, minor_increment, major_increment.
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;
    void SendPhase(EValuePhase phase) override { SendValue(phase, CNumber{value}); }

    /// A drag begins, before its first value. What the two points mean is up to the class.
    virtual void DragBegins(const CMouseEvent &) {}
    /// Of the pointer, in a drag; not yet rounded or cut. The value as it is where the pointer means that one.
    virtual double DraggedTo(CPoint at, std::uint32_t modifiers) = 0;
    /// A value in the range for any one.
    virtual double Limited(double wanted) const { return range.Cut(wanted); }
    double Rounded(double wanted) const;
    /// What is drawn elsewhere than before is marked. The value is the new one already.
    virtual void Moved(double) { Invalidate(); }
    /// Has the pointer's button down on it.
    bool IsDragged() const { return dragged; }
    /// The pointer or the drag looks different now.
    virtual void LookChanged() { Invalidate(); }

private:
    friend class CSliderTracker;
    /// Whether it is another value.
    bool Change(double to);
    void Step(double by) { StepTo(Rounded(value + by)); }
    void StepTo(double to);

    CNumberRange range{0, 100};
    double value = 0, quantum = 0, minorStep = 0, majorStep = 0;
    bool dragged = false;
};

} // namespace Sarnik
