#include "deblur/deconv/latentEstimator.h"

#include "deblur/deconv/alignKernels.h"
#include "deblur/deconv/extendPeriodic.h"
#include "deblur/deconv/fastSize.h"
#include "deblur/deconv/planeSamples.h"
#include "deblur/deconv/traceBlend.h"
#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/resample.h"

#include <tbb/blocked_range.h>
#include <tbb/parallel_for.h>

#include <algorithm>
#include <cassert>
#include <cmath>
#include <cstring>
#include <iterator>

namespace CorvaneDeblur
{
namespace
{

int scaledSize(int size, float scale)
{
    return std::max(1, static_cast<int>(static_cast<float>(size) * scale));
}

/// Truncates; regions come out of files and may lie anywhere.
int scaledCoordinate(int value, float scale)
{
    constexpr float farAway = 1 << 30;
    return static_cast<int>(std::clamp(static_cast<float>(value) * scale, -farAway, farAway));
}

floatArray scaledKernel(const floatArray &kernel, float scale)
{
    const floatArray scaled = floatArray::allocate(scaledSize(kernel.rows, scale), scaledSize(kernel.cols, scale));
    if (kernel.empty())
        fill(scaled, 0.0f);
    else
        resize(kernel, scaled);
    normaliseSum(scaled);
    return scaled;
}

/// False for a kernel of zeros, and for one with samples that are no numbers: neither describes a blur.
bool hasWeight(const floatArray &kernel)
{
    const float sum = sumAbs(kernel);
    return sum > 0.0f && std::isfinite(sum);
}

/// The samples as they are, without a way through intensities.
void copyPlane(const std::byte *source, std::byte *destination, int plane, int rows, std::size_t bytes,
               std::ptrdiff_t sourceRowBytes, std::ptrdiff_t destinationRowBytes)
{
    source += sourceRowBytes * rows * plane;
    destination += destinationRowBytes * rows * plane;
    for (int y = 0; y < rows; ++y)
        std::memcpy(destination + destinationRowBytes * y, source + sourceRowBytes * y, bytes);
}

} // namespace

void latentEstimator::setKernels(const std::vector<latentKernel> &traces, float scale)
{
    kernels = traces;
    // A common position of the estimated kernels is worked out, and leaves with the list: what is rendered with are the
    // traces' own kernels, where they sit.
    std::vector<latentKernel> estimated;
    std::copy_if(traces.begin(), traces.end(), std::back_inserter(estimated),
                 [](const latentKernel &trace) { return !trace.isManual; });
    if (estimated.size() > 1)
        alignKernels(estimated);
    for (latentKernel &trace : kernels)
    {
        trace.kernel = scaledKernel(trace.kernel, scale);
        trace.regionLeft = scaledCoordinate(trace.regionLeft, scale);
        trace.regionTop = scaledCoordinate(trace.regionTop, scale);
        trace.regionRight = scaledCoordinate(trace.regionRight, scale);
        trace.regionBottom = scaledCoordinate(trace.regionBottom, scale);
    }
}

void latentEstimator::prepareRectangle(int x, int y, int cols, int rows)
{
    originX = x;
    originY = y;
    rectCols = cols;
    rectRows = rows;
    // The first trace alone sets the padding: the traces of a render are normally of like size.
    paddedCols = fastSize(cols + kernels[0].kernel.cols - 1);
    paddedRows = fastSize(rows + kernels[0].kernel.rows - 1);
    activeKernels = selectActiveKernels(kernels, x, y, x + cols - 1, y + rows - 1);
}

void latentEstimator::deconvolve(const std::byte *source, std::byte *destination, int x, int y, int cols, int rows,
                                 int planes, std::ptrdiff_t sourceRowBytes, std::ptrdiff_t destinationRowBytes,
                                 int depth)
{
    assert(!kernels.empty());
    if (cols <= 0 || rows <= 0)
        return;
    prepareRectangle(x, y, cols, rows);
    if (planes <= 0)
        return;
    // Isolated: an exception elsewhere in the caller's loops must not leave planes out without a word.
    tbb::task_group_context context(tbb::task_group_context::isolated);
    const auto runPlanes = [&](const tbb::blocked_range<int> &range) {
        for (int plane = range.begin(); plane < range.end() && !stopped(); ++plane)
            runPlane(plane, source, destination, sourceRowBytes, destinationRowBytes, depth);
    };
    tbb::parallel_for(tbb::blocked_range<int>(0, planes, 1), runPlanes, tbb::auto_partitioner(), context);
}

void latentEstimator::runPlane(int plane, const std::byte *source, std::byte *destination,
                               std::ptrdiff_t sourceRowBytes, std::ptrdiff_t destinationRowBytes, int depth) const
{
    const auto trace = [&](int index) -> const latentKernel & { return kernels[static_cast<std::size_t>(index)]; };
    if (activeKernels.size() == 1 && !hasWeight(trace(activeKernels[0]).kernel))
    {
        const std::size_t bytes = static_cast<std::size_t>(rectCols) * static_cast<std::size_t>(depth / 8);
        copyPlane(source, destination, plane, rectRows, bytes, sourceRowBytes, destinationRowBytes);
        return;
    }

    const floatArray tile = floatArray::allocate(rectRows, rectCols);
    const floatArray padded = floatArray::allocate(paddedRows, paddedCols);
    readPlane(source, tile, plane, sourceRowBytes, depth);
    extendPeriodic(tile, padded);
    if (activeKernels.size() == 1)
        deconvolvePlane(padded, trace(activeKernels[0]), tile);
    else
    {
        std::vector<floatArray> results;
        for (const int index : activeKernels)
        {
            results.push_back(floatArray::allocate(rectRows, rectCols));
            if (hasWeight(trace(index).kernel))
                deconvolvePlane(padded, trace(index), results.back());
            else
                copyTo(padded.subRect(0, 0, rectRows, rectCols), results.back());
        }
        blendResults(tile, kernels, activeKernels, results, originX, originY);
    }
    writePlane(tile, destination, plane, destinationRowBytes, depth);
}

} // namespace CorvaneDeblur
