#include "deblur/deconv/hyperLaplacianDeconvolver.h"

#include "deblur/deconv/gradientSweep.h"
#include "deblur/deconv/splittingRounds.h"
#include "deblur/estimate/gridKernel.h"
#include "platform/math/multiversion.h"

#include <algorithm>
#include <cmath>

namespace CorvaneDeblur
{
namespace
{

STILLMARK_MULTIVERSION
void setUpPiece(const complexSample *__restrict kernel, const complexSample *__restrict observed, float pull,
                std::ptrdiff_t count, complexSample *__restrict numerator, float *__restrict kernelPower)
{
    for (std::ptrdiff_t i = 0; i < count; ++i)
    {
        const float kr = kernel[i].re, ki = kernel[i].im, yr = observed[i].re, yi = observed[i].im;
        numerator[i].re = (kr + pull) * yr + ki * yi;
        numerator[i].im = (kr + pull) * yi - ki * yr;
        kernelPower[i] = kr * kr + ki * ki;
    }
}

/// X = (N - c * S) / (c * D + |K|^2 + W) of one piece.
STILLMARK_MULTIVERSION
void updatePiece(const complexSample *__restrict numerator, const complexSample *__restrict shrunk,
                 const float *__restrict kernelPower, const float *__restrict dxPower, const float *__restrict dyPower,
                 float c, float pull, int rows, complexSample *__restrict out)
{
    for (int v = 0; v < rows; ++v)
        for (int j = 0; j < columnLanes; ++j)
        {
            const int i = v * columnLanes + j;
            const float denominator = c * (dxPower[j] + dyPower[v]) + kernelPower[i] + pull;
            out[i].re = (numerator[i].re - c * shrunk[i].re) / denominator;
            out[i].im = (numerator[i].im - c * shrunk[i].im) / denominator;
        }
}

/// The same while every shrunk gradient is zero.
STILLMARK_MULTIVERSION
void updatePieceWithoutGradients(const complexSample *__restrict numerator, const float *__restrict kernelPower,
                                 const float *__restrict dxPower, const float *__restrict dyPower, float c, float pull,
                                 int rows, complexSample *__restrict out)
{
    for (int v = 0; v < rows; ++v)
        for (int j = 0; j < columnLanes; ++j)
        {
            const int i = v * columnLanes + j;
            const float denominator = c * (dxPower[j] + dyPower[v]) + kernelPower[i] + pull;
            out[i].re = numerator[i].re / denominator;
            out[i].im = numerator[i].im / denominator;
        }
}

STILLMARK_MULTIVERSION
void fadeRow(float *result, const float *input, float share, int count)
{
    for (int i = 0; i < count; ++i)
        result[i] = (1.0f - share) * result[i] + share * input[i];
}

} // namespace

hyperLaplacianDeconvolver::hyperLaplacianDeconvolver(const floatArray &padded, const shrinkageTableStore &store,
                                                     workers executor)
    : observed(padded), tables(store), who(executor), grid(padded.rows, padded.cols, executor),
      dxPower(differencePower(padded.cols, grid.pieces() * columnLanes)),
      dyPower(differencePower(padded.rows, padded.rows)),
      scale(1.0f / (static_cast<float>(padded.rows) * static_cast<float>(padded.cols))), spectrum(grid.spectrumCount()),
      numerator(grid.spectrumCount()), kernelPower(grid.spectrumCount()),
      x(floatArray::allocate(padded.rows, padded.cols))
{
}

void hyperLaplacianDeconvolver::firstRound(const floatArray &kernel, float c)
{
    // The result spectrum is free until the first solve: it carries the plane in, `numerator` the kernel.
    grid.forwardRows(observed.data, observed.stride, observed.cols, 0, observed.rows, spectrum.data());
    grid.clearRows(0, grid.rows(), numerator.data());
    forwardKernelRows(grid, kernel, numerator.data());
    grid.forPieces([&](int piece, const realTransform2d::pieceScratch &scratch) {
        const std::ptrdiff_t first = piece * grid.pieceStride();
        complexSample *n = numerator.data() + first;
        float *power = kernelPower.data() + first;
        const float *dx = dxPower.data() + static_cast<std::ptrdiff_t>(piece) * columnLanes;
        grid.forwardColumns(spectrum.data() + first, scratch(0));
        grid.forwardColumns(n, scratch(1));
        setUpPiece(scratch(1), scratch(0), pull, grid.pieceStride(), n, power);
        updatePieceWithoutGradients(n, power, dx, dyPower.data(), c, pull, grid.rows(), scratch(2));
        grid.inverseColumns(scratch(2), spectrum.data() + first);
    });
}

void hyperLaplacianDeconvolver::nextRound(float c, bool anyGradient)
{
    grid.forPieces([&](int piece, const realTransform2d::pieceScratch &scratch) {
        const std::ptrdiff_t first = piece * grid.pieceStride();
        const complexSample *n = numerator.data() + first;
        const float *power = kernelPower.data() + first;
        const float *dx = dxPower.data() + static_cast<std::ptrdiff_t>(piece) * columnLanes;
        if (anyGradient)
        {
            grid.forwardColumns(spectrum.data() + first, scratch(0));
            updatePiece(n, scratch(0), power, dx, dyPower.data(), c, pull, grid.rows(), scratch(1));
        }
        else
            updatePieceWithoutGradients(n, power, dx, dyPower.data(), c, pull, grid.rows(), scratch(1));
        grid.inverseColumns(scratch(1), spectrum.data() + first);
    });
}

void hyperLaplacianDeconvolver::finish(const floatArray &out, float suppression) const
{
    grid.inverseRows(spectrum.data(), 0, out.rows, out.data, out.stride, out.cols, scale);
    const float m = std::max(suppression - 0.8f, 0.0f);
    const float share = std::pow(4.0f * m, 4.0f);
    if (share > 0.0f)
        for (int y = 0; y < out.rows; ++y)
            fadeRow(out.row(y), observed.row(y), share, out.cols);
}

void hyperLaplacianDeconvolver::run(const floatArray &out, const floatArray &kernel, float smoothing, float suppression)
{
    // 1/40 - 1/6000 and 1/6000: the data term's weight runs from 6000 at smoothing 0 to 40 at 1.
    const float lambda = 1.0f / (0.024833334f * std::pow(smoothing, 3.0f) + 0.00016666666f);
    pull = 0.7f * std::pow(suppression, 4.0f);
    const std::vector<float> betas = splittingBetas();
    roundsWithGradients = 0;
    firstRound(kernel, betas[0] / lambda);
    for (std::size_t round = 1; round < betas.size(); ++round)
    {
        grid.inverseRows(spectrum.data(), 0, x.rows, x.data, x.stride, x.cols, scale);
        const bool any = shrunkGradientRows(grid, x, tables.prepared(static_cast<int>(round)), spectrum.data(), who);
        roundsWithGradients += any;
        nextRound(betas[round] / lambda, any);
    }
    finish(out, suppression);
}

} // namespace CorvaneDeblur
