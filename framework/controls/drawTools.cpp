#include "framework/controls/drawTools.h"

#include <algorithm>
#include <cmath>

namespace Sarnik
{
namespace
{

/// The sizes of a em, by the number of the plain font of each size; kFont_System and kFont_Application are like UI.
constexpr struct
{
    std::int32_t first;
    double size;
} sizes[] = {{kFont_UI, 13}, {kFont_UILarge, 16}, {kFont_UIMedium, 12}, {kFont_UISmall, 11}, {kFont_UIMicro, 10}};

Platform::rectangle shrunk(const Platform::rectangle &r, double by)
{
    return {r.left + by, r.top + by, r.right - by, r.bottom - by};
}

double placed(double start, double room, double size, EAlign align)
{
    if (align == kAlign_Center || align == kAlign_Default)
        return start + (room - size) / 2;
    return align == kAlign_Far ? start + room - size : start;
}

char32_t lowerCase(char32_t c)
{
    return c >= U'A' && c <= U'Z' ? c + (U'a' - U'A') : c;
}

} // namespace

const CPalette &CDrawTools::Colours()
{
    static const CPalette palette;
    return palette;
}

Platform::font CDrawTools::Font(std::int32_t number)
{
    for (const auto &[first, size] : sizes)
        if (number >= first && number < first + 4)
            return {size, ((number - first) & 1) != 0, ((number - first) & 2) != 0};
    return {sizes[0].size};
}

CDrawTools::label CDrawTools::SplitLabel(std::string_view text)
{
    label result;
    for (std::size_t i = 0; i < text.size(); ++i)
    {
        if (text[i] == '&' && i + 1 < text.size())
        {
            ++i;
            const auto letter = static_cast<unsigned char>(text[i]);
            if (text[i] != '&' && result.underlined < 0 && letter > ' ' && letter < 0x80)
            {
                result.underlined = static_cast<std::ptrdiff_t>(result.text.size());
                result.key = lowerCase(letter);
            }
        }
        result.text += text[i];
    }
    return result;
}

void CDrawTools::Text(CPort &port, const Platform::rectangle &room, const Platform::textBlock &block,
                      Platform::colour ink, EAlign x, EAlign y)
{
    const double left = placed(room.left, room.width(), block.width(), x == kAlign_Default ? kAlign_Near : x);
    const double top = placed(room.top, room.height(), block.height(), y);
    // On a whole pixel the base line is as sharp as the font allows.
    const Platform::point base = port.Canvas().sharp(Platform::point{left, top + block.baseline()});
    port.Canvas().save();
    port.Canvas().clip(room);
    port.Canvas().drawText(block, {base.x, base.y - block.baseline()}, ink);
    port.Canvas().restore();
}

void CDrawTools::Text(CPort &port, const Platform::rectangle &room, const label &text, const Platform::font &font,
                      Platform::colour ink, EAlign x, EAlign y, Platform::textTrim trim)
{
    if (room.empty() || text.text.empty())
        return;
    const Platform::textBlock natural(text.text, font, {.underlined = text.underlined});
    if (trim == Platform::textTrim::none || natural.width() <= room.width())
        return Text(port, room, natural, ink, x, y);
    const Platform::textBlock trimmed(text.text, font,
                                      {.width = room.width(), .trim = trim, .underlined = text.underlined});
    Text(port, room, trimmed, ink, kAlign_Near, y);
}

void CDrawTools::Text(CPort &port, const Platform::rectangle &room, std::string_view text, const Platform::font &font,
                      Platform::colour ink, EAlign x, EAlign y, Platform::textTrim trim)
{
    Text(port, room, label{std::string(text)}, font, ink, x, y, trim);
}

void CDrawTools::Face(CPort &port, const Platform::rectangle &r, EFace state, bool prominent, double radius)
{
    const CPalette &c = Colours();
    const Platform::rectangle place = port.Canvas().sharp(r);
    Platform::colour fill = state == EFace::pressed ? c.facePressed : state == EFace::hot ? c.faceHot : c.face;
    if (prominent && state != EFace::disabled)
        fill = state == EFace::pressed ? c.accentPressed : state == EFace::hot ? c.accentHot : c.accent;
    const double line = 1 / port.Scale();
    if (state == EFace::disabled)
        fill = {88, 88, 88};
    port.Canvas().fillRounded(place, radius, state == EFace::disabled ? c.groove : c.edge);
    port.Canvas().fillRounded(shrunk(place, line), radius - line, fill);
}

void CDrawTools::Icon(CPort &port, const Platform::rectangle &room, const CIcon &icon, EAlign x, double strength)
{
    if (!icon)
        return;
    const auto [left, top] =
        port.Canvas().sharp(Platform::point{placed(room.left, room.width(), icon.Width(), x),
                                            placed(room.top, room.height(), icon.Height(), kAlign_Center)});
    port.Canvas().drawImage(*icon.pixels, icon.pixels->bounds(), {left, top, left + icon.Width(), top + icon.Height()},
                            icon.scale == port.Scale() ? Platform::sampling::nearest : Platform::sampling::smooth,
                            strength);
}

void CDrawTools::Field(CPort &port, const Platform::rectangle &r, bool enabled, bool hot)
{
    const CPalette &c = Colours();
    const Platform::rectangle place = port.Canvas().sharp(r);
    const double line = 1 / port.Scale();
    port.Canvas().fillRounded(place, corner, hot ? c.edgeLight : enabled ? c.edge : c.groove);
    port.Canvas().fillRounded(shrunk(place, line), corner - line, enabled ? c.field : Platform::colour{78, 78, 78});
}

void CDrawTools::FocusRing(CPort &port, const Platform::rectangle &r, double radius)
{
    // Whole pixels wide, at the outer end of its room.
    const double scale = port.Scale(), width = std::round(1.5 * scale) / scale;
    const double out = std::floor((ringRoom - width) * scale) / scale + width / 2;
    port.Canvas().drawRounded(shrunk(port.Canvas().sharp(r), -out), radius + out,
                              {.ink = Colours().ring, .width = width});
}

void CDrawTools::Line(CPort &port, Platform::point from, Platform::point to, Platform::colour ink)
{
    const double pixel = 1 / port.Scale();
    const auto middle = [&](Platform::point p) {
        p = port.Canvas().sharp(p);
        return Platform::point{p.x + pixel / 2, p.y + pixel / 2};
    };
    port.Canvas().drawLine(middle(from), middle(to), {.ink = ink, .width = pixel});
}

void CDrawTools::CheckMark(CPort &port, const Platform::rectangle &r, Platform::colour ink)
{
    const auto at = [&](double x, double y) { return Platform::point{r.left + x * r.width(), r.top + y * r.height()}; };
    Platform::path mark;
    mark.moveTo(at(0.22, 0.53)).lineTo(at(0.42, 0.73)).lineTo(at(0.78, 0.29));
    port.Canvas().stroke(mark,
                         {.ink = ink, .width = std::max(1.5, r.width() / 8), .roundEnds = true, .roundJoins = true});
}

void CDrawTools::Chevron(CPort &port, const Platform::rectangle &r, direction to, Platform::colour ink)
{
    const double x = (r.left + r.right) / 2, y = (r.top + r.bottom) / 2;
    constexpr double wide = 3.5, deep = 1.75;
    const bool upright = to == direction::up || to == direction::down;
    const double sign = to == direction::up || to == direction::left ? -1 : 1;
    const auto at = [&](double along, double across) {
        return upright ? Platform::point{x + along, y + sign * across} : Platform::point{x + sign * across, y + along};
    };
    Platform::path line;
    line.moveTo(at(-wide, -deep)).lineTo(at(0, deep)).lineTo(at(wide, -deep));
    port.Canvas().stroke(line, {.ink = ink, .width = 1.5, .roundEnds = true, .roundJoins = true});
}

CLayoutSize CDrawMeasure::Measure(std::string_view text, std::int32_t font) const
{
    if (text.empty())
        return {};
    const Platform::textBlock block(CDrawTools::SplitLabel(text).text, CDrawTools::Font(font), {.lines = true});
    return {static_cast<std::int32_t>(std::ceil(block.width())), static_cast<std::int32_t>(std::ceil(block.height()))};
}

} // namespace Sarnik
