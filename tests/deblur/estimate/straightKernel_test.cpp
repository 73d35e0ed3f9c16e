#include "deblur/estimate/straightKernel.h"

#include "deblur/estimate/arrayOps.h"
#include "tests/support/matchers.h"
#include "tests/support/npy.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

using namespace CorvaneDeblur;
using TestSupport::arrayIdentical;
using TestSupport::arrayNear;

TEST(StraightKernel, ReferenceLines)
{
    const struct
    {
        const char *name;
        double length, angle;
    } cases[] = {{"line_1_0", 1, 0},      {"line_5_0", 5, 0},         {"line_5_90", 5, 90},
                 {"line_10_45", 10, 45},  {"line_12.5_30", 12.5, 30}, {"line_17.3_131", 17.3, 131},
                 {"line_40_179", 40, 179}};
    for (const auto &c : cases)
        EXPECT_TRUE(arrayNear(straightKernel(c.length, c.angle), TestSupport::readFloats(c.name, "kernel"), 1e-6))
            << c.name;
}

TEST(StraightKernel, EveryLineIsSymmetricAboutItsMiddleAndSumsToOne)
{
    for (const double length : {1.0, 1.5, 2.0, 3.0, 7.7, 30.0, 199.0})
    {
        for (int angle = 0; angle < 180; angle += 7)
        {
            const floatArray line = straightKernel(length, angle);
            ASSERT_EQ(line.rows % 2, 1);
            ASSERT_EQ(line.cols % 2, 1);
            ASSERT_NEAR(sumAbs(line), 1.0f, 0.01f) << length << " at " << angle;
            ASSERT_LE(std::max(line.rows, line.cols), static_cast<int>(length) + 3);
            for (int y = 0; y < line.rows; ++y)
                for (int x = 0; x < line.cols; ++x)
                    ASSERT_EQ(line.at(y, x), line.at(line.rows - 1 - y, line.cols - 1 - x));
        }
    }
}

TEST(StraightKernel, AnglesTurnCounterclockwiseAndRepeatAfterHalfATurn)
{
    // 30 degrees points to the upper right: weight in the top right corner, none in the top left.
    const floatArray line = straightKernel(21, 30);
    EXPECT_GT(line.at(0, line.cols - 1) + line.at(0, line.cols - 2), 0.0f);
    EXPECT_EQ(line.at(0, 0), 0.0f);

    EXPECT_TRUE(arrayNear(straightKernel(21, 210), line, 1e-6));
    EXPECT_TRUE(arrayNear(straightKernel(21, -150), line, 1e-6));
    EXPECT_TRUE(arrayIdentical(straightKernel(21, 180), straightKernel(21, 0)));
}

TEST(StraightKernel, SenselessValuesStaySmall)
{
    const double infinity = std::numeric_limits<double>::infinity();
    for (const floatArray &line :
         {straightKernel(-5, 20), straightKernel(std::nan(""), 20), straightKernel(infinity, 0),
          straightKernel(5, std::nan("")), straightKernel(5, infinity)})
        EXPECT_EQ(line.rows * line.cols, 1);
    EXPECT_EQ(straightKernel(1e300, 0).cols, 4097);
}
