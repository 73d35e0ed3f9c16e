#pragma once

#include "deblur/estimate/floatArray.h"

#include <gtest/gtest.h>

/// Comparisons of arrays that tell what is wrong: EXPECT_TRUE(arrayNear(actual, expected, 1e-5)).
namespace TestSupport
{

/// How far two arrays of one shape are apart; differences are absolute, in double. NaN and infinite samples count as
/// infinitely far unless both are the same infinity.
struct arrayDifference
{
    double max = 0.0;
    double rms = 0.0;
    double percentile999 = 0.0; ///< 99.9th percentile
    double shareOutside = 0.0;  ///< share of samples further apart than the limit given
    int worstRow = 0, worstCol = 0;
};
arrayDifference differenceOf(const CorvaneDeblur::floatArray &actual, const CorvaneDeblur::floatArray &expected,
                             double limit);

/// Same shape, and no more than `shareOutside` of the samples further apart than `max`.
testing::AssertionResult arrayNear(const CorvaneDeblur::floatArray &actual, const CorvaneDeblur::floatArray &expected,
                                   double max, double shareOutside = 0.0);
/// Same shape and every one of the three bounds kept; one that is 0 is not looked at.
testing::AssertionResult arrayWithin(const CorvaneDeblur::floatArray &actual, const CorvaneDeblur::floatArray &expected,
                                     double max, double rms, double percentile999 = 0.0);
/// Same shape and the same bits.
testing::AssertionResult arrayIdentical(const CorvaneDeblur::floatArray &actual,
                                        const CorvaneDeblur::floatArray &expected);

/// Normalised correlation of two kernels of any shapes, centres on one another: sum(a b) / sqrt(sum(a^2) sum(b^2)), the
/// largest over whole-pixel shifts of up to `largestShift` on each axis.
double kernelCorrelation(const CorvaneDeblur::floatArray &a, const CorvaneDeblur::floatArray &b, int largestShift = 2);

} // namespace TestSupport
