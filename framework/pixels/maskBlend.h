#pragma once

#include "framework/pixels/memoryPixmap.h"

namespace Sarnik
{

/// Mixes a result with the source it came from, by the selection that the source carries as a plane: over what both
/// pixmaps share, `planes` planes from the first on. With m the mask as a fraction (of 255, of 32768, or the float):
/// the source's very bits at m = 0, the result's at 1, and (1 - m) * source + m * result between, cut to whole numbers
/// and to 255 or 32768 where samples are whole (floats have no limit).
///
/// Samples of 8, 16 (the host's range) or 32 bits, the same in both; otherwise throws std::invalid_argument.
void blendByMask(CBasicPixmap &result, CBasicPixmap &source, int planes, int maskPlane);

} // namespace Sarnik
