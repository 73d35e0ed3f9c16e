#include "deblur/estimate/gradientPredictor.h"

#include "deblur/estimate/arrayOps.h"

#include <algorithm>
#include <array>
#include <vector>

namespace CorvaneDeblur
{
namespace
{

constexpr int bands = 4;
constexpr int bins = 130050; // 2 * 255 * 255

/// Band of the angle of (x, y) modulo 180 degrees: 0 from 0 to below 45 degrees, .. 3 from 135 to 180. What atan2, an
/// addition of pi to negative angles and a division by pi / 4 come to, decided by comparisons.
int bandOf(float x, float y)
{
    if (y < 0.0f)
    {
        x = -x;
        y = -y;
    }
    if (x > 0.0f || (x == 0.0f && y == 0.0f))
        return y < x || y == 0.0f ? 0 : 1;
    return y > -x ? 2 : 3;
}

using histogramColumn = std::array<std::int32_t, bands>;

} // namespace

float orientationThreshold(const floatArray &gradX, const floatArray &gradY, const floatArray &magnitude,
                           int minimumCount, float cap)
{
    const float top = peak(magnitude);
    if (0.0001f > top)
        return 0.0f;
    const float range = cap != 0.0f && top > cap ? cap : top;
    const float scale = 2.0f / range;

    std::vector<histogramColumn> histogram(bins, histogramColumn{});
    int highest = 0;
    for (int y = 0; y < magnitude.rows; ++y)
    {
        const float *gx = gradX.row(y), *gy = gradY.row(y), *m = magnitude.row(y);
        for (int x = 0; x < magnitude.cols; ++x)
        {
            // Compared as floats first: a magnitude far above the cap would not fit an int.
            const float position = scale * m[x] * 255.0f * 255.0f;
            const int bin = position < static_cast<float>(bins - 1) ? static_cast<int>(position) : bins - 1;
            ++histogram[static_cast<std::size_t>(std::max(bin, 0))][static_cast<std::size_t>(bandOf(gx[x], gy[x]))];
            highest = std::max(highest, bin);
        }
    }

    histogramColumn atLeast{};
    for (int b = highest; b >= 1; --b)
    {
        for (std::size_t g = 0; g < bands; ++g)
            atLeast[g] += histogram[static_cast<std::size_t>(b)][g];
        if (*std::min_element(atLeast.begin(), atLeast.end()) >= minimumCount)
            return static_cast<float>(b) / 65025.0f / scale;
    }
    return 0.0f;
}

} // namespace CorvaneDeblur
