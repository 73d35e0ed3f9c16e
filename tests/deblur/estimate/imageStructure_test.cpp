#include "deblur/estimate/imageStructure.h"

#include "tests/support/synthetic.h"

#include <gtest/gtest.h>

using namespace CorvaneDeblur;

TEST(HasStructure, SeesBlurredEdgesAndNoNoise)
{
    const floatArray flat = TestSupport::noiseImage(400, 500, 1, 0.5f - 0.02f, 0.5f + 0.02f);
    EXPECT_FALSE(hasStructure(flat, 31));
    const floatArray kernel = TestSupport::shakeKernel(31, 31, 2);
    EXPECT_TRUE(hasStructure(TestSupport::blurred(TestSupport::edgeScene(400, 500, 3), kernel, 0.02f, 4), 31));
}
