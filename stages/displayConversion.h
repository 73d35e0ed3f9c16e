#pragma once

#include "framework/pixels/imageMode.h"
#include "framework/pixels/memoryPixmap.h"

#include <cstdint>

namespace Sarnik
{
class CQuadConverter;
}

namespace Project
{

/// What the display conversion must know of a picture.
struct PDisplayFormat
{
    Sarnik::CImageFormat format;
    bool transparency = false;                   ///< the plane after the colours hides, and a checkerboard shows
    Sarnik::CQuadConverter *converter = nullptr; ///< for CMYK; null: a plain multiplication of the inks
};

/// Samples of the host (8, 16 or 32 bits) as packed 8-bit pixels 0xFFRRGGBB, over the whole rectangle of `to`, which
/// has one plane of 32 bits and lies within that of `from`. Lab (D50) becomes sRGB. The checkerboard is fixed to the
/// coordinates.
void ConvertForDisplay(const PDisplayFormat &about, Sarnik::CMemoryPixmap &from, Sarnik::CMemoryPixmap &to);

} // namespace Project
