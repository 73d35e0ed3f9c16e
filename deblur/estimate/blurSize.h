#pragma once

#include "deblur/estimate/floatArray.h"

namespace CorvaneDeblur
{

/// Size of the blur, in pixels, that a window of a photograph shows: an odd number, at least 31, and above 150 only for
/// images wider or taller than 1500 pixels. It comes from two autocorrelations of the image's derivatives, in which
/// the blur's path stands out of the flat spectrum of natural edges; no kernel is estimated.
///
/// window: full-scale grey, 0..1, not empty. imageCols, imageRows: size of the image that it comes from.
int blurSizeOfWindow(const floatArray &window, int imageCols, int imageRows);

/// Columns and rows.
struct blurExtent
{
    int cols = 0;
    int rows = 0;
};

/// Half the extent of the autocorrelation of the gradients of `padded` (a periodic image), freed of the image's own
/// spectrum.
blurExtent extentFromGradients(const floatArray &padded);
/// The same from the mixed second derivative.
blurExtent extentFromMixedDerivative(const floatArray &padded);
/// Bounding box of the samples above a hundredth of the peak that are connected with the centre of `a` through their
/// eight neighbours; the centre itself always counts.
blurExtent connectedExtent(const floatArray &a);

} // namespace CorvaneDeblur
