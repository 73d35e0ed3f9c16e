#pragma once

namespace CorvaneDeblur
{

/// The grey value, 0..1, that the engine sees of a colour: ITU-R BT.601 luma. Channels are 0..maximum (255, 65535 or
/// 1). Computed in double with the single-precision constants.
inline float greyValue(double red, double green, double blue, double maximum = 1.0)
{
    const double luma = 0.587f * green + 0.299f * red + 0.114f * blue;
    return static_cast<float>(luma / maximum);
}

} // namespace CorvaneDeblur
