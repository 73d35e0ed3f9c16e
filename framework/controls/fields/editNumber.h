#pragma once

#include "framework/controls/fields/editString.h"
#include "framework/controls/fields/numberFormat.h"

namespace Sarnik
{

/// A field for a number. The class "CEditNumber" of layouts. The number changes by typing, by the arrow and page keys
/// (with Shift in large steps) and, while it has the focus, by the wheel. It tells by CValMsg<CNumber>: while typing
/// whenever the text is a number within the range, at the end the number cut to the range. Text that is no number
/// brings back the one from before.
class CEditNumber : public CEditString
{
public:
    using CEditString::CEditString;

    /// Exact, also where fewer digits are shown, as long as the user does not change it.
    double Number() const { return value; }
    /// Cut to the range. Tells nobody. While the user types, a number that is another one replaces the text.
    void SetNumber(double number);
    const CNumberRange &Range() const { return range; }
    /// Ends in the wrong order count as one.
    void SetRange(double least, double most);
    const CNumberFormat &Format() const { return format; }
    void SetFormat(const CNumberFormat &newFormat);
    /// 0 for steps that fit the format: 1, or a tenth where the range is small; ten times that.
    void SetIncrements(double minorStep, double majorStep);
    double MinorIncrement() const;
    double MajorIncrement() const;

    void Commit() override;
    void Restore() override;
    void FocusChanged(bool has) override;
    bool ReceiveKeyboard(CKeyboardMessage &message) override;
    bool ReceiveMessage(CMessage &message) override;
    bool MouseWheel(const CMouseEvent &e) override;

    /// As CEditString, and the format's properties: number_format, decimal_digits, text_digits, number_minimum,
    /// number_maximum, number_value, minor_increment, major_increment.
    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure);
    static CNumberFormat ReadFormat(const CWyraVariablePropertyList &properties);
    /// Room for the widest number of a range.
    static std::int32_t WidthFor(const CNumberFormat &format, const CNumberRange &range, std::int32_t font,
                                 const CTextMeasure &measure);

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;
    std::string Acceptable(std::string_view utf8) const override { return CNumberFormat::Filtered(utf8); }
    bool StepKey(const CKeyboardMessage &message) override;
    void SendPhase(EValuePhase phase) override;

private:
    double Limited(double number) const { return format.Wraps() ? range.Wrapped(number) : range.Cut(number); }
    void Take(double typed);
    void Step(double by);
    void ShowNumber();

    CNumberRange range;
    CNumberFormat format;
    double minorStep = 0, majorStep = 0;
    double value = 0, before = 0; ///< now, and what Escape comes back to
    bool stepping = false;        ///< by a key that is still down
};

} // namespace Sarnik
