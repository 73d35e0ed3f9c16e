#include "stages/render/renderRectangle.h"

#include "framework/pixels/sixteenBit.h"
#include "platform/math/alignedBuffer.h"

#include <algorithm>
#include <cstring>

namespace Project
{

using CorvaneDeblur::alignedBuffer;
using Sarnik::CMemoryPixmap;
using Sarnik::CRect;

namespace
{

/// Whole planes of the source in a row, as the estimator wants them: rows of the same pitch.
class planeRun
{
public:
    planeRun(const CMemoryPixmap &source, int firstPlane, int planeCount)
        : bounds(source.Bounds()), first(firstPlane), planes(planeCount), pitch(source.RowBytes()),
          bytes(static_cast<std::size_t>(pitch * bounds.Height()) * static_cast<std::size_t>(planes)), results(bytes)
    {
    }

    void Deconvolve(const CMemoryPixmap &source, CorvaneDeblur::latentEstimator &estimator, int originX, int originY,
                    bool expand)
    {
        const std::byte *samples = source.PlaneData(first);
        alignedBuffer<std::byte> expanded;
        if (expand)
        {
            expanded = alignedBuffer<std::byte>(bytes);
            std::memcpy(expanded.data(), samples, bytes);
            Sarnik::expandSamples(reinterpret_cast<std::uint16_t *>(expanded.data()), bytes / 2);
            samples = expanded.data();
        }
        estimator.deconvolve(samples, results.data(), originX, originY, static_cast<int>(bounds.Width()),
                             static_cast<int>(bounds.Height()), planes, pitch, pitch, source.GetDepth());
    }

    /// Copies what the destination wants of the results.
    void Deliver(CMemoryPixmap &destination, bool compress) const
    {
        const CRect wanted = destination.Bounds().Intersected(bounds);
        const std::ptrdiff_t sampleBytes = destination.GetDepth() / 8;
        const auto samples = static_cast<std::size_t>(wanted.Width());
        for (int plane = 0; plane < planes; ++plane)
        {
            const Sarnik::CPixelArea to = destination.Plane(first + plane);
            for (std::int32_t y = wanted.top; y < wanted.bottom; ++y)
            {
                const std::byte *from = results.data() + (plane * bounds.Height() + y - bounds.top) * pitch +
                                        (wanted.left - bounds.left) * sampleBytes;
                std::byte *row = to.Row<std::byte>(y) + (wanted.left - to.rect.left) * sampleBytes;
                std::memcpy(row, from, samples * static_cast<std::size_t>(sampleBytes));
                if (compress)
                    Sarnik::compressSamples(reinterpret_cast<std::uint16_t *>(row), samples);
            }
        }
    }

private:
    const CRect bounds;
    const int first, planes;
    const std::ptrdiff_t pitch;
    const std::size_t bytes;
    alignedBuffer<std::byte> results;
};

} // namespace

void renderRectangle(const renderSettings &settings, CorvaneDeblur::latentEstimator &estimator,
                     CMemoryPixmap &destination, CMemoryPixmap &source, int originX, int originY, int colourPlanes)
{
    // The host's samples end at 32768, the estimator's at 65535; pictures of two planes are not converted.
    const bool sixteen = source.GetDepth() == 16 && (colourPlanes == 1 || colourPlanes == 3 || colourPlanes == 4);
    const int planes = destination.GetPlaneCount();
    for (int plane = 0; plane < planes;)
    {
        int end = plane + 1;
        const bool deconvolved = plane < colourPlanes && settings.Deconvolves(plane);
        while (deconvolved && end < std::min(colourPlanes, planes) && settings.Deconvolves(end))
            ++end;
        if (deconvolved)
        {
            planeRun run(source, plane, end - plane);
            run.Deconvolve(source, estimator, originX, originY, sixteen);
            run.Deliver(destination, sixteen);
        }
        else
            copyPlanes(destination, plane, source, plane, end - plane, destination.Bounds());
        plane = end;
    }
}

} // namespace Project
