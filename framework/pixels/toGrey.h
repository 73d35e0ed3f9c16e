#pragma once

#include "framework/pixels/imageMode.h"
#include "framework/pixels/memoryPixmap.h"

namespace Sarnik
{

/// Above what a raw sample counts as clipped. For no masking at all: of(255).
struct CMaskLimits
{
    std::uint8_t byte = 255;
    std::uint16_t word = 65535; ///< compared with samples as the host gives them, before expansion
    float real = 1.0f;

    static CMaskLimits of(std::uint8_t m)
    {
        return {m, static_cast<std::uint16_t>(m * 257), static_cast<float>(m) / 255.0f};
    }
};

/// Turns interleaved pixels of four samples from CMYK to RGB in place (the fourth sample is then without meaning).
/// Throws where the conversion fails.
class CQuadConverter
{
public:
    virtual void CmykToRgb(std::uint8_t *quads, std::size_t pixels) = 0;
    virtual void CmykToRgb(std::uint16_t *quads, std::size_t pixels) = 0;

protected:
    ~CQuadConverter() = default;
};

/// What surrounds the pixels of a grey conversion.
struct CGreySource
{
    CPixelKind kind = CPixelKind::rgb;
    bool hasMask = false;                ///< the source has the selection as one plane more
    CQuadConverter *converter = nullptr; ///< null: CMYK samples count as RGB
    CMaskLimits limits;
};

/// Grey values for the estimation of what `area`, the source and `grey` (64 bits, one plane) share, and where `mask` (8
/// bits, over at least the same rectangle) is given, 1 at clipped samples and 0 elsewhere. The source carries the
/// picture's planes, transparency, and the selection if hasMask:
///
/// | kind  | planes      | depths    | grey                                  |
/// | RGB   | 4 + hasMask | 8, 16, 32 | (0.299 R + 0.587 G + 0.114 B) / range |
/// | Lab   | 4 + hasMask | 8, 16     | first plane / range                   |
/// | other | 2 + hasMask | 8, 16, 32 | first plane / range                   |
/// | other | 5 + hasMask | 8, 16     | converted from CMYK, then as RGB      |
///
/// False, with nothing done, for any other combination.
bool ToGrey(CPixmap &source, const CRect &area, const CGreySource &about, CMemoryPixmap &grey,
            CMemoryPixmap *mask = nullptr);

} // namespace Sarnik
