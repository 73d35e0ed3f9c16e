#pragma once

#include "deblur/estimate/floatArray.h"

namespace CorvaneDeblur
{

/// The longest line that straightKernel draws.
inline constexpr double longestStraightKernel = 4096.0;

/// The kernel of a straight motion: an antialiased line one pixel wide, summing to (very nearly) 1, in the smallest
/// array that holds it, odd on both axes.
///
/// length: in pixels; below 1 counts as 1, above longestStraightKernel as that. angleDegrees: counterclockwise from the
/// direction of the columns, modulo 180: 0 gives a single row, 90 a single column. Values that are not finite count as
/// length 1, angle 0.
floatArray straightKernel(double length, double angleDegrees);

} // namespace CorvaneDeblur
