#include "framework/icons/iconCursor.h"

#include "framework/icons/iconNames.h"
#include "framework/icons/programIcons.h"

namespace Sarnik
{
namespace
{

Platform::cursorShape nearestShape(std::uint32_t id)
{
    using enum Platform::cursorShape;
    switch (id)
    {
    case kCursor_Region:
    case kCursor_Direction:
        return cross;
    case kCursor_Hand:
    case kCursor_HandClosed:
        return hand;
    case kCursor_SizeVertical:
        return sizeVertical;
    case kCursor_SizeHorizontal:
        return sizeHorizontal;
    case kCursor_SizeFalling:
        return sizeFalling;
    case kCursor_SizeRising:
        return sizeRising;
    case kCursor_Move:
    case kCursor_MoveEnd:
        return move;
    default:
        return arrow;
    }
}

} // namespace

CIconCursor::CIconCursor(std::uint32_t id, double scale)
{
    shape = nearestShape(id);
    auto picture = CProgramIcons::Get()->OnScreen(id, scale);
    image = std::move(picture.pixels);
    hotX = picture.hotX;
    hotY = picture.hotY;
}

} // namespace Sarnik
