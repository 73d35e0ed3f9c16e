#include "deblur/estimate/fastDeconvolver.h"

#include "deblur/estimate/gridKernel.h"
#include "platform/math/multiversion.h"

#include <algorithm>

namespace CorvaneDeblur
{
namespace
{

/// Tables of one column piece: columnLanes values along u, all rows along v.
struct pieceTables
{
    const float *dxPower, *dyPower;
    const float *lowPassCols, *lowPassRows;
};

STILLMARK_MULTIVERSION
void solvePiece(const complexSample *__restrict kernel, const complexSample *__restrict observed, const pieceTables &t,
                bool secondOrder, float mu, int rows, complexSample *__restrict out)
{
    for (int v = 0; v < rows; ++v)
    {
        const float b = t.dyPower[v], rowPass = t.lowPassRows[v];
        for (int j = 0; j < columnLanes; ++j)
        {
            const int i = v * columnLanes + j;
            const float a = t.dxPower[j];
            const float regulariser = a + b;
            const float weight = secondOrder ? 50.0f + 25.0f * regulariser + 12.5f * (a * a + b * b + a * b)
                                             : 25.0f * regulariser + 1.0f;
            const float kr = kernel[i].re, ki = kernel[i].im;
            const float yr = observed[i].re * weight, yi = observed[i].im * weight;
            const float pass = rowPass * t.lowPassCols[j];
            const float denominator = (kr * kr + ki * ki) * weight + mu * regulariser;
            out[i].re = (kr * yr + ki * yi) * pass / denominator;
            out[i].im = (kr * yi - ki * yr) * pass / denominator;
        }
    }
}

} // namespace

fastDeconvolver::fastDeconvolver(const blurredGrid &b, derivativeOrder o)
    : blurred(b), order(o), kernelRows(b.grid.spectrumCount()), result(b.grid.spectrumCount())
{
    blurred.grid.clearRows(0, blurred.grid.rows(), kernelRows.data());
    lowPass.rows.assign(static_cast<std::size_t>(blurred.grid.rows()), 1.0f);
    lowPass.cols.assign(blurred.dxPower.size(), 1.0f);
}

void fastDeconvolver::solve(const floatArray &kernel, const floatArray &latent, float mu)
{
    const realTransform2d &grid = blurred.grid;
    forwardKernelRows(grid, kernel, kernelRows.data());
    grid.forPieces([&](int piece, const realTransform2d::pieceScratch &scratch) {
        const std::ptrdiff_t first = piece * grid.pieceStride();
        const std::ptrdiff_t col = static_cast<std::ptrdiff_t>(piece) * columnLanes;
        grid.forwardColumns(kernelRows.data() + first, scratch(0));
        const pieceTables tables{blurred.dxPower.data() + col, blurred.dyPower.data(), lowPass.cols.data() + col,
                                 lowPass.rows.data()};
        solvePiece(scratch(0), blurred.spectrum.data() + first, tables, order == derivativeOrder::second, mu,
                   grid.rows(), scratch(1));
        grid.inverseColumns(scratch(1), result.data() + first);
    });
    grid.inverseRows(result.data(), 0, latent.rows, latent.data, latent.stride, latent.cols, blurred.scale);
}

} // namespace CorvaneDeblur
