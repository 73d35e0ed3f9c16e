#include "deblur/estimate/kernelMeasures.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/resample.h"
#include "tests/support/npy.h"
#include "tests/support/synthetic.h"

#include <gtest/gtest.h>

using namespace CorvaneDeblur;

namespace
{

floatArray ramp(int rows, int cols, float perCol, float perRow)
{
    const floatArray a = floatArray::allocate(rows, cols);
    for (int y = 0; y < rows; ++y)
        for (int x = 0; x < cols; ++x)
            a.at(y, x) = perCol * static_cast<float>(x) + perRow * static_cast<float>(y);
    return a;
}

} // namespace

TEST(KernelSparsity, ReferenceValuesAndTheJudgementOfThem)
{
    const struct
    {
        const char *name;
        double sparsity;
        bool good;
    } cases[] = {{"impulse", 0.3333333333333333, true},
                 {"box31", 5.567764500890887, false},
                 {"shake15", 1.1915583721607181, true}};
    for (const auto &c : cases)
    {
        const floatArray kernel = TestSupport::readFloats("sparsity", c.name);
        EXPECT_NEAR(kernelSparsity(kernel), c.sparsity, 1e-5 * c.sparsity) << c.name;
        EXPECT_EQ(isGoodKernel(kernel), c.good) << c.name;
        EXPECT_EQ(kernelSparsity(TestSupport::stridedCopy(kernel)), kernelSparsity(kernel)) << c.name;
    }
}

TEST(KernelDistance, IgnoresScaleAndSizeButNotPlace)
{
    const floatArray small = TestSupport::shakeKernel(15, 15, 4);
    const floatArray large = floatArray::allocate(31, 31);
    resize(small, large);
    scaleInto(large, large, 7.0f);
    const floatArray moved = floatArray::allocate(15, 15);
    fill(moved, 0.0f);
    copyTo(small.subRect(0, 0, 12, 12), moved.subRect(3, 3, 12, 12));
    EXPECT_LT(kernelDistance(large, small), 0.1 * kernelDistance(moved, small));
}

TEST(GradientSparsity, SumOfFirstPowersOverSquares)
{
    // A ramp of slopes s and t gives 1/s + 1/t whatever its size.
    EXPECT_NEAR(gradientSparsity(ramp(20, 30, 0.25f, -0.125f)), 4.0 + 8.0, 1e-6);
    // The last row and column lend their samples, not their own differences.
    const floatArray image = ramp(4, 4, 0.25f, 0.125f);
    image.at(3, 3) = 100.0f;
    EXPECT_NEAR(gradientSparsity(image), 4.0 + 8.0, 1e-6);
}

TEST(PointKernel, TellsASteadyPhotoFromAShake)
{
    const floatArray point = floatArray::allocate(15, 15);
    fill(point, 0.0f);
    EXPECT_EQ(pointShare(point), 0.0);
    point.at(0, 0) = 0.7f; // in a corner the neighbourhood is cut
    point.at(14, 14) = 0.3f;
    EXPECT_NEAR(pointShare(point), 0.7, 1e-7);
    EXPECT_TRUE(isPointKernel(point));
    for (unsigned seed = 1; seed < 6; ++seed)
        EXPECT_FALSE(isPointKernel(TestSupport::shakeKernel(13, 13, seed)));
    EXPECT_FALSE(isPointKernel(floatArray()));
}

TEST(BorderShare, CountsEachOuterSampleOnce)
{
    const floatArray box = floatArray::allocate(5, 7);
    fill(box, 0.5f);
    box.at(2, 3) += 20.0f;
    EXPECT_NEAR(borderShare(box), 10.0 / 37.5, 1e-7);
    EXPECT_EQ(borderShare(floatArray()), 0.0);
}
