#include "framework/controls/panes/groupPane.h"

#include "framework/base/localisedString.h"
#include "framework/controls/focusOrder.h"

#include <utility>

namespace Sarnik
{
namespace
{

std::int32_t titleFont(const CWyraVariablePropertyList &properties)
{
    return properties.Integer("bold_label_font", kFont_UIMediumBold);
}

constexpr std::int32_t inset = 8 + CDrawTools::ringRoom;

} // namespace

void CGroupPane::SetText(std::string text)
{
    if (text == rawText)
        return;
    rawText = std::move(text);
    title = CDrawTools::SplitLabel(Localize(rawText));
    Invalidate();
}

void CGroupPane::Press()
{
    focusFirst(*this);
}

void CGroupPane::Draw(CPort &port)
{
    CFramePane::Draw(port);
    const CRect bounds = Bounds();
    const Platform::rectangle room{inset, 1, static_cast<double>(bounds.right - inset), titleHeight};
    CDrawTools::Text(port, room, title, CDrawTools::Font(fontNumber),
                     IsEnabled() ? CDrawTools::Colours().text : CDrawTools::Colours().textDim);
}

CLayoutSize CGroupPane::NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure)
{
    const std::string text = properties.LocalisedText("text");
    return text.empty() ? CLayoutSize{}
                        : CLayoutSize{measure.Measure(text, titleFont(properties)).width + 2 * inset, titleHeight};
}

void CGroupPane::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CFramePane::ReadProperties(placement, properties);
    SetText(std::string(properties.Text("text")));
    fontNumber = titleFont(properties);
}

} // namespace Sarnik
