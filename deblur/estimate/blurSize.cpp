#include "deblur/estimate/blurSize.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/filters.h"
#include "deblur/estimate/fourier.h"
#include "deblur/estimate/resample.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <utility>
#include <vector>

namespace CorvaneDeblur
{
namespace
{

/// Side of the autocorrelation that is looked at: odd, at most 81, within the grid.
int correlationSide(const floatArray &padded)
{
    const int side = std::min(81, std::min(padded.rows, padded.cols) / 2);
    return side % 2 == 0 ? side + 1 : side;
}

complexArray spectrumOf(const floatArray &a)
{
    const complexArray spectrum = complexArray::allocate(a.rows, halfSpectrumCols(a.cols));
    forwardFFT(a, spectrum);
    return spectrum;
}

/// Spectrum of a 3 x 3 filter, centred, on the grid of `like`.
complexArray filterSpectrum(const std::array<float, 9> &taps, const floatArray &like)
{
    const floatArray filter = floatArray::allocate(3, 3);
    std::copy(taps.begin(), taps.end(), filter.data);
    const complexArray spectrum = complexArray::allocate(like.rows, halfSpectrumCols(like.cols));
    placeCentred(filter, spectrum, like.cols, like.rows);
    return spectrum;
}

floatArray centreOf(const complexArray &spectrum, const floatArray &grid)
{
    const int side = correlationSide(grid);
    const floatArray correlation = floatArray::allocate(side, side);
    gatherCentred(spectrum, correlation, grid.cols, grid.rows);
    return correlation;
}

blurExtent halfOf(blurExtent extent)
{
    return {extent.cols / 2, extent.rows / 2};
}

/// From half extents on the small image to a size on one axis of the window: at least 31, above 150 only as far as a
/// tenth of the image.
int sizeOnAxis(int windowLength, int smallLength, int extentSum, int imageLength)
{
    const float scaled =
        static_cast<float>(windowLength) * static_cast<float>(extentSum / 2) / static_cast<float>(smallLength);
    int size = std::max(31, 2 * static_cast<int>(scaled + 0.5f));
    if (size > 150)
        size = std::min(size, std::max(150, imageLength / 10));
    return size % 2 == 0 ? size + 1 : size;
}

} // namespace

blurExtent connectedExtent(const floatArray &a)
{
    const float limit = 0.01f * peak(a);
    const int centreX = (a.cols - 1) / 2, centreY = (a.rows - 1) / 2;
    std::vector<char> seen(static_cast<std::size_t>(a.rows) * a.cols, 0);
    std::vector<std::pair<int, int>> queue{{centreX, centreY}};
    seen[static_cast<std::size_t>(centreY) * a.cols + centreX] = 1;
    int left = centreX, right = centreX, top = centreY, bottom = centreY;
    for (std::size_t next = 0; next < queue.size(); ++next)
    {
        const auto [x, y] = queue[next];
        left = std::min(left, x);
        right = std::max(right, x);
        top = std::min(top, y);
        bottom = std::max(bottom, y);
        for (int ny = std::max(y - 1, 0); ny <= std::min(y + 1, a.rows - 1); ++ny)
        {
            for (int nx = std::max(x - 1, 0); nx <= std::min(x + 1, a.cols - 1); ++nx)
            {
                char &visited = seen[static_cast<std::size_t>(ny) * a.cols + nx];
                if (visited || !(a.at(ny, nx) > limit))
                    continue;
                visited = 1;
                queue.emplace_back(nx, ny);
            }
        }
    }
    return {right - left + 1, bottom - top + 1};
}

blurExtent extentFromGradients(const floatArray &padded)
{
    const floatArray gradient = floatArray::allocate(padded.rows, padded.cols);
    circularDiffX(padded, gradient);
    const complexArray spectrumX = spectrumOf(gradient);
    circularDiffY(padded, gradient);
    const complexArray spectrumY = spectrumOf(gradient);
    // A Laplacian stands for the spectrum that gradients have without any blur. Its transform is real.
    const complexArray noise = filterSpectrum({0, -1, 0, -1, 4, -1, 0, -1, 0}, padded);

    constexpr float strength = 35.5f;
    for (int y = 0; y < spectrumX.rows; ++y)
    {
        complexSample *gx = spectrumX.row(y);
        const complexSample *gy = spectrumY.row(y);
        const complexSample *filter = noise.row(y);
        for (int x = 0; x < spectrumX.cols; ++x)
        {
            const float power = norm(gx[x]) + norm(gy[x]);
            gx[x] = {power / (power + strength * filter[x].re + strength), 0.0f};
        }
    }

    const floatArray correlation = centreOf(spectrumX, padded);
    thresholdInto(correlation, correlation, 0.05f * peak(correlation));
    normaliseSum(correlation);
    for (int y = 0; y < correlation.rows; ++y)
        std::transform(correlation.row(y), correlation.row(y) + correlation.cols, correlation.row(y),
                       [](float value) { return std::sqrt(value); });
    return halfOf(connectedExtent(correlation));
}

blurExtent extentFromMixedDerivative(const floatArray &padded)
{
    const floatArray alongX = floatArray::allocate(padded.rows, padded.cols);
    const floatArray mixed = floatArray::allocate(padded.rows, padded.cols);
    circularDiffX(padded, alongX);
    circularDiffY(alongX, mixed);
    const complexArray spectrum = spectrumOf(mixed);
    const complexArray filter = filterSpectrum({0, -1, 1, 0, 1, -1, 0, 0, 0}, padded);

    for (int y = 0; y < spectrum.rows; ++y)
    {
        complexSample *d = spectrum.row(y);
        const complexSample *f = filter.row(y);
        for (int x = 0; x < spectrum.cols; ++x)
            d[x] = {norm(d[x]) / (norm(f[x]) + 10.0f), 0.0f};
    }

    const floatArray correlation = centreOf(spectrum, padded);
    thresholdInto(correlation, correlation, 0.1f * peak(correlation));
    return halfOf(connectedExtent(correlation));
}

int blurSizeOfWindow(const floatArray &window, int imageCols, int imageRows)
{
    // A quarter of the scale is fine enough, and quick.
    const int smallCols = std::min(std::max(window.cols / 4, 100), window.cols);
    const int smallRows = std::min(std::max(window.rows / 4, 100), window.rows);
    const floatArray small = floatArray::allocate(smallRows, smallCols);
    resize(window, small);

    const floatArray padded = floatArray::allocate(smallRows + 20, smallCols + 20);
    taperedExtension(small, padded, 21, 21);
    const floatArray gaussian = floatArray::allocate(5, 5);
    gaussianFill(gaussian, 5.0f / 6.0f);
    convolveFFT(padded, padded, gaussian, borderMode::circular);

    const blurExtent a = extentFromGradients(padded);
    const blurExtent b = extentFromMixedDerivative(padded);
    return std::max(sizeOnAxis(window.cols, smallCols, a.cols + b.cols, imageCols),
                    sizeOnAxis(window.rows, smallRows, a.rows + b.rows, imageRows));
}

} // namespace CorvaneDeblur
