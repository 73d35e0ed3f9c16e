#include "tests/reference/literalHyperLaplacian.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/fourier.h"
#include "tests/reference/literalSplitting.h"
#include "tests/reference/spectra.h"

#include <algorithm>
#include <cmath>

using namespace CorvaneDeblur;

namespace Reference
{

void literalHyperLaplacian(const floatArray &padded, const floatArray &kernel, float smoothing, float suppression,
                           const shrinkageTableStore &tables, const floatArray &out)
{
    const float pull = 0.7f * std::pow(suppression, 4.0f);
    const float lambda = 1.0f / (0.024833334f * std::pow(smoothing, 3.0f) + 0.00016666666f);
    const float betaRate = std::sqrt(2.0f) + std::sqrt(2.0f);

    const floatArray d = laplacianSpectrum(padded.rows, padded.cols);
    const complexArray k = centredSpectrum(kernel, padded.rows, padded.cols);
    const complexArray y = spectrumOf(padded);
    const floatArray k2 = powerOf(k);
    const complexArray n = complexArray::allocate(k.rows, k.cols);
    for (int v = 0; v < k.rows; ++v)
        for (int u = 0; u < k.cols; ++u)
        {
            const complexSample weight = conj(k.at(v, u)) + complexSample{pull, 0.0f};
            n.at(v, u) = weight * y.at(v, u);
        }

    const floatArray x = floatArray::allocate(padded.rows, padded.cols);
    fill(x, 0.0f);
    const complexArray solution = complexArray::allocate(k.rows, k.cols);
    float beta = 1.0f;
    for (int round = 0; beta < 256.0f; ++round, beta *= betaRate)
    {
        const float c = beta / lambda;
        const complexArray s = shrunkGradientSpectrum(x, tables.prepared(round));
        for (int v = 0; v < k.rows; ++v)
            for (int u = 0; u < k.cols; ++u)
            {
                const complexSample numerator = n.at(v, u) - s.at(v, u) * c;
                const float denominator = c * d.at(v, u) + k2.at(v, u) + pull;
                solution.at(v, u) = {numerator.re / denominator, numerator.im / denominator};
            }
        inverseFFT(solution, x, inverseScale::normalised);
    }

    const float fade = std::pow(4.0f * std::max(suppression - 0.8f, 0.0f), 4.0f);
    combine(1.0f - fade, x.subRect(0, 0, out.rows, out.cols), fade, padded.subRect(0, 0, out.rows, out.cols), out);
}

} // namespace Reference
