#include "deblur/estimate/fourier.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/gridKernel.h"

#include <algorithm>

namespace CorvaneDeblur
{
namespace
{

/// Copies between the two layouts of a half spectrum: natural rows, and column pieces.
void naturalFromPieces(const realTransform2d &grid, const complexSample *pieces, const complexArray &natural)
{
    for (int v = 0; v < natural.rows; ++v)
        for (int u = 0; u < natural.cols; u += columnLanes)
            std::copy_n(pieces + u / columnLanes * grid.pieceStride() + static_cast<std::ptrdiff_t>(v) * columnLanes,
                        std::min(columnLanes, natural.cols - u), natural.row(v) + u);
}

void piecesFromNatural(const realTransform2d &grid, const complexArray &natural, complexSample *pieces)
{
    for (int v = 0; v < natural.rows; ++v)
        for (int u = 0; u < natural.cols; u += columnLanes)
        {
            complexSample *to =
                pieces + u / columnLanes * grid.pieceStride() + static_cast<std::ptrdiff_t>(v) * columnLanes;
            const int count = std::min(columnLanes, natural.cols - u);
            std::copy_n(natural.row(v) + u, count, to);
            std::fill(to + count, to + columnLanes, complexSample{0.0f, 0.0f});
        }
}

void filter(const floatArray &src, const floatArray &dst, const floatArray &kernel, borderMode border,
            kernelSense sense)
{
    if (border == borderMode::circular)
    {
        filterGrid(src, dst, kernel, sense, workers::all);
        return;
    }
    const int marginRows = kernel.rows / 2, marginCols = kernel.cols / 2;
    const floatArray padded = padArray(src, marginRows, marginRows, marginCols, marginCols, border);
    filterGrid(padded, padded, kernel, sense, workers::all);
    copyTo(padded.subRect(marginRows, marginCols, src.rows, src.cols), dst);
}

} // namespace

void forwardFFT(const floatArray &a, const complexArray &spectrum)
{
    assert(spectrum.rows == a.rows && spectrum.cols == halfSpectrumCols(a.cols));
    const realTransform2d grid(a.rows, a.cols, workers::all);
    const pieceSpectrum pieces(grid.spectrumCount());
    grid.forward(a.data, a.stride, pieces.data());
    naturalFromPieces(grid, pieces.data(), spectrum);
}

void inverseFFT(const complexArray &spectrum, const floatArray &a, inverseScale scale)
{
    assert(spectrum.rows == a.rows && spectrum.cols == halfSpectrumCols(a.cols));
    const realTransform2d grid(a.rows, a.cols, workers::all);
    const pieceSpectrum pieces(grid.spectrumCount());
    piecesFromNatural(grid, spectrum, pieces.data());
    const float factor =
        scale == inverseScale::none ? 1.0f : 1.0f / (static_cast<float>(a.rows) * static_cast<float>(a.cols));
    grid.inverse(pieces.data(), a.data, a.stride, factor);
}

void placeCentred(const floatArray &kernel, const complexArray &spectrum, int gridCols, int gridRows)
{
    assert(spectrum.rows == gridRows && spectrum.cols == halfSpectrumCols(gridCols));
    const realTransform2d grid(gridRows, gridCols, workers::all);
    const pieceSpectrum pieces(grid.spectrumCount());
    grid.clearRows(0, gridRows, pieces.data());
    forwardKernelRows(grid, kernel, pieces.data());
    grid.forPieces([&](int piece, const realTransform2d::pieceScratch &scratch) {
        complexSample *samples = pieces.data() + piece * grid.pieceStride();
        grid.forwardColumns(samples, scratch(0));
        std::copy_n(scratch(0), grid.pieceStride(), samples);
    });
    naturalFromPieces(grid, pieces.data(), spectrum);
}

void gatherCentred(const complexArray &spectrum, const floatArray &out, int gridCols, int gridRows)
{
    assert(spectrum.rows == gridRows && spectrum.cols == halfSpectrumCols(gridCols));
    const realTransform2d grid(gridRows, gridCols, workers::all);
    const pieceSpectrum pieces(grid.spectrumCount());
    piecesFromNatural(grid, spectrum, pieces.data());
    grid.forPieces([&](int piece, const realTransform2d::pieceScratch &scratch) {
        complexSample *samples = pieces.data() + piece * grid.pieceStride();
        grid.inverseColumns(samples, scratch(0));
        std::copy_n(scratch(0), grid.pieceStride(), samples);
    });
    inverseKernelRows(grid, pieces.data(), out, 1.0f / (static_cast<float>(gridRows) * static_cast<float>(gridCols)));
}

floatArray padArray(const floatArray &src, int top, int bottom, int left, int right, borderMode mode, float value)
{
    const floatArray out = floatArray::allocate(src.rows + top + bottom, src.cols + left + right);
    for (int y = 0; y < out.rows; ++y)
    {
        float *row = out.row(y);
        const bool inside = y >= top && y < top + src.rows;
        if (!inside && mode == borderMode::constant)
        {
            std::fill_n(row, out.cols, value);
            continue;
        }
        const float *from = src.row(std::clamp(y - top, 0, src.rows - 1));
        std::fill_n(row, left, mode == borderMode::constant ? value : from[0]);
        std::copy_n(from, src.cols, row + left);
        std::fill_n(row + left + src.cols, right, mode == borderMode::constant ? value : from[src.cols - 1]);
    }
    return out;
}

void convolveFFT(const floatArray &src, const floatArray &dst, const floatArray &kernel, borderMode border)
{
    filter(src, dst, kernel, border, kernelSense::convolve);
}

void correlateFFT(const floatArray &src, const floatArray &dst, const floatArray &kernel, borderMode border)
{
    filter(src, dst, kernel, border, kernelSense::correlate);
}

} // namespace CorvaneDeblur
