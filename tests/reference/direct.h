#pragma once

#include "deblur/estimate/floatArray.h"
#include "deblur/estimate/fourier.h"

/// Sums written out as their definitions, accumulated in double. For small arrays: the cost is the product of both
/// sizes.
namespace Reference
{

/// Half spectrum of a: sum over (y, x) of a[y][x] exp(-2 pi i (v y / rows + u x / cols)).
CorvaneDeblur::complexArray directDFT(const CorvaneDeblur::floatArray &a);

enum class filterKind
{
    convolution,
    correlation
};
/// src filtered by the kernel, its element ((rows - 1) / 2, (cols - 1) / 2) over the pixel.
CorvaneDeblur::floatArray directFilter(const CorvaneDeblur::floatArray &src, const CorvaneDeblur::floatArray &kernel,
                                       CorvaneDeblur::borderMode border, filterKind kind);

/// Sum over the (2 radiusRows + 1) x (2 radiusCols + 1) window, samples outside counting as 0.
CorvaneDeblur::floatArray directBoxSum(const CorvaneDeblur::floatArray &a, int radiusRows, int radiusCols);

} // namespace Reference
