#include "deblur/estimate/gradientPredictor.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/edgeFilters.h"
#include "deblur/estimate/filters.h"
#include "platform/math/multiversion.h"
#include "platform/math/vectorOps.h"

#include <algorithm>
#include <numbers>

namespace CorvaneDeblur
{
namespace
{

constexpr float spatialSigma = 2.0f;
constexpr int filterRadius = 2;
constexpr float decay = 0.9f;
constexpr float lowestThreshold = 0.1f;
constexpr int rowsPerPiece = 64;

/// Keeps the gradients whose weighted magnitude reaches the threshold.
STILLMARK_MULTIVERSION
void selectRow(const float *magnitude, float threshold, float *gx, float *gy, float *rejected, int count)
{
    for (int x = 0; x < count; ++x)
    {
        const float selected = magnitude[x] >= threshold ? 1.0f : 0.0f;
        gx[x] *= selected;
        gy[x] *= selected;
        rejected[x] = 1.0f - selected;
    }
}

/// Adds to the selection: here the weight multiplies the squared magnitude.
STILLMARK_MULTIVERSION
void selectMoreRow(const float *weights, float squaredThreshold, float *gx, float *gy, float *rejected, int count)
{
    for (int x = 0; x < count; ++x)
    {
        const float squared = (gx[x] * gx[x] + gy[x] * gy[x]) * weights[x];
        const float below = squaredThreshold > squared ? rejected[x] : 0.0f;
        rejected[x] = below;
        gx[x] *= 1.0f - below;
        gy[x] *= 1.0f - below;
    }
}

} // namespace

gradientPredictor::gradientPredictor(int imageRows, int imageCols, int kRows, int kCols, floatArray w, workers executor)
    : kernelRows(kRows), kernelCols(kCols), weights(std::move(w)), who(executor),
      smooth(floatArray::allocate(imageRows, imageCols)), working(floatArray::allocate(imageRows, imageCols))
{
    assert(weights.rows == imageRows && weights.cols == imageCols);
}

void gradientPredictor::sharpen(const floatArray &latent)
{
    bilateralFilter(latent, smooth, spatialSigma, rangeSigma, filterRadius, who);
    shockFilter(smooth, working, shockStep, who);
}

void gradientPredictor::selectFirst(const floatArray &gradX, const floatArray &gradY)
{
    forwardDiffX(working, gradX);
    forwardDiffY(working, gradY);
    const floatArray magnitude = smooth; // its samples are not needed any more
    const std::size_t n = static_cast<std::size_t>(magnitude.cols);
    for (int y = 0; y < magnitude.rows; ++y)
    {
        vsHypot(n, gradX.row(y), gradY.row(y), magnitude.row(y));
        vsMul(n, magnitude.row(y), weights.row(y), magnitude.row(y));
    }
    const int minimumCount = std::max(10, 2 * std::max(kernelRows, kernelCols));
    threshold = orientationThreshold(gradX, gradY, magnitude, minimumCount, std::numbers::sqrt2_v<float>);
    rejected = floatArray::allocate(magnitude.rows, magnitude.cols);
    for (int y = 0; y < magnitude.rows; ++y)
        selectRow(magnitude.row(y), threshold, gradX.row(y), gradY.row(y), rejected.row(y), magnitude.cols);
}

void gradientPredictor::selectMore(const floatArray &gradX, const floatArray &gradY)
{
    const int rows = working.rows, cols = working.cols;
    inPieces(who, rows, rowsPerPiece, [&](int begin, int end) {
        for (int y = begin; y < end; ++y)
        {
            const float *here = working.row(y);
            float *gx = gradX.row(y), *gy = gradY.row(y);
            vsSub(static_cast<std::size_t>(cols - 1), here + 1, here, gx);
            gx[cols - 1] = 0.0f;
            vsSub(static_cast<std::size_t>(cols), working.row(std::min(y + 1, rows - 1)), here, gy);
            selectMoreRow(weights.row(y), threshold * threshold, gx, gy, rejected.row(y), cols);
        }
    });
}

void gradientPredictor::predict(const floatArray &latent, const floatArray &gradX, const floatArray &gradY)
{
    sharpen(latent);
    if (threshold == 0.0f)
        selectFirst(gradX, gradY);
    else
        selectMore(gradX, gradY);
    rangeSigma *= decay;
    shockStep *= decay;
    threshold = std::max(threshold * decay, lowestThreshold);
}

} // namespace CorvaneDeblur
