#include "deblur/estimate/noiseMeasure.h"

#include "deblur/estimate/arrayOps.h"
#include "tests/deblur/estimate/measuresImage.h"
#include "tests/support/synthetic.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

using namespace CorvaneDeblur;
using TestSupport::noiseImage;

namespace
{

/// White noise of standard deviation `sigma` around `level`.
floatArray noisy(int rows, int cols, float level, float sigma, unsigned seed)
{
    const float reach = sigma * std::sqrt(3.0f);
    return noiseImage(rows, cols, seed, level - reach, level + reach);
}

floatArray cut(const floatArray &a, const regionRect &r)
{
    return a.subRect(r.y, r.x, r.height, r.width);
}

} // namespace

TEST(NoiseMeasure, ReferencePicture)
{
    const floatArray grey = TestSupport::measuresImage();
    const regionRect patch = flattestPatch(grey, grey.cols, grey.rows);
    EXPECT_EQ(patch, (regionRect{331, 14, 201, 201}));
    EXPECT_NEAR(noiseOfPatch(cut(grey, patch)), 0.006429506f, 6.4e-6f);
}

TEST(NoiseMeasure, UnusablePatchesHaveNone)
{
    EXPECT_EQ(noiseOfPatch(noisy(201, 201, 0.05f, 0.01f, 1)), 0.0f) << "nearly black";
    EXPECT_EQ(noiseOfPatch(noisy(201, 201, 0.9f, 0.01f, 1)), 0.0f) << "nearly clipped";
    EXPECT_EQ(noiseOfPatch(noisy(24, 201, 0.4f, 0.01f, 1)), 0.0f) << "no window fits";
    EXPECT_EQ(noiseOfPatch(noisy(27, 27, 0.4f, 0.01f, 1)), 0.0f) << "nine windows";
    EXPECT_GT(noiseOfPatch(noisy(26, 29, 0.4f, 0.01f, 1)), 0.0f) << "ten windows";
    EXPECT_EQ(noiseOfPatch(floatArray{}), 0.0f);

    const floatArray flat = floatArray::allocate(100, 100);
    fill(flat, 0.3f);
    EXPECT_LT(noiseOfPatch(flat), 1e-3f) << "rounding only, never a root of a negative variance";
}

TEST(NoiseMeasure, PatchStaysWithinAnyImage)
{
    for (const int cols : {1, 10, 12, 300})
        for (const int rows : {1, 11, 201})
        {
            const floatArray grey = noisy(rows, cols, 0.5f, 0.1f, 9);
            for (const float sample : {0.5f, std::numeric_limits<float>::quiet_NaN()})
            {
                grey.at(rows / 2, cols / 2) = sample;
                const regionRect patch = flattestPatch(grey, cols, rows);
                EXPECT_FALSE(patch.empty());
                EXPECT_TRUE(patch.x >= 0 && patch.y >= 0);
                EXPECT_TRUE(patch.x + patch.width <= cols && patch.y + patch.height <= rows) << cols << "x" << rows;
                EXPECT_TRUE(std::isfinite(noiseOfPatch(cut(grey, patch))));
            }
        }
}
