#pragma once

#include "deblur/estimate/floatArray.h"

#include <cstddef>

namespace CorvaneDeblur
{

/// One plane of planar pixel memory as intensities, and back. Plane p of an array of `rows` rows begins at byte
/// p * rows * rowBytes, row r of it r * rowBytes further on; rows may start at any address. depth is 8, 16 (0..65535)
/// or 32 (float), in the machine's byte order; with any other depth nothing happens. Any thread.

/// Fills `plane` with sample / 255, sample / 65535 or the sample itself. Samples that are not finite read as 0.
void readPlane(const std::byte *memory, const floatArray &plane, int planeIndex, std::ptrdiff_t rowBytes, int depth);

/// Clamps to 0..1 (NaN to 0), multiplies by 255 or 65535 in single precision and truncates; 32 bits are stored as they
/// are after the clamp. Every 8- and 16-bit code survives being read and written.
void writePlane(const floatArray &plane, std::byte *memory, int planeIndex, std::ptrdiff_t rowBytes, int depth);

} // namespace CorvaneDeblur
