#include "framework/pixels/sixteenBit.h"

#include "framework/pixels/memoryPixmap.h"
#include "platform/math/multiversion.h"

namespace Sarnik
{
namespace
{

template <class Convert> void convertPlanes(CBasicPixmap &pixmap, int imagePlanes, Convert convert)
{
    if (pixmap.GetDepth() != 16 || (imagePlanes != 1 && imagePlanes != 3 && imagePlanes != 4) ||
        imagePlanes > pixmap.GetPlaneCount())
        return;
    const CRect bounds = pixmap.Bounds();
    for (int p = 0; p < imagePlanes; ++p)
    {
        const CPixelArea plane = pixmap.Plane(p);
        for (std::int32_t y = bounds.top; y < bounds.bottom; ++y)
            convert(plane.Row<std::uint16_t>(y), static_cast<std::size_t>(bounds.Width()));
    }
}

} // namespace

STILLMARK_MULTIVERSION
void expandSamples(std::uint16_t *samples, std::size_t n)
{
    for (std::size_t i = 0; i < n; ++i)
        samples[i] = expandSample(samples[i]);
}

STILLMARK_MULTIVERSION
void compressSamples(std::uint16_t *samples, std::size_t n)
{
    // The same as compressSample in one expression without a choice of two values.
    for (std::size_t i = 0; i < n; ++i)
        samples[i] = static_cast<std::uint16_t>((samples[i] >> 1) + (samples[i] == 65535));
}

void expandSixteenBit(CBasicPixmap &pixmap, int imagePlanes)
{
    convertPlanes(pixmap, imagePlanes, expandSamples);
}

void compressSixteenBit(CBasicPixmap &pixmap, int imagePlanes)
{
    convertPlanes(pixmap, imagePlanes, compressSamples);
}

} // namespace Sarnik
