#include "framework/controls/panes/staticText.h"

#include "framework/controls/focusOrder.h"
#include "framework/layout/layoutFlags.h"

#include <cmath>

namespace Sarnik
{
namespace
{

EAlign readAlign(const CWyraVariablePropertyList &properties, std::string_view name, EAlign otherwise)
{
    std::int32_t number = 0;
    if (!properties.ReadAny({name, "text_align"}, &number) || number < kAlign_Near || number > kAlign_Full)
        return otherwise;
    return static_cast<EAlign>(number);
}

Platform::textAlign lineAlign(EAlign x)
{
    return x == kAlign_Center ? Platform::textAlign::centre
           : x == kAlign_Far  ? Platform::textAlign::right
                              : Platform::textAlign::left;
}

} // namespace

void CStaticText::SetStaticOptions(std::uint32_t bits)
{
    options = bits;
    Invalidate();
}

void CStaticText::SetAlign(EAlign x, EAlign y)
{
    alignX = x;
    alignY = y;
    Invalidate();
}

void CStaticText::SetTrim(Platform::textTrim to)
{
    trim = to;
    Invalidate();
}

void CStaticText::Press()
{
    focusNext(*this);
}

Platform::font CStaticText::DrawnFont() const
{
    Platform::font font = Font();
    font.bold = font.bold || (options & kStatic_GroupTitle) != 0;
    return font;
}

void CStaticText::Draw(CPort &port)
{
    // As far in as the faces of controls, which leave room for their focus rings.
    Platform::rectangle room = Room();
    room.left += CDrawTools::ringRoom;
    room.right -= CDrawTools::ringRoom;
    if ((options & kStatic_Wrap) == 0)
        return CDrawTools::Text(port, room, Label(), DrawnFont(), Ink(), alignX, alignY, trim);
    if (room.empty() || Label().text.empty())
        return;
    const Platform::textBlock block(
        Label().text, DrawnFont(),
        {.width = room.width(), .lines = true, .align = lineAlign(alignX), .underlined = Label().underlined});
    // A text that is too high shows its beginning.
    const EAlign y = block.height() > room.height() ? kAlign_Near : alignY;
    CDrawTools::Text(port, room, block, Ink(), kAlign_Near, y);
}

void CStaticText::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CControl::ReadProperties(placement, properties);
    options = static_cast<std::uint32_t>(ReadFlags(properties, "static_options"));
    alignX = readAlign(properties, "text_align_x", kAlign_Near);
    alignY = readAlign(properties, "text_align_y", kAlign_Center);
    if (const std::int32_t number = properties.Integer("text_trim", -1); number >= 0 && number <= 3)
        trim = static_cast<Platform::textTrim>(number);
}

CLayoutSize CStaticText::NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure)
{
    const std::string text = properties.LocalisedText("text");
    if (text.empty())
        return {};
    const auto options = static_cast<std::uint32_t>(ReadFlags(properties, "static_options"));
    std::int32_t font = ReadFont(properties, "label_font");
    // The bold font of a size follows its plain one.
    if ((options & kStatic_GroupTitle) != 0 && font >= kFont_UI && (font - kFont_UI) % 2 == 0)
        ++font;
    constexpr std::int32_t sides = 2 * CDrawTools::ringRoom;
    const std::int32_t width = properties.Integer("width");
    if ((options & kStatic_Wrap) == 0 || width <= sides)
    {
        const CLayoutSize size = measure.Measure(text, font);
        return {size.width + sides, size.height};
    }
    const Platform::textBlock block(CDrawTools::SplitLabel(text).text, CDrawTools::Font(font),
                                    {.width = static_cast<double>(width - sides), .lines = true});
    return {width, static_cast<std::int32_t>(std::ceil(block.height()))};
}

} // namespace Sarnik
