#pragma once

#include "platform/canvas/geometry.h"

#include <cstddef>
#include <cstdint>
#include <vector>

namespace Platform
{

/// Pixels in memory, 32 bits each: alpha in the highest byte, then red, green, blue, the colours multiplied by the
/// alpha. Rows follow one another without a gap. Starts transparent.
class raster
{
public:
    /// The largest width and height.
    static constexpr int largestSide = 32767;

    raster() = default;
    /// Throws std::length_error where a side is negative or larger than largestSide, std::bad_alloc without room.
    raster(int width, int height);

    int width() const { return columns; }
    int height() const { return rows; }
    bool empty() const { return pixels.empty(); }
    pixelRect bounds() const { return {0, 0, columns, rows}; }
    std::size_t rowBytes() const { return static_cast<std::size_t>(columns) * sizeof(std::uint32_t); }

    std::uint32_t *row(int y)
    {
        return pixels.data() + static_cast<std::size_t>(y) * static_cast<std::size_t>(columns);
    }
    const std::uint32_t *row(int y) const { return const_cast<raster *>(this)->row(y); }

    friend bool operator==(const raster &, const raster &) = default;

private:
    int columns = 0, rows = 0;
    std::vector<std::uint32_t> pixels;
};

/// A colour as a raster holds it.
std::uint32_t packed(colour c);
/// Of a pixel, with the alpha divided out; transparent black where the alpha is 0.
colour unpacked(std::uint32_t pixel);

} // namespace Platform
