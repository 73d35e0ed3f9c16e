#include "cli/kernelArrays.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/fourier.h"

#include <algorithm>

namespace Stillmark
{

using namespace CorvaneDeblur;

floatArray toArray(const kernelSamples &kernel)
{
    const auto array = floatArray::allocate(kernel.rows, kernel.cols);
    std::copy(kernel.samples.begin(), kernel.samples.end(), array.data);
    return array;
}

kernelSamples toSamples(const floatArray &kernel)
{
    kernelSamples out{kernel.rows, kernel.cols, {}};
    for (int y = 0; y < kernel.rows; ++y)
        out.samples.insert(out.samples.end(), kernel.row(y), kernel.row(y) + kernel.cols);
    return out;
}

floatArray squareKernel(const floatArray &kernel)
{
    if (kernel.rows == kernel.cols)
        return kernel;
    const int side = std::max(kernel.rows, kernel.cols);
    const int above = (side - kernel.rows) / 2, left = (side - kernel.cols) / 2;
    return padArray(kernel, above, side - kernel.rows - above, left, side - kernel.cols - left, borderMode::constant);
}

latentKernel latentTrace(const floatArray &kernel, const rectangle &region, const traceStrength &strength)
{
    latentKernel trace;
    trace.kernel = kernel;
    trace.regionLeft = region.x;
    trace.regionTop = region.y;
    trace.regionRight = region.x + region.width;
    trace.regionBottom = region.y + region.height;
    trace.smoothing = strength.smoothing;
    trace.suppression = strength.suppression;
    return trace;
}

} // namespace Stillmark
