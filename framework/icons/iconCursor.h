#pragma once

#include "platform/window/display.h"

#include <cstdint>

namespace Sarnik
{

/// The cursor that looks as the icon of a number (iconNames.h) and points with its hot spot, for a screen of `scale`
/// pixels a view unit. Where there is no such icon it is a shape of the display's own, an arrow at worst. Interface
/// thread.
struct CIconCursor : Platform::cursor
{
    explicit CIconCursor(std::uint32_t id, double scale = 1);
};

} // namespace Sarnik
