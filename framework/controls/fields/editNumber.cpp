#include "framework/controls/fields/editNumber.h"

#include "framework/base/alerts.h"
#include "framework/base/localisedString.h"
#include "framework/layout/layoutFlags.h"
#include "framework/messages/notifications.h"

#include <algorithm>
#include <cmath>

namespace Sarnik
{
namespace
{

using Platform::key;

const CObjID rangeAlert("Sarnik/EditNumber/RangeAlert");

} // namespace

void CEditNumber::SetNumber(double number)
{
    const double limited = range.Cut(std::isnan(number) ? 0 : number);
    // What is being typed is not put into another form.
    if (limited == value && (IsEditing() || Value() == format.Text(value)))
        return;
    value = limited;
    if (!IsEditing())
        before = value;
    ShowNumber();
}

void CEditNumber::SetRange(double least, double most)
{
    range = {std::clamp(least, -CNumberFormat::largest, CNumberFormat::largest),
             std::clamp(most, -CNumberFormat::largest, CNumberFormat::largest)};
    range.most = std::max(range.least, range.most);
    SetNumber(value);
}

void CEditNumber::SetFormat(const CNumberFormat &newFormat)
{
    format = newFormat;
    ShowNumber();
}

void CEditNumber::SetIncrements(double newMinor, double newMajor)
{
    minorStep = newMinor > 0 ? newMinor : 0;
    majorStep = newMajor > 0 ? newMajor : 0;
}

double CEditNumber::MinorIncrement() const
{
    if (minorStep > 0)
        return minorStep;
    return std::max(format.Quantum(), range.Length() <= 10 ? 0.1 : 1.0);
}

double CEditNumber::MajorIncrement() const
{
    return majorStep > 0 ? majorStep : 10 * MinorIncrement();
}

void CEditNumber::ShowNumber()
{
    ReplaceText(format.Text(value));
    if (HasFocus())
        Select(0, Value().size());
}

/// A text that still shows the number as it is, or as it was, means that number with all its digits.
void CEditNumber::Take(double typed)
{
    if (Value() == format.Text(before))
        value = before;
    else if (Value() != format.Text(value))
        value = Limited(format.Rounded(typed));
}

void CEditNumber::SendPhase(EValuePhase phase)
{
    if (phase == kValue_Edit)
    {
        const std::optional<double> typed = CNumberFormat::Parse(Value());
        if (!typed || !range.Contains(format.Rounded(*typed)))
            return;
        Take(*typed);
    }
    if (phase == kValue_EditEnd)
        before = value;
    SendValue(phase, CNumber{value});
}

void CEditNumber::Commit()
{
    stepping = false;
    bool alert = false;
    if (IsEditing())
    {
        const std::optional<double> typed = CNumberFormat::Parse(Value());
        if (!typed)
        {
            Beep();
            value = before;
        }
        else
        {
            Take(*typed);
            alert = !range.Contains(format.Rounded(*typed)) && !format.Wraps() && !Has(kEdit_NoRangeAlert);
        }
    }
    before = value;
    if (Value() != format.Text(value))
        ShowNumber();
    // The text may change in the alert's loop: it waits until this message is through.
    if (alert)
        CNotifications::Post(*this, std::make_unique<CustomNotificationMessage>(rangeAlert));
    CEditString::Commit();
}

void CEditNumber::Restore()
{
    stepping = false;
    value = before;
    ShowNumber();
    EndEdit();
}

void CEditNumber::FocusChanged(bool has)
{
    if (has)
        before = value;
    CEditString::FocusChanged(has);
}

bool CEditNumber::ReceiveMessage(CMessage &message)
{
    if (message.Id() != rangeAlert)
        return false;
    Alerts().Show({.kind = CAlertKind::Ok,
                   .title = {},
                   .first = Localize("$$$/Sarnik/EditNumber/OutOfRange=A number from ^0 to ^1 is needed here. The "
                                     "nearest one was taken.",
                                     {format.Text(range.least), format.Text(range.most)}),
                   .second = {}});
    return true;
}

bool CEditNumber::ReceiveKeyboard(CKeyboardMessage &message)
{
    // Shift alone ends nothing.
    if (stepping && !message.IsDown() && !message.IsChar() && message.Key() != key::none)
    {
        Commit();
        return true;
    }
    return CEditString::ReceiveKeyboard(message);
}

bool CEditNumber::StepKey(const CKeyboardMessage &message)
{
    if (Has(kEdit_ReadOnly) || (message.Modifiers() & Platform::ctrlModifier) != 0)
        return false;
    const bool up = message.Key() == key::up || message.Key() == key::pageUp;
    const bool large = (message.Modifiers() & Platform::shiftModifier) != 0 || message.Key() == key::pageUp ||
                       message.Key() == key::pageDown;
    stepping = true;
    Step((up ? 1 : -1) * (large ? MajorIncrement() : MinorIncrement()));
    return true;
}

bool CEditNumber::MouseWheel(const CMouseEvent &e)
{
    if (!HasFocus() || e.wheelY == 0 || Has(kEdit_ReadOnly))
        return false;
    const double notches = WholeNotches(e.wheelY);
    if (notches == 0)
        return true;
    const std::weak_ptr<const void> alive = Life();
    Step(notches * (e.Shift() ? MajorIncrement() : MinorIncrement()));
    if (!alive.expired())
        EndEditAfterRest();
    return true;
}

void CEditNumber::Step(double by)
{
    const double old = value;
    // From what stands there.
    const std::optional<double> typed = Value() == format.Text(value) ? std::nullopt : CNumberFormat::Parse(Value());
    const double wanted = Limited(format.Rounded((typed ? *typed : value) + by));
    if (wanted == old && !typed)
        return;
    const std::weak_ptr<const void> alive = Life();
    BeginEdit();
    if (alive.expired())
        return;
    value = wanted;
    ShowNumber();
    SendValue(kValue_Edit, CNumber{value});
}

// Properties.

CNumberFormat CEditNumber::ReadFormat(const CWyraVariablePropertyList &properties)
{
    CNumberFormat format;
    format.bits = static_cast<std::uint32_t>(ReadFlags(properties, "number_format"));
    // Without a word about it, as many digits as anybody needs, or two.
    format.decimals =
        std::clamp(properties.Integer("decimal_digits", (format.bits & kNumber_FixedDecimal) != 0 ? 2 : 6), 0, 9);
    format.digits = std::clamp(properties.Integer("text_digits"), 0, 20);
    return format;
}

void CEditNumber::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CEditString::ReadProperties(placement, properties);
    SetFormat(ReadFormat(properties));
    SetRange(properties.Number("number_minimum", range.least), properties.Number("number_maximum", range.most));
    SetIncrements(properties.Number("minor_increment", properties.Number("increment")),
                  properties.Number("major_increment"));
    SetNumber(properties.Number("number_value", value));
}

std::int32_t CEditNumber::WidthFor(const CNumberFormat &format, const CNumberRange &range, std::int32_t font,
                                   const CTextMeasure &measure)
{
    const auto wide = [&](double end) {
        // Every digit is as wide as every other.
        std::string text = format.Text(std::trunc(end));
        const auto digits = static_cast<std::size_t>(std::max(0, format.digits));
        if (text.size() < digits)
            text.append(digits - text.size(), '0');
        if (format.HasFraction() && format.decimals > 0 && text.find('.') == std::string::npos)
            text += "." + std::string(static_cast<std::size_t>(std::min(format.decimals, 9)), '0');
        return measure.Measure(text, font).width;
    };
    const bool open = range.Length() >= CNumberFormat::largest;
    // Two units more: frames of views are whole, texts are not, and the caret wants room.
    return (open ? wide(-999999) : std::max(wide(range.least), wide(range.most))) + 2 + 2 * (CDrawTools::ringRoom + 5);
}

CLayoutSize CEditNumber::NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure)
{
    CLayoutSize size = CEditString::NaturalSize(properties, measure);
    std::int32_t asked = 0;
    if (properties.ReadAny({"text_width", "text_characters"}, &asked))
        return size;
    const CNumberRange unlimited;
    size.width = WidthFor(
        ReadFormat(properties),
        {properties.Number("number_minimum", unlimited.least), properties.Number("number_maximum", unlimited.most)},
        ReadFont(properties, "edit_font"), measure);
    return size;
}

} // namespace Sarnik
