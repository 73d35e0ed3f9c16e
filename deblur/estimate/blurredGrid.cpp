#include "deblur/estimate/blurredGrid.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/filters.h"

#include <cmath>
#include <numbers>

namespace CorvaneDeblur
{
namespace
{

double angleOf(int frequency, int size)
{
    return 2.0 * std::numbers::pi * frequency / size;
}

int pieceCols(const realTransform2d &grid)
{
    return grid.pieces() * columnLanes;
}

void differenceSpectrum(int size, int count, std::vector<complexSample> &d, std::vector<float> &power)
{
    d.resize(static_cast<std::size_t>(count));
    power.resize(static_cast<std::size_t>(count));
    for (int f = 0; f < count; ++f)
    {
        const double angle = angleOf(f, size);
        d[static_cast<std::size_t>(f)] = {static_cast<float>(std::cos(angle) - 1.0),
                                          static_cast<float>(std::sin(angle))};
        power[static_cast<std::size_t>(f)] = static_cast<float>(2.0 - 2.0 * std::cos(angle));
    }
}

/// Spectrum of a centred even line of taps, at the first `count` of `size` frequencies.
std::vector<float> evenSpectrum(const floatArray &taps, int size, int count)
{
    const int centre = (taps.cols - 1) / 2;
    std::vector<float> spectrum(static_cast<std::size_t>(count));
    for (int f = 0; f < count; ++f)
    {
        double sum = 0.0;
        for (int i = 0; i < taps.cols; ++i)
            sum += static_cast<double>(taps.row(0)[i]) * std::cos(angleOf(f, size) * (i - centre));
        spectrum[static_cast<std::size_t>(f)] = static_cast<float>(sum);
    }
    return spectrum;
}

} // namespace

lowPassProfile gaussianSpectrum(const realTransform2d &grid, int taps, float sigma)
{
    const floatArray line = floatArray::allocate(1, taps);
    gaussianFill(line, sigma);
    return {evenSpectrum(line, grid.rows(), grid.rows()), evenSpectrum(line, grid.cols(), pieceCols(grid))};
}

lowPassProfile gaussianLowPass(const realTransform2d &grid, float sigma)
{
    const int radius = static_cast<int>(static_cast<double>(3.0f * sigma) + 0.5);
    return gaussianSpectrum(grid, 2 * radius + 1, sigma);
}

blurredGrid::blurredGrid(const floatArray &padded, workers who)
    : grid(padded.rows, padded.cols, who), spectrum(grid.spectrumCount()),
      scale(1.0f / (static_cast<float>(padded.rows) * static_cast<float>(padded.cols)))
{
    grid.forward(padded.data, padded.stride, spectrum.data());
    differenceSpectrum(padded.cols, pieceCols(grid), dx, dxPower);
    differenceSpectrum(padded.rows, padded.rows, dy, dyPower);
}

} // namespace CorvaneDeblur
