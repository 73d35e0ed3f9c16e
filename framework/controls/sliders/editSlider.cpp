#include "framework/controls/sliders/editSlider.h"

#include "framework/base/localisedString.h"

#include <algorithm>

namespace Sarnik
{
namespace
{

const CViewID sliderId("Sarnik/EditSlider/Slider"), fieldId("Sarnik/EditSlider/Field");

constexpr std::int32_t gap = 4, naturalTravel = 120;

CNumberRange rangeOf(const CWyraVariablePropertyList &properties)
{
    return {properties.Number("slider_minimum", 0), properties.Number("slider_maximum", 100)};
}

CNumberFormat formatOf(const CWyraVariablePropertyList &properties)
{
    CNumberFormat format = CEditNumber::ReadFormat(properties);
    format.decimals = std::min(properties.Integer("decimal_digits", 1), 9);
    return format;
}

std::int32_t fieldWidthOf(const CWyraVariablePropertyList &properties, std::int32_t font, const CTextMeasure &measure)
{
    // Numbers of several sliders in a column are alike where they differ by a digit only.
    constexpr std::int32_t usual = 54;
    return std::max(usual, CEditNumber::WidthFor(formatOf(properties), rangeOf(properties), font, measure));
}

} // namespace

CEditSlider::CEditSlider(const CRect &viewFrame, std::uint32_t viewOptions)
    : CControl(viewFrame, viewOptions), slider(&Make<CCustomSlider>(CRect{}, kView_Target)),
      field(&Make<CEditNumber>(CRect{}, kView_Target | kView_TabStop))
{
    slider->SetId(sliderId);
    slider->SetOrientation(CCustomSlider::orientation::horizontal);
    field->SetId(fieldId);
    field->SetRange(0, 100);
    field->SetNumber(0);
    slider->SetQuantum(field->Format().Quantum());
    Arrange();
}

void CEditSlider::SetValue(double to)
{
    slider->SetValue(to);
    field->SetNumber(slider->Value());
}

void CEditSlider::SetRange(double least, double most)
{
    slider->SetRange(least, most);
    field->SetRange(slider->Range().least, slider->Range().most);
}

void CEditSlider::SetFormat(const CNumberFormat &format)
{
    field->SetFormat(format);
    slider->SetQuantum(format.Quantum());
}

bool CEditSlider::ReceiveValue(CValueMessage &message)
{
    const auto *const number = dynamic_cast<CValMsg<CNumber> *>(&message);
    if (number == nullptr || (message.Id() != sliderId && message.Id() != fieldId))
        return false;
    if (message.Id() == sliderId)
        field->SetNumber(number->Value().value);
    else
        slider->SetValue(number->Value().value);
    SendValue(message.Phase(), number->Value());
    return true;
}

void CEditSlider::Arrange()
{
    const CRect room = Bounds();
    const std::int32_t left = std::max(room.left, room.right - fieldWidth);
    field->SetFrame({left, room.top, room.right, room.bottom});
    const std::int32_t begin = labelWidth > 0 ? labelWidth + gap : 0;
    slider->SetFrame({begin, room.top, std::max(begin, left - gap), room.bottom});
}

void CEditSlider::Draw(CPort &port)
{
    if (labelWidth <= 0)
        return;
    const Platform::rectangle room = Room();
    CDrawTools::Text(port, {room.left, room.top, room.left + labelWidth, room.bottom}, Label(), Font(), Ink(),
                     kAlign_Far);
}

CLayoutSize CEditSlider::NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure)
{
    const std::int32_t font = ReadFont(properties, {});
    const std::int32_t label = measure.Measure(properties.LocalisedText("text"), font).width;
    return {(label > 0 ? label + gap : 0) + naturalTravel + gap + fieldWidthOf(properties, font, measure),
            CEditString::naturalHeight};
}

void CEditSlider::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CControl::ReadProperties(placement, properties);
    const CDrawMeasure measure;
    field->SetFont(FontNumber());
    fieldWidth = fieldWidthOf(properties, FontNumber(), measure);
    const std::int32_t own = measure.Measure(Localize(Text()), FontNumber()).width;
    labelWidth = Text().empty() ? 0 : std::max(placement.labelWidth, own);
    SetFormat(formatOf(properties));
    const CNumberRange range = rangeOf(properties);
    SetRange(range.least, range.most);
    slider->SetPositions(properties.Integer("slider_positions"));
    const double minor = properties.Number("minor_increment", properties.Number("increment"));
    const double major = properties.Number("major_increment");
    slider->SetIncrements(minor, major);
    field->SetIncrements(minor, major);
    SetValue(properties.Number("slider_value", properties.Number("number_value", range.least)));
    Arrange();
}

} // namespace Sarnik
