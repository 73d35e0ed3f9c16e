#include "deblur/estimate/noiseMeasure.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/filters.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <vector>

namespace CorvaneDeblur
{
namespace
{

/// Grey values that show noise as it is: neither near black nor near clipping.
constexpr float darkest = 25.0f / 255.0f;
constexpr float brightest = 200.0f / 255.0f;

struct localMoments
{
    floatArray mean, variance;
};

/// Mean and variance over the window of the given radii around every sample.
localMoments momentsOf(const floatArray &grey, int radiusRows, int radiusCols)
{
    const float weight = 1.0f / (static_cast<float>(2 * radiusRows + 1) * static_cast<float>(2 * radiusCols + 1));
    localMoments moments{floatArray::allocate(grey.rows, grey.cols), floatArray::allocate(grey.rows, grey.cols)};
    boxSum(grey, moments.mean, radiusRows, radiusCols);
    scaleInto(moments.mean, moments.mean, weight);

    multiplyInto(grey, grey, moments.variance);
    boxSum(moments.variance, moments.variance, radiusRows, radiusCols);
    for (int y = 0; y < grey.rows; ++y)
    {
        const float *mean = moments.mean.row(y);
        float *variance = moments.variance.row(y);
        for (int x = 0; x < grey.cols; ++x)
            variance[x] = weight * variance[x] - mean[x] * mean[x];
    }
    return moments;
}

/// Number of usable samples around every sample.
floatArray validCounts(const floatArray &grey, int radius)
{
    const floatArray valid = floatArray::allocate(grey.rows, grey.cols);
    for (int y = 0; y < grey.rows; ++y)
        std::transform(grey.row(y), grey.row(y) + grey.cols, valid.row(y),
                       [](float value) { return value >= darkest && value <= brightest ? 1.0f : 0.0f; });
    boxSum(valid, valid, radius, radius);
    return valid;
}

/// The position, at least `radius` from the edges, of the smallest variance among those with `needed` usable samples.
bool flattestPosition(const floatArray &variance, const floatArray &valid, int radius, int needed, int &atX, int &atY)
{
    float smallest = std::numeric_limits<float>::infinity();
    bool found = false;
    for (int y = radius; y < variance.rows - radius; ++y)
    {
        for (int x = radius; x < variance.cols - radius; ++x)
        {
            if (valid.at(y, x) < static_cast<float>(needed) || !(variance.at(y, x) < smallest))
                continue;
            smallest = variance.at(y, x);
            atX = x;
            atY = y;
            found = true;
        }
    }
    return found;
}

} // namespace

regionRect flattestPatch(const floatArray &grey, int sourceCols, int sourceRows)
{
    const int half = std::min(100, std::min(sourceCols, sourceRows) / 2);
    const float ratio = static_cast<float>(grey.cols) / static_cast<float>(sourceCols);
    const int radius = std::max(5, static_cast<int>(static_cast<float>(half) * ratio + 0.5f));

    int centreX = sourceCols / 2, centreY = sourceRows / 2;
    if (grey.cols > 2 * radius && grey.rows > 2 * radius)
    {
        const int count = (2 * radius + 1) * (2 * radius + 1);
        const floatArray variance = momentsOf(grey, radius, radius).variance;
        const floatArray valid = validCounts(grey, radius);
        // Mostly usable samples if there is such a place, otherwise less, at last any place.
        for (const int needed : {count / 2, count / 3, 0})
        {
            int x = 0, y = 0;
            if (!flattestPosition(variance, valid, radius, needed, x, y))
                continue;
            centreX = static_cast<int>(static_cast<float>(x) / ratio + 0.5f);
            centreY = static_cast<int>(static_cast<float>(y) / ratio + 0.5f);
            break;
        }
    }

    regionRect patch;
    patch.x = std::max(0, centreX - half);
    patch.y = std::max(0, centreY - half);
    patch.width = std::min(centreX + half, sourceCols - 1) - patch.x + 1;
    patch.height = std::min(centreY + half, sourceRows - 1) - patch.y + 1;
    return patch;
}

float noiseOfPatch(const floatArray &grey)
{
    constexpr int radius = 12;
    constexpr double share = 0.1; // what is left of the picture in a patch spoils the larger variances
    if (grey.rows <= 2 * radius || grey.cols <= 2 * radius)
        return 0.0f;

    const localMoments moments = momentsOf(grey, radius, radius);
    std::vector<float> variances;
    for (int y = radius; y < grey.rows - radius; ++y)
    {
        for (int x = radius; x < grey.cols - radius; ++x)
        {
            const float mean = moments.mean.at(y, x);
            const float variance = moments.variance.at(y, x);
            if (mean > darkest && mean < brightest && std::isfinite(variance))
                variances.push_back(std::max(variance, 0.0f)); // below zero by rounding only
        }
    }

    const auto used = static_cast<std::size_t>(static_cast<double>(variances.size()) * share);
    if (used == 0)
        return 0.0f;
    std::nth_element(variances.begin(), variances.begin() + static_cast<std::ptrdiff_t>(used), variances.end());
    std::sort(variances.begin(), variances.begin() + static_cast<std::ptrdiff_t>(used)); // sum in ascending order
    double sum = 0.0;
    for (std::size_t i = 0; i < used; ++i)
        sum += variances[i];
    return static_cast<float>(std::sqrt(sum / static_cast<double>(used)));
}

} // namespace CorvaneDeblur
