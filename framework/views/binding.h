#pragma once

#include "framework/pixels/rect.h"

#include <cstdint>

namespace Sarnik
{

/// Where a frame goes when its parent's size changes. On each axis, of the bits sizeable, centre, near edge (left, top)
/// and far edge (right, bottom):
///
///     fixed size     near or none: stays           far: goes with the far edge
///                    centre: with the middle       centre and near, or far: with the middle of that half
///     sizeable       alone, or with one edge, or centre: grows as the parent does
///                    centre and near, or far: as that half does
///
/// Halves are rounded so that a parent that returns to its old size brings every frame back.
CRect boundFrame(const CRect &frame, std::uint32_t binding, std::int32_t oldWidth, std::int32_t oldHeight,
                 std::int32_t newWidth, std::int32_t newHeight);

} // namespace Sarnik
