#pragma once

#include "deblur/estimate/blurredGrid.h"

namespace CorvaneDeblur
{

/// A latent image from the blurred one and the current kernel, by one regularised division per frequency:
///     X = conj(K) * w * Y * G / (|K|^2 * w + mu * (|Dx|^2 + |Dy|^2)),
/// w = 25 * (|Dx|^2 + |Dy|^2) + 1 with first derivatives in the data term, and
/// w = 50 + 25 * (|Dx|^2 + |Dy|^2) + 12.5 * (|Dxx|^2 + |Dyy|^2 + |Dxy|^2) with second ones. G is the pass's low-pass.
class fastDeconvolver
{
public:
    /// `blurred` is kept by reference. Kernels of one shape at a time follow one another.
    fastDeconvolver(const blurredGrid &blurred, derivativeOrder order);

    /// The low-pass of the next solves; none (an empty profile) before the first call.
    void setLowPass(const lowPassProfile &profile) { lowPass = profile; }

    /// latent: the top left part of the solution; at most as large as the grid. mu: weight of the gradient penalty.
    void solve(const floatArray &kernel, const floatArray &latent, float mu);

private:
    const blurredGrid &blurred;
    derivativeOrder order;
    lowPassProfile lowPass;
    pieceSpectrum kernelRows; ///< row transforms of the kernel; rows outside its support stay 0
    pieceSpectrum result;
};

} // namespace CorvaneDeblur
