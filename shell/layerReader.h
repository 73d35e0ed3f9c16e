#pragma once

#include "framework/pixels/memoryPixmap.h"
#include "shell/channelSource.h"

#include <optional>
#include <span>

namespace Sarnik
{

/// What becomes of a pixmap's pixels that the source has no samples for.
enum class CFillMode
{
    fallback = 0,  ///< the fallback source first, or the constants
    constant = 1,  ///< the constants
    replicate = 2, ///< the source's edge samples, repeated outwards
    replicateToo = 3
};

/// A sample's bits a plane, for fills; planes beyond them are 0.
using CFillConstants = std::span<const std::uint32_t>;

/// Fills all planes of a pixmap, whose rectangle is in picture coordinates: the colour planes of `source`, then
/// transparency where the pixmap has a plane for it (opaque where the source has none). `fallback` is read where the
/// source has no list or misses the rectangle. Any failed read of the host throws CAbort, silent.
void ReadLayer(CChannelSource &host, CBasicPixmap &pixmap, int source, int fallback, CFillMode fillMode,
               CFillConstants constants = {});

/// Fills one 8, 16 or 32-bit plane from a single channel: the selection, the first alpha channel, or a layer's mask.
/// What has no samples becomes `constant`. A selection that arrives with 8 bits is widened to the pixmap's depth.
void ReadMask(CChannelSource &host, CBasicPixmap &pixmap, int layer, int plane, std::uint32_t constant = 0);

/// Writes the pixmap's planes into the target's channels, over what `rect`, the pixmap and the channels share: as many
/// colour planes as both have, then transparency where `withTransparency` and both have it. A failed write throws
/// CTintorelError with the host's (negative) code, CAbort, silent, for any other number.
void WriteTarget(CChannelSource &host, CBasicPixmap &pixmap, const CRect &rect, bool withTransparency);

/// v of 0..255 to 0..32768, and to 0..1.
constexpr std::uint16_t widenSelection(std::uint8_t v)
{
    return static_cast<std::uint16_t>(((static_cast<std::uint32_t>(v) << 15) | 128u) / 255u);
}
void widenSelection(std::size_t n, const std::uint8_t *in, std::uint16_t *out);
void widenSelection(std::size_t n, const std::uint8_t *in, float *out);

} // namespace Sarnik
