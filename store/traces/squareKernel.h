#pragma once

#include "deblur/estimate/floatArray.h"

namespace Project
{

/// The kernel in the middle of a side x side array of zeros; what does not fit is lost equally on both sides. An odd
/// sample of margin comes after. The kernel itself, sharing its samples, if it has that shape already.
CorvaneDeblur::floatArray SquareKernel(const CorvaneDeblur::floatArray &kernel, int side);

} // namespace Project
