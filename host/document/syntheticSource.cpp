#include "host/document/syntheticSource.h"

#include "platform/math/multiversion.h"

#include <cassert>
#include <cstdlib>

namespace Stillmark
{
namespace
{

/// Spreads the bits of a number over the whole word: multiplications by odd numbers, and shifts, neither of which two
/// numbers can come out of alike. The constants are arbitrary ones without pattern.
inline std::uint32_t mixed(std::uint32_t h)
{
    h = (h ^ h >> 16) * 0x7feb352du;
    h = (h ^ h >> 15) * 0x846ca68bu;
    return h ^ h >> 16;
}

/// A triangle of period 65536 and height 0 to 32767.
inline std::uint32_t triangle(std::uint32_t phase)
{
    phase &= 0xffff;
    return phase < 0x8000 ? phase : 0xffff - phase;
}

/// What a row's pixels have in common.
struct rowPattern
{
    std::uint32_t key;           ///< of the noise
    std::uint32_t along, across; ///< phases of the waves at x 0
    std::uint32_t slope;         ///< how fast the first wave goes on
};

/// From 0 to 65535: two waves that fill three quarters of the range, noise in the rest.
inline std::uint32_t code16(const rowPattern &row, std::uint32_t x)
{
    const std::uint32_t waves = triangle(row.along + x * row.slope) + triangle(row.across - x * 23);
    return (waves * 3 >> 2) + (mixed(row.key + x) >> 18);
}

// Separately per depth, because what is compiled twice can be no template.
STILLMARK_MULTIVERSION
void fillRow(const rowPattern &row, std::uint32_t x, int count, std::uint8_t *out)
{
    for (int i = 0; i < count; ++i)
        out[i] = static_cast<std::uint8_t>(code16(row, x + static_cast<std::uint32_t>(i)) >> 8);
}

STILLMARK_MULTIVERSION
void fillRow(const rowPattern &row, std::uint32_t x, int count, std::uint16_t *out)
{
    for (int i = 0; i < count; ++i)
        out[i] = static_cast<std::uint16_t>(code16(row, x + static_cast<std::uint32_t>(i)));
}

STILLMARK_MULTIVERSION
void fillRow(const rowPattern &row, std::uint32_t x, int count, float *out)
{
    for (int i = 0; i < count; ++i)
        out[i] = static_cast<float>(static_cast<std::int32_t>(code16(row, x + static_cast<std::uint32_t>(i)))) / 65535;
}

} // namespace

planeSamples syntheticSource::plane(int number, const rectangle &area)
{
    assert(number >= 0 && number < planes() && area.x >= 0 && area.y >= 0 && area.x + area.width <= s.width &&
           area.y + area.height <= s.height);
    const std::size_t rowBytes = static_cast<std::size_t>(area.width) * static_cast<std::size_t>(sampleBytes());
    if (number == lastPlane && area.x == lastArea.x && area.y == lastArea.y && area.width == lastArea.width &&
        area.height == lastArea.height)
        return {samples.data(), rowBytes};

    samples.resize(rowBytes * static_cast<std::size_t>(area.height));
    const std::uint32_t ofPlane = mixed(s.seed * 64 + static_cast<std::uint32_t>(number) + 1);
    for (int y = area.y; y < area.y + area.height; ++y)
    {
        const auto row = static_cast<std::uint32_t>(y);
        const rowPattern pattern{mixed(ofPlane + row), ofPlane + row * 31, (ofPlane >> 16) + row * 61,
                                 11 + ofPlane % 13};
        std::byte *to = samples.data() + static_cast<std::size_t>(y - area.y) * rowBytes;
        const auto x = static_cast<std::uint32_t>(area.x);
        if (s.depth == 8)
            fillRow(pattern, x, area.width, reinterpret_cast<std::uint8_t *>(to));
        else if (s.depth == 16)
            fillRow(pattern, x, area.width, reinterpret_cast<std::uint16_t *>(to));
        else
            fillRow(pattern, x, area.width, reinterpret_cast<float *>(to));
    }
    lastPlane = number;
    lastArea = area;
    return {samples.data(), rowBytes};
}

} // namespace Stillmark
