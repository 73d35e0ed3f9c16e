#pragma once

#include <cstdint>

namespace Platform
{

/// Drawing coordinates: x to the right, y down, in view units; a unit is `scale` pixels of the raster.
struct point
{
    double x = 0, y = 0;

    friend bool operator==(const point &, const point &) = default;
};

/// From (left, top) to (right, bottom); empty where it ends before it begins.
struct rectangle
{
    double left = 0, top = 0, right = 0, bottom = 0;

    double width() const { return right > left ? right - left : 0; }
    double height() const { return bottom > top ? bottom - top : 0; }
    bool empty() const { return !(right > left && bottom > top); }
    bool contains(point p) const { return p.x >= left && p.x < right && p.y >= top && p.y < bottom; }

    friend bool operator==(const rectangle &, const rectangle &) = default;
};

/// Pixels left..right-1, top..bottom-1 of a raster.
struct pixelRect
{
    int left = 0, top = 0, right = 0, bottom = 0;

    int width() const { return right > left ? right - left : 0; }
    int height() const { return bottom > top ? bottom - top : 0; }
    bool empty() const { return right <= left || bottom <= top; }

    friend bool operator==(const pixelRect &, const pixelRect &) = default;
};

/// A colour of the screen's own space (sRGB), alpha not multiplied in.
struct colour
{
    std::uint8_t red = 0, green = 0, blue = 0, alpha = 255;

    /// The same with `share` (0 to 1) of its opacity.
    colour faded(double share) const
    {
        return {red, green, blue, static_cast<std::uint8_t>(alpha * (share < 0 ? 0 : share > 1 ? 1 : share) + 0.5)};
    }

    friend bool operator==(const colour &, const colour &) = default;
};

} // namespace Platform
