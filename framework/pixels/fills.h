#pragma once

#include "framework/pixels/memoryPixmap.h"

namespace Sarnik
{

/// Fills of one plane. A depth other than 8, 16 and 32 bits makes them do nothing. `value` is a sample's bits: for a
/// float plane the bits of the float, for the others the low 8 or 16. Rectangles are cut to the pixmap's bounds.
void fillArea(CBasicPixmap &pixmap, int plane, const CRect &area, std::uint32_t value);

/// Everything outside of `inner`.
void fillBorder(CBasicPixmap &pixmap, int plane, const CRect &inner, std::uint32_t value);

/// Repeats the edge samples of `inner` outwards: up and down along its columns first, then left and right along the
/// whole height. An empty `inner` has no edge: nothing happens.
void replicateBorder(CBasicPixmap &pixmap, int plane, const CRect &inner);

/// The value of a sample that hides nothing: 255, 32768, or all bits set for 32 bits.
constexpr std::uint32_t opaqueValue(int depth)
{
    return depth == 8 ? 255u : depth == 16 ? 32768u : 0xffffffffu;
}

} // namespace Sarnik
