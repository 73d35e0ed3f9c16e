#pragma once

#include "deblur/estimate/floatArray.h"
#include "deblur/estimate/regionRect.h"

namespace CorvaneDeblur
{

/// The place of lowest variance of an image, among pixels neither clipped nor very dark: there one sees the noise
/// rather than the picture. grey: the whole image at any scale, not empty. sourceCols, sourceRows: the size of the
/// source; the result is in its pixels, at most 201 x 201, within it. Where no position is far enough from the edges
/// it is the patch around the middle.
regionRect flattestPatch(const floatArray &grey, int sourceCols, int sourceRows);

/// Standard deviation of the noise in a patch of full-scale grey: that of its smoothest tenth, by windows of 25 x 25.
/// 0 for a patch with fewer than ten usable windows (smaller than 25 pixels, clipped or black).
float noiseOfPatch(const floatArray &grey);

} // namespace CorvaneDeblur
