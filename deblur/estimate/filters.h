#pragma once

#include "deblur/estimate/floatArray.h"

/// Small filters shared by estimation and deconvolution. `out` has a's shape; it may not be `a` itself unless told.
namespace CorvaneDeblur
{

/// Fills with a Gaussian of the given standard deviations (samples) around the array's centre, summing to 1.
/// sigmaCols 0 means sigmaRows.
void gaussianFill(const floatArray &a, float sigmaRows, float sigmaCols = 0.0f);
/// The same around (centreX, centreY), in columns and rows of the array.
void gaussianFill(const floatArray &a, float sigmaRows, float sigmaCols, float centreX, float centreY);

/// out[y][x] = a[y][x+1] - a[y][x]; the last column (row) of out is 0.
void forwardDiffX(const floatArray &a, const floatArray &out);
void forwardDiffY(const floatArray &a, const floatArray &out);
/// The same, but the last column (row) takes its neighbour from the first.
void circularDiffX(const floatArray &a, const floatArray &out);
void circularDiffY(const floatArray &a, const floatArray &out);

/// What the Laplacian takes for samples outside.
enum class laplacianEdge
{
    zero,  ///< 0 (Dirichlet)
    centre ///< the sample itself (Neumann)
};
/// Four-neighbour negative Laplacian: out = n * centre - sum of the neighbours inside; n is 4 with `zero`, and the
/// number of neighbours inside with `centre`.
void laplacian(const floatArray &a, const floatArray &out, laplacianEdge edge);

/// Sum of a over the (2 * radiusRows + 1) x (2 * radiusCols + 1) window, samples outside counting as 0.
/// radiusCols -1 means radiusRows. Running sums in single precision, the entering sample added before the leaving one
/// is taken off; cost independent of the window. out may be a.
void boxSum(const floatArray &a, const floatArray &out, int radiusRows, int radiusCols = -1);

} // namespace CorvaneDeblur
