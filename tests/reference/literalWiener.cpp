#include "tests/reference/literalWiener.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/fourier.h"
#include "tests/reference/spectra.h"

using namespace CorvaneDeblur;

namespace Reference
{

void literalWiener(const floatArray &padded, const floatArray &kernel, float smoothing, const floatArray &out)
{
    const float reg = smoothing * smoothing * 0.095f + 0.005f;
    const complexArray observed = spectrumOf(padded);
    const complexArray kernelSpectrum = centredSpectrum(kernel, padded.rows, padded.cols);
    const complexArray result = complexArray::allocate(observed.rows, observed.cols);
    for (int v = 0; v < padded.rows; ++v)
        for (int u = 0; u < result.cols; ++u)
        {
            const complexSample k = kernelSpectrum.at(v, u);
            const complexSample numerator = conj(k) * observed.at(v, u);
            const float denominator = norm(k) + reg;
            result.at(v, u) = {numerator.re / denominator, numerator.im / denominator};
        }

    const floatArray grid = floatArray::allocate(padded.rows, padded.cols);
    inverseFFT(result, grid, inverseScale::none);
    scaleInto(grid.subRect(0, 0, out.rows, out.cols), out,
              (1.0f + reg) / (static_cast<float>(padded.rows) * static_cast<float>(padded.cols)));
}

} // namespace Reference
