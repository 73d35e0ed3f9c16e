#pragma once

namespace CorvaneDeblur
{

/// A rectangle of source image pixels.
struct regionRect
{
    int x = 0;
    int y = 0;
    int width = 0;
    int height = 0;

    bool empty() const { return width <= 0 || height <= 0; }
    int centreX() const { return x + width / 2; }
    int centreY() const { return y + height / 2; }

    friend bool operator==(const regionRect &, const regionRect &) = default;
};

/// A pixel of the source image.
struct imagePoint
{
    int x = 0;
    int y = 0;
};

} // namespace CorvaneDeblur
