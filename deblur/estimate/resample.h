#pragma once

#include "deblur/estimate/floatArray.h"

namespace CorvaneDeblur
{

/// Resamples src to dst's shape, each axis for itself: area weighting where it shrinks, bilinear where it grows, a copy
/// where the shapes are equal. Both are at least 1 x 1; dst may not be src.
void resize(const floatArray &src, const floatArray &dst);

/// dst = the rectangle of its own shape whose centre is at (centreX, centreY) of src, in columns and rows, bilinear.
/// Coordinates outside src take the nearest edge sample.
void subPixelCrop(const floatArray &src, const floatArray &dst, float centreX, float centreY);

/// Prepares src for a periodic transform on the larger grid `padded` (allocated by the caller): src in the top left
/// corner, its edges faded into a blurred copy, the added margin the blurred periodic continuation, so that no seam
/// crosses the grid's border. The blur is a kernelRows x kernelCols Gaussian of standard deviation `sigma` samples;
/// sigma 0 means kernelCols / 6.
void taperedExtension(const floatArray &src, const floatArray &padded, int kernelCols, int kernelRows,
                      float sigma = 0.0f);

} // namespace CorvaneDeblur
