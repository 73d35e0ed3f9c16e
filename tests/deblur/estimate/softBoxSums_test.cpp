#include "deblur/estimate/softBoxSums.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/filters.h"
#include "tests/support/matchers.h"
#include "tests/support/synthetic.h"

#include <gtest/gtest.h>

using namespace CorvaneDeblur;

namespace
{

/// The box as an array, to be convolved with.
floatArray softBox(int rows, int cols)
{
    const floatArray box = floatArray::allocate(rows + 4, cols + 4);
    fill(box, 0.0f);
    fill(box.subRect(2, 2, rows, cols), 1.0f);
    const floatArray gaussian = floatArray::allocate(5, 5);
    gaussianFill(gaussian, 5.0f / 6.0f);
    convolveFFT(box, box, gaussian, borderMode::constant);
    return box;
}

} // namespace

// Odd and even boxes, one sample, longer than the map, maps thinner than the Gaussian.
TEST(SoftBoxSums, EqualsTheConvolutionWithTheBox)
{
    const struct
    {
        int rows, cols, boxRows, boxCols;
    } cases[] = {{40, 60, 7, 12}, {40, 60, 1, 1}, {33, 21, 16, 9}, {12, 9, 30, 4}, {1, 25, 3, 3}, {2, 2, 2, 5}};
    for (const auto &c : cases)
    {
        for (const borderMode border : {borderMode::constant, borderMode::replicate})
        {
            const floatArray map = TestSupport::stridedCopy(TestSupport::noiseImage(c.rows, c.cols, 11));
            const floatArray expected = floatArray::allocate(c.rows, c.cols),
                             sums = floatArray::allocate(c.rows, c.cols);
            convolveFFT(map, expected, softBox(c.boxRows, c.boxCols), border);
            softBoxSums(map, border, c.boxRows, c.boxCols).sumInto(sums, c.boxRows, c.boxCols);
            const double tolerance = 2e-6 * c.boxRows * c.boxCols + 1e-6;
            EXPECT_TRUE(TestSupport::arrayNear(sums, expected, tolerance))
                << c.rows << "x" << c.cols << " under " << c.boxRows << "x" << c.boxCols;
        }
    }
}

// Counts of edge pixels are compared with whole numbers: under the flat part of the box they must be exact.
TEST(SoftBoxSums, WholeCountsStayWhole)
{
    const floatArray map = floatArray::allocate(30, 30);
    fill(map, 0.0f);
    for (const int x : {3, 12, 13, 14, 16})
        map.at(15, x) = 1.0f;
    const floatArray sums = floatArray::allocate(30, 30);
    softBoxSums(map, borderMode::constant).sumInto(sums, 15, 15);
    for (int y = 10; y <= 20; ++y)
        EXPECT_EQ(sums.at(y, 14), 4.0f);
}
