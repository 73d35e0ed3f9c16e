#pragma once

#include "deblur/deconv/shrinkageTableStore.h"
#include "deblur/estimate/floatArray.h"

namespace Reference
{

/// The two hyper-Laplacian methods on an extended plane, whole arrays at every step; out is its top left corner. Six
/// rounds at beta = 1, 2.83, 8, 22.6, 64, 181 of half-quadratic splitting after D. Krishnan and R. Fergus, "Fast image
/// deconvolution using hyper-Laplacian priors", NIPS 2009.
void literalHyperLaplacian(const CorvaneDeblur::floatArray &padded, const CorvaneDeblur::floatArray &kernel,
                           float smoothing, float suppression, const CorvaneDeblur::shrinkageTableStore &tables,
                           const CorvaneDeblur::floatArray &out);

/// The earlier form: low-pass prior in place of the pull towards the input, de-ringing in place of the fade.
void literalHyperLaplacianOld(const CorvaneDeblur::floatArray &padded, const CorvaneDeblur::floatArray &kernel,
                              float smoothing, float suppression, CorvaneDeblur::shrinkageTableStore &tables,
                              const CorvaneDeblur::floatArray &out);

} // namespace Reference
