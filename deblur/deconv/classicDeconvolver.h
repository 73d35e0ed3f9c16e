#pragma once

#include "deblur/deconv/shrinkageTableStore.h"
#include "deblur/estimate/blurredGrid.h"
#include "platform/math/realTransform2d.h"

#include <vector>

namespace CorvaneDeblur
{

/// The earlier form of hyperLaplacianDeconvolver: suppression works as a second sparse prior, on a low-passed copy of
/// the image (G an 11 x 11 Gaussian, w = 200 * suppression),
///     X = (N - c * (S + w * G * T)) / (c * D * (1 + w * G^2) + |K|^2),   N = conj(K) * Y,
/// T the transform of the low-passed image's shrunk gradients, at 21 times the round's beta; no pull towards the input;
/// and ten steps of de-ringing at the end.
class classicDeconvolver
{
public:
    /// padded: the plane on its periodic grid, kept as a view.
    classicDeconvolver(const floatArray &padded, shrinkageTableStore &tables, workers who);

    void run(const floatArray &out, const floatArray &kernel, float smoothing, float suppression);

    /// Forward transforms of shrunk gradients in the last run: none is done where no gradient survived the shrinkage.
    int gradientTransforms() const { return transformedGradients; }

private:
    struct roundState
    {
        float c;                ///< beta / lambda
        bool gradients, smooth; ///< whether S and T have anything in them
        bool last;
    };
    void setUp(const floatArray &kernel);
    void solve(const roundState &round);
    bool shrinkRows(complexSample *spectrumRows, float beta);

    floatArray observed;
    shrinkageTableStore &tables;
    workers who;
    realTransform2d grid;
    lowPassProfile lowPass;
    std::vector<float> dxPower, dyPower;
    int transformedGradients = 0;
    float smoothWeight = 0.0f;    ///< w
    float scale;                  ///< normalises an inverse transform
    pieceSpectrum spectrum;       ///< rows of S going in, rows of X coming out
    pieceSpectrum smoothSpectrum; ///< rows of T going in, rows of G * X coming out; unused while w is 0
    pieceSpectrum numerator;
    alignedBuffer<float> kernelPower;
    floatArray x;
};

} // namespace CorvaneDeblur
