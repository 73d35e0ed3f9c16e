#pragma once

#include <cstddef>
#include <cstdint>

namespace Sarnik
{

class CBasicPixmap;

/// The host's 16-bit samples run from 0 to 32768, those of computing code from 0 to 65535. The two directions are not
/// quite each other's inverse: 65534 comes from 32767 and 65535 from 32768, and each goes back there; an odd number
/// below loses its last bit.
constexpr std::uint16_t expandSample(std::uint16_t s)
{
    return static_cast<std::uint16_t>(s & 0x8000 ? 65535 : s * 2);
}
constexpr std::uint16_t compressSample(std::uint16_t s)
{
    return static_cast<std::uint16_t>(s < 65535 ? s >> 1 : 32768);
}

/// In place, n samples.
void expandSamples(std::uint16_t *samples, std::size_t n);
void compressSamples(std::uint16_t *samples, std::size_t n);

/// In place, over the first planes of a 16-bit pixmap: as many as the picture has, which is 1, 3 or 4. Any other
/// number, more than the pixmap's planes, or another depth: nothing happens.
void expandSixteenBit(CBasicPixmap &pixmap, int imagePlanes);
void compressSixteenBit(CBasicPixmap &pixmap, int imagePlanes);

} // namespace Sarnik
