#include "deblur/deconv/extendPeriodic.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/filters.h"
#include "tests/reference/literalExtendPeriodic.h"
#include "tests/support/matchers.h"
#include "tests/support/npy.h"
#include "tests/support/synthetic.h"

#include <string>

using namespace CorvaneDeblur;
using namespace TestSupport;

namespace
{

TEST(ExtendPeriodic, MatchesReferenceValues)
{
    const floatArray tile = readFloats("extend_periodic", "tile"), expected = readFloats("extend_periodic", "extended");
    const floatArray out = floatArray::allocate(expected.rows, expected.cols);
    extendPeriodic(tile, out);
    EXPECT_TRUE(arrayNear(out, expected, 5e-5));
}

// Strips of no interior, of one row or column and of more; tiles without an interior of their own.
TEST(ExtendPeriodic, EqualsLiteralOneForAnyStrip)
{
    for (const auto &[rows, cols] :
         {std::pair(1, 1), std::pair(1, 6), std::pair(2, 2), std::pair(5, 2), std::pair(3, 9), std::pair(17, 24)})
        for (const int addedRows : {0, 1, 2, 3, 11, 30})
            for (const int addedCols : {0, 1, 2, 5, 28})
            {
                SCOPED_TRACE(std::to_string(rows) + " x " + std::to_string(cols) + " and " + std::to_string(addedRows) +
                             ", " + std::to_string(addedCols));
                const floatArray tile = stridedCopy(noiseImage(rows, cols, 31));
                const floatArray out = stridedCopy(floatArray::allocate(rows + addedRows, cols + addedCols));
                const floatArray expected = floatArray::allocate(out.rows, out.cols);
                fill(out, -9.0f);
                extendPeriodic(tile, out);
                Reference::literalExtendPeriodic(tile, expected);
                EXPECT_TRUE(arrayNear(out, expected, 1e-5));
                EXPECT_TRUE(arrayIdentical(out.subRect(0, 0, rows, cols), tile));
                EXPECT_TRUE(marginUntouched(out));
            }
}

TEST(SolveLaplace, InteriorIsHarmonicAndTheFrameStays)
{
    for (const auto &[rows, cols] : {std::pair(3, 3), std::pair(3, 40), std::pair(40, 4), std::pair(61, 83)})
    {
        const floatArray frame = noiseImage(rows, cols, 32), grid = cloned(frame), bend = cloned(frame);
        fill(grid.subRect(1, 1, rows - 2, cols - 2), -7.0f); // of no influence
        solveLaplace(grid);
        laplacian(grid, bend, laplacianEdge::zero);
        EXPECT_NEAR(peakAbs(bend.subRect(1, 1, rows - 2, cols - 2)), 0.0f, 3e-6) << rows << " x " << cols;
        copyTo(frame.subRect(1, 1, rows - 2, cols - 2), grid.subRect(1, 1, rows - 2, cols - 2));
        EXPECT_TRUE(arrayIdentical(grid, frame));
    }
}

} // namespace
