#include "tests/reference/spectra.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/filters.h"
#include "deblur/estimate/fourier.h"

using namespace CorvaneDeblur;

namespace Reference
{

complexArray spectrumOf(const floatArray &a)
{
    const complexArray spectrum = complexArray::allocate(a.rows, halfSpectrumCols(a.cols));
    forwardFFT(a, spectrum);
    return spectrum;
}

complexArray centredSpectrum(const floatArray &kernel, int gridRows, int gridCols)
{
    const complexArray spectrum = complexArray::allocate(gridRows, halfSpectrumCols(gridCols));
    placeCentred(kernel, spectrum, gridCols, gridRows);
    return spectrum;
}

floatArray realSpectrum(const floatArray &kernel, int gridRows, int gridCols)
{
    const floatArray real = floatArray::allocate(gridRows, halfSpectrumCols(gridCols));
    realPartInto(centredSpectrum(kernel, gridRows, gridCols), real, complexPart::real);
    return real;
}

floatArray gaussianSpectrum(float sigma, int gridRows, int gridCols)
{
    const int n = 2 * static_cast<int>(3.0f * sigma + 0.5) + 1;
    const floatArray g = floatArray::allocate(n, n);
    gaussianFill(g, sigma);
    return realSpectrum(g, gridRows, gridCols);
}

} // namespace Reference
