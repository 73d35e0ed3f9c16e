#pragma once

#include "deblur/estimate/floatArray.h"
#include "platform/math/realTransform2d.h"

/// Kernels on a transform grid, their centre at the grid's origin and wrapped around it, for work on column pieces
/// (realTransform2d.h): only the few rows that a kernel touches are transformed.
namespace CorvaneDeblur
{

/// Row transforms of the placed kernel into `spectrum`, whose other rows the caller has cleared (clearRows) and which
/// stay clear while kernels of one shape follow one another. A kernel larger than the grid wraps onto itself.
void forwardKernelRows(const realTransform2d &grid, const floatArray &kernel, complexSample *spectrum);

/// The end of an inverse transform whose columns are done: the out.rows x out.cols samples around the origin, times
/// scale. out is at most as large as the grid.
void inverseKernelRows(const realTransform2d &grid, const complexSample *spectrum, const floatArray &out, float scale);

/// The circular filter of a grid-sized array: out = in convolved (or correlated) with the centred kernel. `out` may be
/// `in`.
enum class kernelSense
{
    convolve,
    correlate ///< multiplies by the conjugate of the kernel's spectrum
};
void filterGrid(const floatArray &in, const floatArray &out, const floatArray &kernel, kernelSense sense, workers who);

} // namespace CorvaneDeblur
