#include "deblur/estimate/straightKernel.h"

#include "deblur/estimate/arrayOps.h"
#include "tests/support/matchers.h"
#include "tests/support/npy.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

using namespace CorvaneDeblur;
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

TEST(StraightKernel, SenselessValuesStaySmall)
{
    const double infinity = std::numeric_limits<double>::infinity();
    for (const floatArray &line :
         {straightKernel(-5, 20), straightKernel(std::nan(""), 20), straightKernel(infinity, 0),
          straightKernel(5, std::nan("")), straightKernel(5, infinity)})
        EXPECT_EQ(line.rows * line.cols, 1);
    EXPECT_EQ(straightKernel(1e300, 0).cols, 4097);
}
