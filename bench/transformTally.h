#pragma once

#include "bench/floor.h"
#include "bench/scenes.h"
#include "deblur/deconv/latentEstimator.h"

#include <vector>

/// Which transforms a job needs.
namespace Bench
{

/// A deconvolution of these areas of a photo. Per plane: the plane and the kernel forward, and
/// Wiener: one inverse;
/// fast: an inverse in each of the six rounds, and a forward in every round in which gradients survive the shrinkage;
/// classic: the same, and in each round but the last an inverse for the low-passed copy.
/// How often gradients survive depends on the picture, so both hyper-Laplacian methods are run here, untimed, on all
/// threads.
std::vector<transformCount> transformsOfDeconvolution(CorvaneDeblur::deconvolutionMethod method, memoryPhoto &photo,
                                                      const std::vector<CorvaneDeblur::pixelRect> &areas,
                                                      const CorvaneDeblur::latentKernel &trace,
                                                      CorvaneDeblur::shrinkageTableStore &tables);

/// An estimation that runs every pass of every level, as it does for the low noise figure. Per level: the tapered
/// extension there and back and the level's image forward; per pass: kernel forward and latent image inverse, both
/// gradients forward, right-hand side and operator inverse.
std::vector<transformCount> transformsOfEstimation(int imageRows, int imageCols, int kernelSize, int passes);

} // namespace Bench
