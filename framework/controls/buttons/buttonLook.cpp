#include "framework/controls/buttons/buttonLook.h"

#include "framework/controls/iconSource.h"

#include <algorithm>
#include <cmath>

namespace Sarnik
{
namespace
{

constexpr double gap = 6; ///< between a mark or an icon and the label
constexpr double dimmed = 0.4;

bool isCheck(EButtonStyle style)
{
    return style == kButtonStyle_Check || style == kButtonStyle_SmallCheck;
}

bool isRadio(EButtonStyle style)
{
    return style == kButtonStyle_Radio || style == kButtonStyle_SmallRadio;
}

bool isRound(EButtonStyle style)
{
    return style == kButtonStyle_Round || style == kButtonStyle_SmallRound;
}

std::int32_t markSize(EButtonStyle style)
{
    return style == kButtonStyle_SmallCheck || style == kButtonStyle_SmallRadio ? 12 : 14;
}

Platform::rectangle shrunk(const Platform::rectangle &r, double by)
{
    return {r.left + by, r.top + by, r.right - by, r.bottom - by};
}

/// A square in the middle, of a whole number of units.
Platform::rectangle middleSquare(const Platform::rectangle &r)
{
    const double side = std::floor(std::min(r.width(), r.height()));
    const double left = r.left + std::floor((r.width() - side) / 2), top = r.top + std::floor((r.height() - side) / 2);
    return {left, top, left + side, top + side};
}

/// The same square on whole pixels, as wide as high.
Platform::rectangle sharpSquare(const CPort &port, const Platform::rectangle &square)
{
    const auto [left, top] = port.Canvas().sharp(Platform::point{square.left, square.top});
    const double side = std::round(square.width() * port.Scale()) / port.Scale();
    return {left, top, left + side, top + side};
}

} // namespace

CLayoutSize CButtonLook::Size(EButtonStyle style, CLayoutSize text, CLayoutSize icon)
{
    constexpr std::int32_t ring = 2 * CDrawTools::ringRoom;
    const bool both = text.width > 0 && icon.width > 0;
    const CLayoutSize content{text.width + icon.width + (both ? static_cast<std::int32_t>(gap) : 0),
                              std::max(text.height, icon.height)};
    switch (style)
    {
    case kButtonStyle_Check:
    case kButtonStyle_Radio:
    case kButtonStyle_SmallCheck:
    case kButtonStyle_SmallRadio:
    {
        const std::int32_t mark = markSize(style) + ring;
        const std::int32_t beside = content.width > 0 ? content.width + static_cast<std::int32_t>(gap) : 0;
        return {mark + beside, std::max(mark, content.height + 2)};
    }
    case kButtonStyle_Disclosure:
        return {std::max(16, content.width), std::max(16, content.height)};
    case kButtonStyle_None:
    case kButtonStyle_Tool:
        return {content.width + ring + 4, content.height + ring + 4};
    case kButtonStyle_Bevel:
    case kButtonStyle_Round:
    case kButtonStyle_SmallRound:
        return {content.width + ring + 8, content.height + ring + 6};
    default:
        return {std::max(64, content.width + 24) + ring, std::max(22, content.height + 8) + ring};
    }
}

Platform::colour CButtonLook::Ink() const
{
    return enabled ? CDrawTools::Colours().text : CDrawTools::Colours().textDim;
}

void CButtonLook::Draw(CPort &port, const Platform::rectangle &room) const
{
    if (isCheck(style) || isRadio(style))
    {
        const Platform::rectangle box = sharpSquare(port, Mark(room));
        DrawMark(port, box);
        DrawContent(port, {box.right + gap, room.top, room.right, room.bottom}, kAlign_Near);
        return;
    }
    if (style == kButtonStyle_Disclosure)
        return DrawDisclosure(port, room);
    const Platform::rectangle within = shrunk(room, CDrawTools::ringRoom);
    const Platform::rectangle face =
        isRound(style) ? sharpSquare(port, middleSquare(within)) : port.Canvas().sharp(within);
    DrawFace(port, face);
    DrawContent(port, shrunk(face, style == kButtonStyle_Push ? 4 : 0), kAlign_Center);
    if (ring)
        CDrawTools::FocusRing(port, face, isRound(style) ? face.height() / 2 : CDrawTools::corner);
}

Platform::rectangle CButtonLook::Mark(const Platform::rectangle &room) const
{
    const double side = markSize(style), left = room.left + CDrawTools::ringRoom;
    const double top = std::floor((room.top + room.bottom - side) / 2);
    return {left, top, left + side, top + side};
}

void CButtonLook::DrawMark(CPort &port, const Platform::rectangle &box) const
{
    const CPalette &c = CDrawTools::Colours();
    const double line = 1 / port.Scale(), radius = isRadio(style) ? box.width() / 2 : CDrawTools::corner;
    const bool on = value != kOff;
    Platform::colour edge = hot || pressed ? c.text.faded(0.75) : c.text.faded(0.5);
    Platform::colour fill = pressed ? c.facePressed : c.field;
    if (on)
        edge = fill = pressed ? c.accentPressed : hot ? c.accentHot : c.accent;
    if (!enabled)
    {
        edge = c.text.faded(0.2);
        fill = fill.faded(0);
    }
    // The edge lies over the fill: it may be transparent.
    port.Canvas().fillRounded(box, radius, fill);
    if (!on || !enabled)
        port.Canvas().drawRounded(shrunk(box, line / 2), radius - line / 2, {.ink = edge, .width = line});

    const Platform::colour ink = enabled ? Platform::colour{255, 255, 255} : c.textDim;
    if (isRadio(style) && value == kOn)
        port.Canvas().fillEllipse(shrunk(box, box.width() / 2 - 3), ink);
    else if (value == kNeutral)
        port.Canvas().fillRounded(
            {box.left + 3, (box.top + box.bottom) / 2 - 1, box.right - 3, (box.top + box.bottom) / 2 + 1}, 1, ink);
    else if (value == kOn)
        CDrawTools::CheckMark(port, box, ink);
    if (ring)
        CDrawTools::FocusRing(port, box, radius);
}

void CButtonLook::DrawDisclosure(CPort &port, const Platform::rectangle &room) const
{
    const Platform::rectangle place = shrunk(middleSquare(room), CDrawTools::ringRoom);
    if (CIconSource::Icon(icon, port.Scale()))
        DrawContent(port, room, kAlign_Center);
    else
    {
        const Platform::colour ink = Ink().faded(!enabled || hot || pressed ? 1 : 0.8);
        CDrawTools::Chevron(port, place, value == kOn ? CDrawTools::direction::down : CDrawTools::direction::right,
                            ink);
    }
    if (ring)
        CDrawTools::FocusRing(port, place);
}

void CButtonLook::DrawFace(CPort &port, const Platform::rectangle &face) const
{
    const CPalette &c = CDrawTools::Colours();
    const bool down = pressed || value == kOn;
    if (style == kButtonStyle_None)
        return;
    if (style == kButtonStyle_Tool)
    {
        if (down)
            port.Canvas().fillRounded(face, CDrawTools::corner, enabled ? c.edge : c.groove);
        else if (hot && enabled)
            port.Canvas().fillRounded(face, CDrawTools::corner, c.faceHot);
        return;
    }
    const EFace state = !enabled ? EFace::disabled : down ? EFace::pressed : hot ? EFace::hot : EFace::normal;
    CDrawTools::Face(port, face, state, prominent, isRound(style) ? face.height() / 2 : CDrawTools::corner);
}

void CButtonLook::DrawContent(CPort &port, const Platform::rectangle &room, EAlign align) const
{
    const CIcon picture = CIconSource::Icon(icon, port.Scale(), pressed ? kIconState_Pressed : kIconState_Normal);
    if (!picture)
        return CDrawTools::Text(port, room, label, font, Ink(), align);
    const double strength = !enabled ? dimmed : style == kButtonStyle_None && pressed ? 0.7 : 1;
    if (label.text.empty())
        return CDrawTools::Icon(port, {room.left + iconX, room.top + iconY, room.right + iconX, room.bottom + iconY},
                                picture, align, strength);

    const Platform::textBlock measured(label.text, font);
    const double all = picture.Width() + gap + measured.width();
    const double left = align == kAlign_Center ? std::max(room.left, (room.left + room.right - all) / 2) : room.left;
    CDrawTools::Icon(port, {left + iconX, room.top + iconY, left + picture.Width() + iconX, room.bottom + iconY},
                     picture, kAlign_Near, strength);
    CDrawTools::Text(port, {left + picture.Width() + gap, room.top, room.right, room.bottom}, label, font, Ink());
}

} // namespace Sarnik
