#pragma once

#include "deblur/estimate/floatArray.h"

/// Measures of kernels and latent images. All sums are in double; nothing is changed.
namespace CorvaneDeblur
{

/// Sum of sqrt(|k|) over all samples, divided by (rows * cols)^(1/4). For kernels that sum to 1, smaller is sparser:
/// an impulse of n x n gives 1 / sqrt(n), the most that an n x n kernel can have is sqrt(n). An empty array gives 0.
double kernelSparsity(const floatArray &kernel);

/// Mean of the squared differences between `kernel`, resized to the reference's shape and scaled to a sum of 1, and
/// the reference. Neither may be empty.
double kernelDistance(const floatArray &kernel, const floatArray &reference);

/// sum |dy| / sum dy^2 + sum |dx| / sum dx^2 over the forward differences inside the image (its last row and column
/// left out). Low for an image of few strong edges. Not a number where a direction has no change at all.
double gradientSparsity(const floatArray &image);

/// Whether a finished kernel can be trusted: it has weight and its sparsity is below 3.5. What fails is a spread-out or
/// noisy kernel, the mark of an estimation that found no motion. An empty or all-zero kernel is not good.
bool isGoodKernel(const floatArray &kernel);

/// The largest share of a kernel's weight that lies in 3 x 3 samples: 1 for a point, below 0.5 for any shake that can
/// be seen (measured on hand shakes of 13 to 51 pixels: 0.12 to 0.5). 0 for an empty or all-zero kernel.
double pointShare(const floatArray &kernel);

/// Whether a finished kernel says that nothing moved: at least 0.6 of it lies in one point and its neighbours, which is
/// what an estimate makes of a steady photograph and its noise. To deconvolve by it would change texture only.
bool isPointKernel(const floatArray &kernel);

/// The share of a kernel's weight that lies in its outermost rows and columns. A shake that fits its square ends before
/// them; much weight there means that the square is too small. 0 for an empty or all-zero kernel.
double borderShare(const floatArray &kernel);

} // namespace CorvaneDeblur
