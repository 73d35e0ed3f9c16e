#pragma once

#include "deblur/estimate/floatArray.h"
#include "platform/math/realTransform2d.h"

#include <vector>

namespace CorvaneDeblur
{

/// A Gaussian low-pass on a transform grid. The Gaussian is separable, and so is its spectrum: the factor of frequency
/// (v, u) is rows[v] * cols[u]. cols is as long as the pieces of a half spectrum together.
struct lowPassProfile
{
    std::vector<float> rows, cols;
};

/// The spectrum of a centred taps x taps Gaussian of standard deviation `sigma` samples, summing to 1; taps is odd.
lowPassProfile gaussianSpectrum(const realTransform2d &grid, int taps, float sigma);
/// The same, cut at three sigma.
lowPassProfile gaussianLowPass(const realTransform2d &grid, float sigma);

/// What one pyramid level's solvers share and what does not change from pass to pass: the transform of the level's
/// extended image, and the spectra of the difference filters along each axis,
///     D(f) = exp(2 pi i f / n) - 1,    |D|^2 = 2 - 2 cos(2 pi f / n).
struct blurredGrid
{
    /// padded: the level's image on its periodic grid (taperedExtension). Its transform uses `who`, and so do the
    /// solvers built on this.
    blurredGrid(const floatArray &padded, workers who);

    realTransform2d grid;
    pieceSpectrum spectrum;              ///< transform of the grid, columns done
    std::vector<complexSample> dx, dy;   ///< D of column frequency u (to the end of the last piece), row frequency v
    std::vector<float> dxPower, dyPower; ///< |D|^2 of the same
    float scale;                         ///< 1 / (rows * cols): normalises an inverse transform
};

/// How much a level's data term weighs first and second derivatives.
enum class derivativeOrder
{
    first = 0,
    second = 1
};

} // namespace CorvaneDeblur
