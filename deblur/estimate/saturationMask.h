#pragma once

#include "deblur/estimate/floatArray.h"

namespace CorvaneDeblur
{

/// Keeps an estimation away from clipped highlights, whose blur is not linear.
///
/// mask: 1 at saturated pixels. weights, guide: arrays of the image's shape that receive 1 on good pixels falling to 0
/// in and around saturated ones (grown by about half a kernel), and the image with those places replaced by a blurred
/// copy. The filters are circular.
void applySaturationMask(const byteArray &mask, const floatArray &image, int kernelRows, int kernelCols,
                         const floatArray &weights, const floatArray &guide);

} // namespace CorvaneDeblur
