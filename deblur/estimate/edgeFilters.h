#pragma once

#include "deblur/estimate/floatArray.h"
#include "platform/math/workers.h"

/// The two filters that clean and sharpen a latent image before its edges are taken.
namespace CorvaneDeblur
{

/// destination = bilateral filter of source (C. Tomasi and R. Manduchi, "Bilateral filtering for gray and color
/// images", ICCV 1998) over the (2 * radius + 1) square: weights are a Gaussian of spatialSigma samples times
/// exp(-difference^2 / (2 * rangeSigma^2)); neighbours outside the image do not count. Not in place.
void bilateralFilter(const floatArray &source, const floatArray &destination, float spatialSigma, float rangeSigma,
                     int radius, workers who = workers::all);

/// sharpened = image + step / 2 * |gradient| * sign(negative Laplacian), a shock filter step (S. Osher and L. Rudin,
/// "Feature-oriented image enhancement using shock filters", SIAM J. Numerical Analysis 27(4), 1990). The gradient is
/// the central difference without its half, one-sided at the edges. Not in place.
void shockFilter(const floatArray &image, const floatArray &sharpened, float step, workers who = workers::all);

} // namespace CorvaneDeblur
