#include "deblur/estimate/blurSize.h"

#include "tests/deblur/estimate/measuresImage.h"
#include "tests/support/synthetic.h"

#include <gtest/gtest.h>

#include <limits>

using namespace CorvaneDeblur;

TEST(BlurSize, ReferencePicture)
{
    const floatArray grey = TestSupport::measuresImage();
    EXPECT_EQ(blurSizeOfWindow(grey, grey.cols, grey.rows), 81);
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
