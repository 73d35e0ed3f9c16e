#pragma once

#include "deblur/deconv/latentKernel.h"

#include <vector>

/// Where the kernels of several traces sit in their arrays. Each is estimated by itself and may come out displaced by a
/// few pixels against the others.
namespace CorvaneDeblur
{

/// How far, in whole pixels, `b` must move to lie on `a` best: by the largest positive value of their correlation, the
/// first one in row order. Neither is empty.
void kernelShift(const floatArray &a, const floatArray &b, int &rowShift, int &colShift);

/// Moves the kernels onto a common position, each in a larger array of its own: onto the trace whose region lies
/// nearest to the middle of all regions, and all of them by so much that their mean centroid comes to the middle. A
/// kernel never moves by more than its own size. Lists with an empty kernel, or with samples that are no numbers, stay
/// as they are.
void alignKernels(std::vector<latentKernel> &kernels);

} // namespace CorvaneDeblur
