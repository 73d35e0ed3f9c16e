#include "platform/canvas/raster.h"

#include <algorithm>
#include <stdexcept>

namespace Platform
{

raster::raster(int width, int height) : columns(width), rows(height)
{
    if (width < 0 || height < 0 || width > largestSide || height > largestSide)
        throw std::length_error("raster: sides from 0 to 32767");
    pixels.resize(static_cast<std::size_t>(width) * static_cast<std::size_t>(height));
}

std::uint32_t packed(colour c)
{
    const auto times = [&](std::uint32_t v) { return (v * c.alpha + 127) / 255; };
    return std::uint32_t{c.alpha} << 24 | times(c.red) << 16 | times(c.green) << 8 | times(c.blue);
}

colour unpacked(std::uint32_t pixel)
{
    const std::uint32_t alpha = pixel >> 24;
    if (alpha == 0)
        return {0, 0, 0, 0};
    const auto whole = [&](std::uint32_t v) {
        return static_cast<std::uint8_t>(std::min<std::uint32_t>(255, ((v & 255) * 255 + alpha / 2) / alpha));
    };
    return {whole(pixel >> 16), whole(pixel >> 8), whole(pixel), static_cast<std::uint8_t>(alpha)};
}

} // namespace Platform
