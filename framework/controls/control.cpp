#include "framework/controls/control.h"

#include "framework/base/localisedString.h"

namespace Sarnik
{

void CControl::SetText(std::string text)
{
    if (text == rawText)
        return;
    rawText = std::move(text);
    label = CDrawTools::SplitLabel(Localize(rawText));
    Invalidate();
}

void CControl::SetFont(std::int32_t number)
{
    if (number == fontNumber)
        return;
    fontNumber = number;
    Invalidate();
}

void CControl::SetHot(bool isHot)
{
    if (hot == isHot)
        return;
    hot = isHot;
    Invalidate();
}

std::int32_t CControl::ReadFont(const CWyraVariablePropertyList &properties, std::string_view ownProperty)
{
    std::int32_t number = kFont_UIMedium;
    // A head's font wins over an inherited one, of whatever name.
    if (!ownProperty.empty() && properties.ReadAny({ownProperty, "control_font", "text_font"}, &number))
        return number;
    properties.ReadAny({"control_font", "text_font"}, &number);
    return number;
}

void CControl::ReadProperties(const CLayoutPlacement &, const CWyraVariablePropertyList &properties)
{
    SetText(std::string(properties.Text("text")));
    SetFont(ReadFont(properties, FontProperty()));
}

bool CControl::SendCommand(CObjID command)
{
    CCommandMessage message(command);
    return Dispatch(message);
}

} // namespace Sarnik
