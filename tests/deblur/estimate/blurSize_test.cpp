#include "deblur/estimate/blurSize.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/straightKernel.h"
#include "tests/deblur/estimate/measuresImage.h"
#include "tests/support/synthetic.h"

#include <gtest/gtest.h>

#include <limits>

using namespace CorvaneDeblur;

TEST(BlurSize, ReferencePicture)
{
    const floatArray grey = TestSupport::measuresImage();
    EXPECT_EQ(blurSizeOfWindow(grey, grey.cols, grey.rows), 81);
    EXPECT_EQ(blurSizeOfWindow(TestSupport::stridedCopy(grey), grey.cols, grey.rows), 81);
}

TEST(BlurSize, GrowsWithTheBlurAndHoldsIt)
{
    const floatArray scene = TestSupport::edgeScene(480, 640, 3);
    int last = 0;
    for (const double length : {1.0, 40.0, 80.0})
    {
        const floatArray window = TestSupport::blurred(scene, straightKernel(length, 0), 0.002f, 5);
        const int size = blurSizeOfWindow(window, 3000, 2000);
        EXPECT_EQ(size % 2, 1);
        EXPECT_GT(size, last);
        EXPECT_GE(size, length);
        EXPECT_LE(size, 31 + 2 * length);
        last = size;
    }
}

TEST(BlurSize, WithinItsBoundsForAnyWindow)
{
    for (const int cols : {1, 2, 3, 42, 100, 401})
    {
        for (const int rows : {1, 2, 99, 1500})
        {
            const floatArray window = TestSupport::noiseImage(rows, cols, 8);
            const int size = blurSizeOfWindow(window, cols, rows);
            EXPECT_GE(size, 31);
            EXPECT_LE(size, 151);
            EXPECT_TRUE(size == 31 || std::max(cols, rows) > 42);

            window.at(rows / 2, cols / 2) = std::numeric_limits<float>::quiet_NaN();
            EXPECT_GE(blurSizeOfWindow(window, cols, rows), 31);
        }
    }
}

TEST(ConnectedExtent, FollowsEightNeighboursFromTheCentre)
{
    const char *const picture[] = {
        "#.....#", //
        ".#....#", // the diagonal reaches the centre, the right edge's bar does not
        "..#...#", //
        "...#...", //
        "...#...", //
        ".......", //
        "#######", //
    };
    const floatArray a = floatArray::allocate(7, 7);
    for (int y = 0; y < 7; ++y)
        for (int x = 0; x < 7; ++x)
            a.at(y, x) = picture[y][x] == '#' ? 1.0f : 0.01f; // exactly a hundredth of the peak does not count
    const blurExtent extent = connectedExtent(a);
    EXPECT_EQ(extent.cols, 4);
    EXPECT_EQ(extent.rows, 5);

    fill(a, 0.0f);
    EXPECT_EQ(connectedExtent(a).cols, 1);
}
