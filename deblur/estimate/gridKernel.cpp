#include "deblur/estimate/gridKernel.h"

#include "deblur/estimate/arrayOps.h"
#include "platform/math/vectorOps.h"

#include <algorithm>

namespace CorvaneDeblur
{
namespace
{

/// Position of array element i on a periodic axis of n samples, for an array of `size` whose centre lies at 0.
int wrapped(int i, int size, int n)
{
    const int position = (i - (size - 1) / 2) % n;
    return position < 0 ? position + n : position;
}

void addWrapped(const float *in, int count, float *row, int cols)
{
    for (int c = 0; c < count; ++c)
        row[wrapped(c, count, cols)] += in[c];
}

} // namespace

void forwardKernelRows(const realTransform2d &grid, const floatArray &kernel, complexSample *spectrum)
{
    if (kernel.rows > grid.rows())
    {
        const floatArray placed = floatArray::allocate(grid.rows(), grid.cols());
        fill(placed, 0.0f);
        for (int r = 0; r < kernel.rows; ++r)
            addWrapped(kernel.row(r), kernel.cols, placed.row(wrapped(r, kernel.rows, grid.rows())), grid.cols());
        grid.forwardRows(placed.data, placed.stride, grid.cols(), 0, grid.rows(), spectrum);
        return;
    }
    const floatArray pair = floatArray::allocate(2, grid.cols());
    for (int r = 0; r < kernel.rows; r += 2)
    {
        fill(pair, 0.0f);
        const bool both = r + 1 < kernel.rows;
        addWrapped(kernel.row(r), kernel.cols, pair.row(0), grid.cols());
        if (both)
            addWrapped(kernel.row(r + 1), kernel.cols, pair.row(1), grid.cols());
        grid.forwardPair(pair.row(0), both ? pair.row(1) : nullptr, wrapped(r, kernel.rows, grid.rows()),
                         wrapped(r + 1, kernel.rows, grid.rows()), spectrum);
    }
}

void inverseKernelRows(const realTransform2d &grid, const complexSample *spectrum, const floatArray &out, float scale)
{
    assert(out.rows <= grid.rows() && out.cols <= grid.cols());
    const floatArray pair = floatArray::allocate(2, grid.cols());
    for (int r = 0; r < out.rows; r += 2)
    {
        const int count = std::min(2, out.rows - r);
        grid.inversePair(spectrum, wrapped(r, out.rows, grid.rows()), wrapped(r + 1, out.rows, grid.rows()),
                         pair.row(0), count == 2 ? pair.row(1) : nullptr, scale);
        for (int i = 0; i < count; ++i)
            for (int c = 0; c < out.cols; ++c)
                out.at(r + i, c) = pair.row(i)[wrapped(c, out.cols, grid.cols())];
    }
}

void filterGrid(const floatArray &in, const floatArray &out, const floatArray &kernel, kernelSense sense, workers who)
{
    const realTransform2d grid(in.rows, in.cols, who);
    const pieceSpectrum image(grid.spectrumCount()), placed(grid.spectrumCount());
    grid.forwardRows(in.data, in.stride, in.cols, 0, in.rows, image.data());
    grid.clearRows(0, in.rows, placed.data());
    forwardKernelRows(grid, kernel, placed.data());
    grid.forPieces([&](int piece, const realTransform2d::pieceScratch &scratch) {
        const std::ptrdiff_t first = piece * grid.pieceStride();
        grid.forwardColumns(image.data() + first, scratch(0));
        grid.forwardColumns(placed.data() + first, scratch(1));
        const std::size_t n = static_cast<std::size_t>(grid.pieceStride());
        if (sense == kernelSense::convolve)
            vcMul(n, scratch(0), scratch(1), {1.0f, 0.0f}, scratch(0));
        else
            vcMulByConj(n, scratch(0), scratch(1), scratch(0));
        grid.inverseColumns(scratch(0), image.data() + first);
    });
    const float scale = 1.0f / (static_cast<float>(in.rows) * static_cast<float>(in.cols));
    grid.inverseRows(image.data(), 0, in.rows, out.data, out.stride, in.cols, scale);
}

} // namespace CorvaneDeblur
