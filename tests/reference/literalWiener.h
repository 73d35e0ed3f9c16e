#pragma once

#include "deblur/estimate/floatArray.h"

namespace Reference
{

/// Wiener deconvolution of an extended plane: out (its top left corner) = inverse of conj(K) Y / (|K|^2 + r), times
/// 1 + r, with r = 0.095 smoothing^2 + 0.005.
void literalWiener(const CorvaneDeblur::floatArray &padded, const CorvaneDeblur::floatArray &kernel, float smoothing,
                   const CorvaneDeblur::floatArray &out);

} // namespace Reference
