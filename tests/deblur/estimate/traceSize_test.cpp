#include "deblur/estimate/traceSize.h"

#include <gtest/gtest.h>

using namespace CorvaneDeblur;

TEST(TraceSize, StaysWithinWhatThePictureAllows)
{
    EXPECT_EQ(maxKernelSize(50, 400), 15);
    EXPECT_EQ(maxKernelSize(1, 1), 11);
    EXPECT_EQ(maxKernelSize(30000, 20000), 199);
    EXPECT_EQ(sizeForPreset(sizePreset::small, 3000, 1999), 99);
    EXPECT_EQ(sizeForPreset(sizePreset::large, 6000, 4000), 199);
    EXPECT_EQ(sizeForPreset(sizePreset::fixed, 90, 90), 29);
    EXPECT_EQ(limitRegion({100, 50, 3001, 2001}), (regionRect{600, 50, 2000, 2000}));
    EXPECT_EQ(limitRegion({5, 5, 0, 100}), regionRect{});
}
