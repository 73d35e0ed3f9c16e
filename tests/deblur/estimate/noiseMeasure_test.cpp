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

TEST(NoiseMeasure, FindsTheNoiseThatWasAdded)
{
    // The smoothest tenth of the windows lies a little below the truth.
    for (const float sigma : {0.002f, 0.01f, 0.05f})
    {
        const float measured = noiseOfPatch(noisy(201, 201, 0.4f, sigma, 3));
        EXPECT_LT(measured, 1.02f * sigma);
        EXPECT_GT(measured, 0.88f * sigma);
    }
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

TEST(NoiseMeasure, PatchLiesWhereTheImageIsFlatAndExposed)
{
    // A busy picture with a smooth square, and a smoother one that is black.
    const floatArray grey = noisy(400, 600, 0.45f, 0.15f, 5);
    copyTo(noisy(220, 220, 0.45f, 0.01f, 6), grey.subRect(40, 300, 220, 220));
    fill(grey.subRect(150, 20, 210, 210), 0.02f);
    const regionRect patch = flattestPatch(grey, 600, 400);
    EXPECT_NEAR(patch.centreX(), 410, 11);
    EXPECT_NEAR(patch.centreY(), 150, 11);

    // The same on a reduced image, in source pixels.
    const regionRect scaled = flattestPatch(grey, 2400, 1600);
    EXPECT_GE(scaled.x, 1200);
    EXPECT_LE(scaled.x + scaled.width, 2080);
    EXPECT_EQ(scaled.width, 201);

    // Where all is black any place will do.
    fill(grey, 0.0f);
    EXPECT_EQ(flattestPatch(grey, 600, 400).width, 201);
}

TEST(NoiseMeasure, PatchStaysWithinAnyImage)
{
    const float bad = std::numeric_limits<float>::quiet_NaN();
    for (const int cols : {1, 2, 10, 11, 12, 90, 300})
    {
        for (const int rows : {1, 2, 11, 201})
        {
            const floatArray grey = noisy(rows, cols, 0.5f, 0.1f, 9);
            for (const bool broken : {false, true})
            {
                if (broken)
                    grey.at(rows / 2, cols / 2) = bad;
                const regionRect patch = flattestPatch(grey, cols, rows);
                EXPECT_FALSE(patch.empty());
                EXPECT_TRUE(patch.x >= 0 && patch.y >= 0);
                EXPECT_TRUE(patch.x + patch.width <= cols && patch.y + patch.height <= rows) << cols << "x" << rows;
                EXPECT_TRUE(std::isfinite(noiseOfPatch(cut(grey, patch))));
            }
        }
    }
}
