#include "deblur/deconv/classicDeconvolver.h"

#include "deblur/deconv/gradientSweep.h"
#include "deblur/deconv/splittingRounds.h"
#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/filters.h"
#include "deblur/estimate/gridKernel.h"
#include "platform/math/multiversion.h"

#include <algorithm>
#include <cmath>

namespace CorvaneDeblur
{
namespace
{

constexpr int gaussianTaps = 11;
constexpr float smoothBetaFactor = 21.0f;
constexpr int deringingSteps = 10;

/// What one column piece needs; all tables start at the piece.
struct piece
{
    const complexSample *numerator;
    const float *kernelPower, *dxPower, *dyPower, *lowPassCols, *lowPassRows;
    float c, smoothWeight;
    int rows;
};

STILLMARK_MULTIVERSION
void setUpPiece(const complexSample *__restrict kernel, const complexSample *__restrict observed, std::ptrdiff_t count,
                complexSample *__restrict numerator, float *__restrict kernelPower)
{
    for (std::ptrdiff_t i = 0; i < count; ++i)
    {
        numerator[i] = conj(kernel[i]) * observed[i];
        kernelPower[i] = norm(kernel[i]);
    }
}

/// X of one piece into out, and G * X into smoothOut.
STILLMARK_MULTIVERSION
void updatePiece(const piece &p, const complexSample *__restrict shrunk, const complexSample *__restrict smoothShrunk,
                 complexSample *__restrict out, complexSample *__restrict smoothOut)
{
    for (int v = 0; v < p.rows; ++v)
        for (int j = 0; j < columnLanes; ++j)
        {
            const int i = v * columnLanes + j;
            const float g = p.lowPassRows[v] * p.lowPassCols[j];
            const float w = p.smoothWeight * g;
            const float denominator = p.c * (p.dxPower[j] + p.dyPower[v]) * (1.0f + w * g) + p.kernelPower[i];
            out[i].re = (p.numerator[i].re - p.c * (shrunk[i].re + w * smoothShrunk[i].re)) / denominator;
            out[i].im = (p.numerator[i].im - p.c * (shrunk[i].im + w * smoothShrunk[i].im)) / denominator;
            smoothOut[i].re = out[i].re * g;
            smoothOut[i].im = out[i].im * g;
        }
}

/// out -= 0.2 * L * min(1, |L| / 4), L the negative Laplacian: takes the overshoot off edges.
void dering(const floatArray &out)
{
    const floatArray bend = floatArray::allocate(out.rows, out.cols);
    for (int step = 0; step < deringingSteps; ++step)
    {
        laplacian(out, bend, laplacianEdge::centre);
        for (int y = 0; y < out.rows; ++y)
            for (int i = 0; i < out.cols; ++i)
            {
                const float l = bend.row(y)[i];
                out.row(y)[i] -= 0.2f * l * std::min(1.0f, 0.25f * std::fabs(l));
            }
    }
}

} // namespace

classicDeconvolver::classicDeconvolver(const floatArray &padded, shrinkageTableStore &store, workers executor)
    : observed(padded), tables(store), who(executor), grid(padded.rows, padded.cols, executor),
      lowPass(gaussianSpectrum(grid, gaussianTaps, static_cast<float>(gaussianTaps) / 6.0f)),
      dxPower(differencePower(padded.cols, grid.pieces() * columnLanes)),
      dyPower(differencePower(padded.rows, padded.rows)),
      scale(1.0f / (static_cast<float>(padded.rows) * static_cast<float>(padded.cols))), spectrum(grid.spectrumCount()),
      smoothSpectrum(grid.spectrumCount()), numerator(grid.spectrumCount()), kernelPower(grid.spectrumCount()),
      x(floatArray::allocate(padded.rows, padded.cols))
{
}

void classicDeconvolver::setUp(const floatArray &kernel)
{
    grid.forwardRows(observed.data, observed.stride, observed.cols, 0, observed.rows, spectrum.data());
    grid.clearRows(0, grid.rows(), numerator.data());
    forwardKernelRows(grid, kernel, numerator.data());
    grid.forPieces([&](int index, const realTransform2d::pieceScratch &scratch) {
        const std::ptrdiff_t first = index * grid.pieceStride();
        grid.forwardColumns(spectrum.data() + first, scratch(0));
        grid.forwardColumns(numerator.data() + first, scratch(1));
        setUpPiece(scratch(1), scratch(0), grid.pieceStride(), numerator.data() + first, kernelPower.data() + first);
    });
}

void classicDeconvolver::solve(const roundState &round)
{
    grid.forPieces([&](int index, const realTransform2d::pieceScratch &scratch) {
        const std::ptrdiff_t first = index * grid.pieceStride(), count = grid.pieceStride();
        const std::ptrdiff_t col = static_cast<std::ptrdiff_t>(index) * columnLanes;
        const auto forward = [&](bool present, const pieceSpectrum &from, complexSample *to) {
            if (present)
                grid.forwardColumns(from.data() + first, to);
            else
                std::fill_n(to, count, complexSample{0.0f, 0.0f});
        };
        forward(round.gradients, spectrum, scratch(0));
        forward(round.smooth, smoothSpectrum, scratch(1));
        const piece p{numerator.data() + first,
                      kernelPower.data() + first,
                      dxPower.data() + col,
                      dyPower.data(),
                      lowPass.cols.data() + col,
                      lowPass.rows.data(),
                      round.c,
                      smoothWeight,
                      grid.rows()};
        updatePiece(p, scratch(0), scratch(1), scratch(2), scratch(3));
        grid.inverseColumns(scratch(2), spectrum.data() + first);
        if (smoothWeight > 0.0f)
            grid.inverseColumns(scratch(3), smoothSpectrum.data() + first);
    });
}

bool classicDeconvolver::shrinkRows(complexSample *spectrumRows, float beta)
{
    grid.inverseRows(spectrumRows, 0, x.rows, x.data, x.stride, x.cols, scale);
    return shrunkGradientRows(grid, x, *tables.findTable(priorExponent, beta), spectrumRows, who);
}

void classicDeconvolver::run(const floatArray &out, const floatArray &kernel, float smoothing, float suppression)
{
    smoothWeight = 200.0f * suppression;
    transformedGradients = 0;
    const float lambda = 1.0f / (0.02475f * smoothing * smoothing + 0.00025f);
    setUp(kernel);
    roundState round{0.0f, false, false, false};
    const std::vector<float> betas = splittingBetas();
    for (std::size_t i = 0; i < betas.size(); ++i)
    {
        if (i > 0)
        {
            round.gradients = shrinkRows(spectrum.data(), betas[i]);
            round.smooth = smoothWeight > 0.0f && shrinkRows(smoothSpectrum.data(), smoothBetaFactor * betas[i]);
        }
        transformedGradients += round.gradients + round.smooth;
        round.c = betas[i] / lambda;
        round.last = i + 1 == betas.size();
        solve(round);
    }
    grid.inverseRows(spectrum.data(), 0, out.rows, out.data, out.stride, out.cols, scale);
    dering(out);
}

} // namespace CorvaneDeblur
