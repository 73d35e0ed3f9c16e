#pragma once

#include <bit>
#include <cstdint>

namespace CorvaneDeblur
{

/// exp(x) to 2 units in the last place for x in -87..88, outside clamped to that range; NaN gives some number in it.
/// Without branches and tables, so loops that call it vectorise. Argument reduction by Cody and Waite ("Software
/// Manual for the Elementary Functions", 1980), the polynomial of degree 5 is the minimax one of Cephes' expf.
inline float fastExp(float x)
{
    x = x < 88.0f ? x : 88.0f;
    x = x > -87.0f ? x : -87.0f;
    // Adding 1.5 * 2^23 rounds to the nearest integer and leaves it in the low bits of the sum.
    const float shifted = x * 1.44269504088896341f + 12582912.0f;
    const float n = shifted - 12582912.0f;
    const float r = (x - n * 0.693359375f) + n * 2.12194440e-4f;
    float p = 1.9875691500e-4f;
    p = p * r + 1.3981999507e-3f;
    p = p * r + 8.3334519073e-3f;
    p = p * r + 4.1665795894e-2f;
    p = p * r + 1.6666665459e-1f;
    p = p * r + 5.0000001201e-1f;
    const float mantissa = p * r * r + r + 1.0f;
    const std::uint32_t exponent = (std::bit_cast<std::uint32_t>(shifted) - 0x4B400000u + 127u) << 23;
    return mantissa * std::bit_cast<float>(exponent);
}

} // namespace CorvaneDeblur
