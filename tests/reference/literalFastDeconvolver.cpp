#include "tests/reference/literalFastDeconvolver.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/fourier.h"
#include "tests/reference/literalDerivatives.h"

using namespace CorvaneDeblur;

namespace Reference
{

literalFastDeconvolver::literalFastDeconvolver(const floatArray &padded, int derivativesOrder)
    : gridRows(padded.rows), gridCols(padded.cols),
      regulariser(floatArray::allocate(gridRows, halfSpectrumCols(gridCols))),
      dataWeight(floatArray::allocate(gridRows, halfSpectrumCols(gridCols))),
      imageSpectrum(complexArray::allocate(gridRows, halfSpectrumCols(gridCols)))
{
    for (int v = 0; v < gridRows; ++v)
        for (int u = 0; u < regulariser.cols; ++u)
        {
            const complexSample dx = differenceSpectrum(u, gridCols), dy = differenceSpectrum(v, gridRows);
            const float first = norm(dx) + norm(dy);
            const float second = norm(dx * dx) + norm(dy * dy) + norm(dx * dy);
            regulariser.at(v, u) = first;
            dataWeight.at(v, u) = derivativesOrder == 0 ? 25.0f * first + 1.0f : 50.0f + 25.0f * first + 12.5f * second;
        }
    forwardFFT(padded, imageSpectrum);
    multiplySpectrumByReal(imageSpectrum, dataWeight, imageSpectrum);
}

void literalFastDeconvolver::solve(const floatArray &kernel, const floatArray &latent, float mu) const
{
    const complexArray kernelSpectrum = complexArray::allocate(gridRows, regulariser.cols);
    placeCentred(kernel, kernelSpectrum, gridCols, gridRows);

    const complexArray result = complexArray::allocate(gridRows, regulariser.cols);
    for (int v = 0; v < gridRows; ++v)
        for (int u = 0; u < result.cols; ++u)
        {
            const complexSample k = kernelSpectrum.at(v, u);
            complexSample numerator = conj(k) * imageSpectrum.at(v, u);
            if (!lowPass.empty())
                numerator = numerator * lowPass.at(v, u);
            const float denominator = norm(k) * dataWeight.at(v, u) + mu * regulariser.at(v, u);
            result.at(v, u) = {numerator.re / denominator, numerator.im / denominator};
        }

    const floatArray grid = floatArray::allocate(gridRows, gridCols);
    inverseFFT(result, grid, inverseScale::none);
    scaleInto(grid.subRect(0, 0, latent.rows, latent.cols), latent,
              1.0f / (static_cast<float>(gridRows) * static_cast<float>(gridCols)));
}

} // namespace Reference
