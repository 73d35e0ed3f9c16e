#include "deblur/deconv/extendPeriodic.h"
#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/filters.h"
#include "deblur/estimate/gridKernel.h"
#include "deblur/estimate/resample.h"
#include "platform/math/multiversion.h"

#include <algorithm>
#include <cmath>
#include <vector>

namespace CorvaneDeblur
{
namespace
{

/// How much of the unblurred extension shows along one axis: 0 on the image's outer edge and in the added margin,
/// rising to 1 within about a kernel's width inside. `sums` are the blur's sums across the other axis; the profile is
/// 1 less their circular autocorrelation over imageSize - 1 samples, scaled to a peak of 1.
std::vector<float> fadeProfile(const std::vector<float> &sums, int imageSize, int paddedSize)
{
    const int period = imageSize - 1;
    const int taps = std::min(static_cast<int>(sums.size()), period);
    std::vector<double> correlation(static_cast<std::size_t>(std::max(period, 0)), 0.0);
    for (int i = 0; i < taps; ++i)
        for (int j = 0; j < taps; ++j)
            correlation[static_cast<std::size_t>((j - i + period) % period)] +=
                static_cast<double>(sums[static_cast<std::size_t>(i)]) *
                static_cast<double>(sums[static_cast<std::size_t>(j)]);
    double peakValue = 0.0;
    for (const double c : correlation)
        peakValue = std::max(peakValue, std::fabs(c));
    if (peakValue == 0.0)
        peakValue = 1.0;

    std::vector<float> profile(static_cast<std::size_t>(paddedSize), 0.0f);
    for (int i = 0; i < period; ++i)
        profile[static_cast<std::size_t>(i)] =
            static_cast<float>(1.0 - correlation[static_cast<std::size_t>(i)] / peakValue);
    return profile;
}

STILLMARK_MULTIVERSION
void fadeRow(const float *extended, const float *rowFade, float colFade, float *padded, int count)
{
    for (int x = 0; x < count; ++x)
    {
        const float w = rowFade[x] * colFade;
        padded[x] = (1.0f - w) * padded[x] + w * extended[x];
    }
}

} // namespace

void taperedExtension(const floatArray &src, const floatArray &padded, int kernelCols, int kernelRows, float sigma)
{
    const floatArray extended = floatArray::allocate(padded.rows, padded.cols);
    extendPeriodic(src, extended);

    const floatArray g = floatArray::allocate(kernelRows, kernelCols);
    gaussianFill(g, sigma != 0.0f ? sigma : static_cast<float>(kernelCols) / 6.0f);
    filterGrid(extended, padded, g, kernelSense::convolve, workers::all);

    std::vector<float> columnSums(static_cast<std::size_t>(kernelCols), 0.0f);
    std::vector<float> rowSums(static_cast<std::size_t>(kernelRows), 0.0f);
    for (int r = 0; r < kernelRows; ++r)
        for (int c = 0; c < kernelCols; ++c)
        {
            columnSums[static_cast<std::size_t>(c)] += g.row(r)[c];
            rowSums[static_cast<std::size_t>(r)] += g.row(r)[c];
        }
    const std::vector<float> rowFade = fadeProfile(columnSums, src.cols, padded.cols);
    const std::vector<float> colFade = fadeProfile(rowSums, src.rows, padded.rows);
    for (int y = 0; y < padded.rows; ++y)
        fadeRow(extended.row(y), rowFade.data(), colFade[static_cast<std::size_t>(y)], padded.row(y), padded.cols);
}

} // namespace CorvaneDeblur
