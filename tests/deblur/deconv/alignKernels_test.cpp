#include "deblur/deconv/alignKernels.h"

#include "deblur/deconv/latentEstimator.h"
#include "deblur/deconv/shrinkageTableStore.h"
#include "deblur/estimate/arrayOps.h"
#include "tests/support/matchers.h"
#include "tests/support/synthetic.h"

#include <gtest/gtest.h>

using namespace CorvaneDeblur;
using namespace TestSupport;

namespace
{

/// The kernel in a square of `side`, its own top left corner at (y, x).
floatArray placed(const floatArray &kernel, int side, int y, int x)
{
    const floatArray square = floatArray::allocate(side, side);
    fill(square, 0.0f);
    copyTo(kernel, square.subRect(y, x, kernel.rows, kernel.cols));
    return square;
}

TEST(AlignKernels, FindsHowFarAKernelIsDisplaced)
{
    const floatArray path = shakeKernel(9, 9, 4);
    const floatArray reference = placed(path, 21, 6, 6);
    for (const int side : {15, 21, 27})
        for (const auto &[y, x] : {std::pair(3, 6), {6, 1}, {0, 5}})
        {
            int row = 0, col = 0;
            kernelShift(reference, placed(path, side, y, x), row, col);
            // Arrays of different sizes lie with their middles on one another.
            EXPECT_EQ(row, 6 - y - (21 / 2 - side / 2)) << side;
            EXPECT_EQ(col, 6 - x - (21 / 2 - side / 2)) << side;
        }
    const floatArray nothing = placed(path, 21, 0, 0);
    fill(nothing, 0.0f);
    int row = 7, col = 7;
    kernelShift(reference, nothing, row, col);
    EXPECT_EQ(std::abs(row), 21 / 2) << "no positive value: the position stays at the corner";
}

TEST(AlignKernels, MovesAllOntoOnePlace)
{
    const floatArray path = shakeKernel(9, 9, 4);
    std::vector<latentKernel> kernels(3);
    const int shifts[3][2] = {{6, 6}, {2, 9}, {8, 3}};
    for (int i = 0; i < 3; ++i)
    {
        kernels[i].kernel = placed(path, 21, shifts[i][0], shifts[i][1]);
        kernels[i].regionLeft = 100 * i;
        kernels[i].regionRight = 100 * i + 50;
        kernels[i].regionBottom = 50;
    }
    alignKernels(kernels);
    for (const latentKernel &trace : kernels)
    {
        int row = 1, col = 1;
        kernelShift(kernels[1].kernel, trace.kernel, row, col);
        EXPECT_EQ(row, 0);
        EXPECT_EQ(col, 0);
        EXPECT_NEAR(sumAbs(trace.kernel), 1.0f, 1e-5f) << "nothing falls off";
    }

    // A kernel that sums to a million, or is no number, takes no memory by that.
    fill(kernels[0].kernel, 1e6f);
    alignKernels(kernels);
    EXPECT_LE(kernels[0].kernel.rows, 9 * 21);
    kernels[0].kernel.at(0, 0) = 1e38f * 1e38f;
    const int rows = kernels[2].kernel.rows;
    alignKernels(kernels);
    EXPECT_EQ(kernels[2].kernel.rows, rows);
}

} // namespace
