#include "framework/controls/sliders/sliderBase.h"

#include "framework/views/tracker.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace Sarnik
{

using Platform::key;

/// From the press to the release.
class CSliderTracker final : public CTracker
{
public:
    explicit CSliderTracker(CSliderBase &of) : CTracker(of), slider(of), life(of.Life()) {}

protected:
    bool Begin() override
    {
        before = slider.value;
        slider.dragged = true;
        slider.LookChanged();
        slider.SendPhase(kValue_DragBegin);
        if (life.expired())
            return false;
        Track();
        return !life.expired();
    }

    void Track() override
    {
        const double to = slider.DraggedTo(CurrentPoint(), Modifiers());
        if (to != slider.value && slider.Change(slider.Rounded(to)))
            slider.SendPhase(kValue_Drag);
    }

    void End(bool givenUp) override
    {
        if (life.expired())
            return;
        slider.dragged = false;
        slider.LookChanged();
        if (givenUp)
            slider.Change(before);
        slider.SendPhase(kValue_DragEnd);
    }

private:
    CSliderBase &slider;
    std::weak_ptr<const void> life;
    double before = 0;
};

void CSliderBase::SetValue(double to)
{
    Change(range.Cut(to));
}

void CSliderBase::SetRange(double least, double most)
{
    least = std::clamp(std::isnan(least) ? 0 : least, -CNumberFormat::largest, CNumberFormat::largest);
    most = std::clamp(std::isnan(most) ? 0 : most, least, CNumberFormat::largest);
    if (range.least == least && range.most == most)
        return;
    range = {least, most};
    value = range.Cut(value);
    Invalidate();
}

void CSliderBase::SetIncrements(double minor, double major)
{
    minorStep = minor > 0 ? minor : 0;
    majorStep = major > 0 ? major : 0;
}

double CSliderBase::MinorIncrement() const
{
    if (minorStep > 0)
        return minorStep;
    return std::max(quantum, range.Length() <= 10 ? range.Length() / 100 : 1);
}

double CSliderBase::MajorIncrement() const
{
    return majorStep > 0 ? majorStep : 10 * MinorIncrement();
}

double CSliderBase::Rounded(double wanted) const
{
    if (quantum <= 0)
        return Limited(wanted);
    // By whole numbers: 3499 / 10 is 349.9, 3499 * 0.1 is not.
    const double parts = std::round(1 / quantum);
    const bool whole = quantum < 1 && std::abs(parts * quantum - 1) < 1e-9;
    return Limited(whole ? std::round(wanted * parts) / parts : std::round(wanted / quantum) * quantum);
}

bool CSliderBase::Change(double to)
{
    if (to == value || std::isnan(to))
        return false;
    const double old = std::exchange(value, to);
    Moved(old);
    return true;
}

void CSliderBase::StepTo(double to)
{
    if (to == value)
        return;
    const std::weak_ptr<const void> alive = Life();
    BeginEdit();
    if (alive.expired())
        return;
    Change(to);
    Edited();
}

void CSliderBase::FocusChanged(bool has)
{
    CControl::FocusChanged(has);
    if (!has)
        EndEdit();
}

bool CSliderBase::MouseDown(const CMouseEvent &e)
{
    const std::weak_ptr<const void> alive = Life();
    EndEdit();
    if (alive.expired())
        return true;
    DragBegins(e);
    CSliderTracker tracker(*this);
    tracker.Run(e);
    return true;
}

bool CSliderBase::MouseWheel(const CMouseEvent &e)
{
    const double turned = e.wheelY != 0 ? e.wheelY : e.wheelX, notches = WholeNotches(turned);
    if (notches == 0)
        return turned != 0;
    const std::weak_ptr<const void> alive = Life();
    Step(notches * (e.Shift() ? MajorIncrement() : MinorIncrement()));
    if (!alive.expired())
        EndEditAfterRest();
    return true;
}

bool CSliderBase::ReceiveKeyboard(CKeyboardMessage &message)
{
    constexpr std::uint32_t others = Platform::altModifier | Platform::ctrlModifier;
    if (!IsEnabled() || message.IsChar() || (message.Modifiers() & others) != 0)
        return false;
    if (!message.IsDown())
    {
        // Shift alone ends nothing.
        const std::weak_ptr<const void> alive = Life();
        if (message.Key() != key::none)
            EndEdit();
        return alive.expired();
    }
    const bool large = (message.Modifiers() & Platform::shiftModifier) != 0;
    const double step = large ? MajorIncrement() : MinorIncrement();
    switch (message.Key())
    {
    case key::left:
    case key::down:
        Step(-step);
        return true;
    case key::right:
    case key::up:
        Step(step);
        return true;
    case key::pageDown:
        Step(-MajorIncrement());
        return true;
    case key::pageUp:
        Step(MajorIncrement());
        return true;
    case key::home:
        StepTo(range.least);
        return true;
    case key::end:
        StepTo(range.most);
        return true;
    default:
        return false;
    }
}

void CSliderBase::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CControl::ReadProperties(placement, properties);
    SetRange(properties.Number("slider_minimum", range.least), properties.Number("slider_maximum", range.most));
    SetIncrements(properties.Number("minor_increment", properties.Number("increment")),
                  properties.Number("major_increment"));
    SetValue(properties.Number("slider_value", value));
}

} // namespace Sarnik
