#include "deblur/estimate/saturationMask.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/filters.h"
#include "deblur/estimate/fourier.h"

#include <algorithm>

namespace CorvaneDeblur
{
namespace
{

floatArray gaussianKernel(int rows, int cols)
{
    const floatArray g = floatArray::allocate(rows, cols);
    gaussianFill(g, static_cast<float>(rows) / 6.0f, static_cast<float>(cols) / 6.0f);
    return g;
}

} // namespace

void applySaturationMask(const byteArray &mask, const floatArray &image, int kernelRows, int kernelCols,
                         const floatArray &weights, const floatArray &guide)
{
    const int halfRows = std::max(1, (kernelRows - 1) / 2), halfCols = std::max(1, (kernelCols - 1) / 2);
    for (int y = 0; y < mask.rows; ++y)
        std::transform(mask.row(y), mask.row(y) + mask.cols, weights.row(y),
                       [](std::uint8_t m) { return static_cast<float>(m); });

    // Grow: any saturated pixel under the box counts. The box is not normalised, so one is enough.
    const floatArray box = floatArray::allocate(halfRows, halfCols);
    fill(box, 1.0f);
    convolveFFT(weights, weights, box, borderMode::circular);
    for (int y = 0; y < weights.rows; ++y)
        std::transform(weights.row(y), weights.row(y) + weights.cols, weights.row(y),
                       [](float w) { return w > 0.1f ? 1.0f : 0.0f; });
    convolveFFT(weights, weights, gaussianKernel(halfRows, halfCols), borderMode::circular);
    for (int y = 0; y < weights.rows; ++y)
        std::transform(weights.row(y), weights.row(y) + weights.cols, weights.row(y), [](float w) { return 1.0f - w; });

    const floatArray blurred = floatArray::allocate(image.rows, image.cols);
    convolveFFT(image, blurred, gaussianKernel(kernelRows, kernelCols), borderMode::circular);
    for (int y = 0; y < image.rows; ++y)
        for (int x = 0; x < image.cols; ++x)
        {
            const float w = weights.row(y)[x];
            guide.row(y)[x] = w * image.row(y)[x] + (1.0f - w) * blurred.row(y)[x];
        }
}

} // namespace CorvaneDeblur
