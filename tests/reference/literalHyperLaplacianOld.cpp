#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/filters.h"
#include "deblur/estimate/fourier.h"
#include "tests/reference/literalHyperLaplacian.h"
#include "tests/reference/literalSplitting.h"
#include "tests/reference/spectra.h"

#include <algorithm>
#include <cmath>

using namespace CorvaneDeblur;

namespace Reference
{
namespace
{

void dering(const floatArray &out)
{
    const floatArray l = floatArray::allocate(out.rows, out.cols);
    for (int round = 0; round < 10; ++round)
    {
        laplacian(out, l, laplacianEdge::centre);
        for (int y = 0; y < out.rows; ++y)
            for (int x = 0; x < out.cols; ++x)
                out.at(y, x) -= 0.2f * l.at(y, x) * std::min(1.0f, 0.25f * std::abs(l.at(y, x)));
    }
}

} // namespace

void literalHyperLaplacianOld(const floatArray &padded, const floatArray &kernel, float smoothing, float suppression,
                              shrinkageTableStore &tables, const floatArray &out)
{
    const float alpha = 2.0f / 3.0f;
    const float smoothWeight = 200.0f * suppression;
    const float lambda = 1.0f / (0.02475f * smoothing * smoothing + 0.00025f);
    const float betaRate = std::sqrt(2.0f) + std::sqrt(2.0f);

    const floatArray gaussian = floatArray::allocate(11, 11);
    gaussianFill(gaussian, 11.0f / 6.0f);
    const floatArray gs = realSpectrum(gaussian, padded.rows, padded.cols);
    const floatArray d = laplacianSpectrum(padded.rows, padded.cols);
    const complexArray k = centredSpectrum(kernel, padded.rows, padded.cols);
    const complexArray n = spectrumOf(padded);
    multiplySpectrumByConj(n, k, n);
    const floatArray k2 = powerOf(k);

    const floatArray x = floatArray::allocate(padded.rows, padded.cols);
    fill(x, 0.0f);
    const complexArray solution = complexArray::allocate(k.rows, k.cols);
    const complexArray spent = complexArray::allocate(k.rows, k.cols); // the inverse transform overwrites its input
    for (float beta = 1.0f; beta < 256.0f; beta *= betaRate)
    {
        const float c = beta / lambda;
        complexArray t = complexArray::allocate(k.rows, k.cols);
        const complexArray s = shrunkGradientSpectrum(x, *tables.findTable(alpha, beta));
        if (smoothWeight > 0.0f)
        {
            multiplySpectrumByReal(solution, gs, spent);
            inverseFFT(spent, x, inverseScale::normalised);
            t = shrunkGradientSpectrum(x, *tables.findTable(alpha, 21.0f * beta));
        }
        for (int v = 0; v < k.rows; ++v)
            for (int u = 0; u < k.cols; ++u)
            {
                const float g = gs.at(v, u);
                const complexSample prior = s.at(v, u) + t.at(v, u) * (smoothWeight * g);
                const complexSample numerator = n.at(v, u) - prior * c;
                const float denominator = c * d.at(v, u) * (1.0f + smoothWeight * g * g) + k2.at(v, u);
                solution.at(v, u) = {numerator.re / denominator, numerator.im / denominator};
            }
        std::copy_n(solution.data, solution.rows * solution.cols, spent.data);
        inverseFFT(spent, x, inverseScale::normalised);
    }

    copyTo(x.subRect(0, 0, out.rows, out.cols), out);
    dering(out);
}

} // namespace Reference
