#pragma once

#include "deblur/deconv/shrinkageTableStore.h"
#include "platform/math/realTransform2d.h"

#include <vector>

namespace CorvaneDeblur
{

/// Non-blind deconvolution of one plane under a sparse prior on its gradients (exponent 2/3) and a pull towards the
/// blurred input, by half-quadratic splitting after D. Krishnan and R. Fergus, "Fast image deconvolution using
/// hyper-Laplacian priors", NIPS 2009: six rounds at beta = 1, 2.83, 8, 22.6, 64, 181, each a shrinkage of the
/// gradients through a table and an exact solve per frequency,
///     X = (N - c * S) / (c * D + |K|^2 + W),   N = (conj(K) + W) * Y,   c = beta / lambda,
/// D the power of the two difference filters, S the transform of the shrunk gradients' negative adjoint.
///
/// A round costs one sweep over the pixels and one over the spectrum beside its transforms: row transforms, column
/// transforms and both sweeps are interleaved so that each touches memory once.
class hyperLaplacianDeconvolver
{
public:
    /// padded: the plane on its periodic grid, kept as a view.
    hyperLaplacianDeconvolver(const floatArray &padded, const shrinkageTableStore &tables, workers who);

    /// out: receives the top left part of the result. smoothing, suppression: 0..1. Above a suppression of 0.8 the
    /// result also fades towards the input.
    void run(const floatArray &out, const floatArray &kernel, float smoothing, float suppression);

    /// Rounds of the last run in which any gradient survived the shrinkage: each cost one forward transform more.
    int gradientRounds() const { return roundsWithGradients; }

private:
    void firstRound(const floatArray &kernel, float c);
    void nextRound(float c, bool anyGradient);
    void finish(const floatArray &out, float suppression) const;

    floatArray observed;
    const shrinkageTableStore &tables;
    workers who;
    realTransform2d grid;
    std::vector<float> dxPower, dyPower; ///< |D|^2 along each axis, as far as the last piece goes
    float pull = 0.0f;                   ///< W
    int roundsWithGradients = 0;
    float scale;                      ///< normalises an inverse transform
    pieceSpectrum spectrum;           ///< rows of S going in, rows of X coming out
    pieceSpectrum numerator;          ///< N
    alignedBuffer<float> kernelPower; ///< |K|^2, in pieces
    floatArray x;
};

} // namespace CorvaneDeblur
