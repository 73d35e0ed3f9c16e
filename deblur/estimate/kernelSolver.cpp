#include "deblur/estimate/kernelSolver.h"

#include "deblur/deconv/fastSize.h"
#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/filters.h"
#include "deblur/estimate/gridKernel.h"
#include "deblur/estimate/resample.h"
#include "platform/math/multiversion.h"

#include <algorithm>
#include <cmath>

namespace CorvaneDeblur
{
namespace
{

struct pieceTables
{
    const complexSample *dx, *dy;
    const float *lowPassCols, *lowPassRows;
};

/// Right-hand side and operator of one column piece with first derivatives: the blurred gradients are D * S.
STILLMARK_MULTIVERSION
void firstOrderPiece(const complexSample *__restrict sharpX, const complexSample *__restrict sharpY,
                     const complexSample *__restrict observed, const pieceTables &t, int rows,
                     complexSample *__restrict side, complexSample *__restrict power)
{
    for (int v = 0; v < rows; ++v)
    {
        const complexSample dy = t.dy[v];
        const float rowPass = t.lowPassRows[v];
        for (int j = 0; j < columnLanes; ++j)
        {
            const int i = v * columnLanes + j;
            const complexSample x = sharpX[i], y = sharpY[i];
            const complexSample matched = t.dx[j] * conj(x) + dy * conj(y);
            side[i] = observed[i] * matched * (rowPass * t.lowPassCols[j]);
            power[i] = {norm(x) + norm(y), 0.0f};
        }
    }
}

/// The same with second derivatives: 25 times the first ones, 12.5 times Dxx, Dyy and the symmetric Dxy.
STILLMARK_MULTIVERSION
void secondOrderPiece(const complexSample *__restrict sharpX, const complexSample *__restrict sharpY,
                      const complexSample *__restrict observed, const pieceTables &t, int rows,
                      complexSample *__restrict side, complexSample *__restrict power)
{
    for (int v = 0; v < rows; ++v)
    {
        const complexSample dy = t.dy[v];
        const float rowPass = t.lowPassRows[v];
        for (int j = 0; j < columnLanes; ++j)
        {
            const int i = v * columnLanes + j;
            const complexSample dx = t.dx[j], x = sharpX[i], y = sharpY[i];
            const complexSample xx = dx * x, yy = dy * y, xy = (dy * x + dx * y) * 0.5f;
            // Dx * Dy is what 0.5 * (Dy * Dx + Dx * Dy) of the blurred image comes to.
            const complexSample matched = (dx * conj(x) + dy * conj(y)) * 25.0f +
                                          (dx * dx * conj(xx) + dy * dy * conj(yy) + dx * dy * conj(xy)) * 12.5f;
            side[i] = observed[i] * matched * (rowPass * t.lowPassCols[j]);
            power[i] = {25.0f * (norm(x) + norm(y)) + 12.5f * (norm(xx) + norm(yy) + norm(xy)), 0.0f};
        }
    }
}

void takeRealParts(const complexSample *in, std::ptrdiff_t count, float *out)
{
    for (std::ptrdiff_t i = 0; i < count; ++i)
        out[i] = in[i].re;
}

STILLMARK_MULTIVERSION
void multiplyByReal(complexSample *samples, const float *factors, std::ptrdiff_t count)
{
    for (std::ptrdiff_t i = 0; i < count; ++i)
        samples[i] = samples[i] * factors[i];
}

} // namespace

kernelSolver::kernelSolver(const blurredGrid &b, int rows, int cols, derivativeOrder o)
    : blurred(b), kernelRows(rows), kernelCols(cols), order(o), sharpX(b.grid.spectrumCount()),
      sharpY(b.grid.spectrumCount()), side(b.grid.spectrumCount()), lags(b.grid.spectrumCount()),
      smallGrid(fastSize(2 * rows - 1), fastSize(2 * cols - 1), workers::one), smallOperator(smallGrid.spectrumCount()),
      smallSpectrum(smallGrid.spectrumCount()), smallResult(smallGrid.spectrumCount()),
      correlated(floatArray::allocate(rows, cols))
{
    assert(blurred.grid.rows() >= 2 * rows - 1 && blurred.grid.cols() >= 2 * cols - 1);
    lowPass.rows.assign(static_cast<std::size_t>(blurred.grid.rows()), 1.0f);
    lowPass.cols.assign(blurred.dxPower.size(), 1.0f);
}

void kernelSolver::keepKernelRows(const complexSample *columns, int reach, complexSample *spectrum) const
{
    const std::ptrdiff_t kept = static_cast<std::ptrdiff_t>(reach) * columnLanes;
    const std::ptrdiff_t all = blurred.grid.pieceStride();
    if (2 * kept >= all)
    {
        std::copy_n(columns, all, spectrum);
        return;
    }
    std::copy_n(columns, kept, spectrum);
    std::copy_n(columns + all - kept, kept, spectrum + all - kept);
}

void kernelSolver::multiplyColumns()
{
    const realTransform2d &grid = blurred.grid;
    grid.forPieces([&](int piece, const realTransform2d::pieceScratch &scratch) {
        const std::ptrdiff_t first = piece * grid.pieceStride();
        const std::ptrdiff_t col = static_cast<std::ptrdiff_t>(piece) * columnLanes;
        grid.forwardColumns(sharpX.data() + first, scratch(0));
        grid.forwardColumns(sharpY.data() + first, scratch(1));
        const pieceTables tables{blurred.dx.data() + col, blurred.dy.data(), lowPass.cols.data() + col,
                                 lowPass.rows.data()};
        const auto multiply = order == derivativeOrder::first ? firstOrderPiece : secondOrderPiece;
        multiply(scratch(0), scratch(1), blurred.spectrum.data() + first, tables, grid.rows(), scratch(2), scratch(3));
        // Row frequencies past the grid's own half are padding of the last piece; they are never read.
        grid.inverseColumns(scratch(2), scratch(0));
        keepKernelRows(scratch(0), kernelRows, side.data() + first);
        grid.inverseColumns(scratch(3), scratch(1));
        keepKernelRows(scratch(1), kernelRows, lags.data() + first);
    });
}

void kernelSolver::prepare(const floatArray &gradX, const floatArray &gradY)
{
    const realTransform2d &grid = blurred.grid;
    if (gradientRows != gradX.rows)
    {
        gradientRows = gradX.rows;
        grid.clearRows(gradientRows, grid.rows() - gradientRows, sharpX.data());
        grid.clearRows(gradientRows, grid.rows() - gradientRows, sharpY.data());
    }
    grid.forwardRows(gradX.data, gradX.stride, gradX.cols, 0, gradientRows, sharpX.data());
    grid.forwardRows(gradY.data, gradY.stride, gradY.cols, 0, gradientRows, sharpY.data());
    multiplyColumns();

    const floatArray reach = floatArray::allocate(2 * kernelRows - 1, 2 * kernelCols - 1);
    inverseKernelRows(grid, lags.data(), reach, blurred.scale);
    smallGrid.clearRows(0, smallGrid.rows(), smallSpectrum.data());
    forwardKernelRows(smallGrid, reach, smallSpectrum.data());
    smallGrid.forPieces([&](int piece, const realTransform2d::pieceScratch &scratch) {
        const std::ptrdiff_t first = piece * smallGrid.pieceStride();
        smallGrid.forwardColumns(smallSpectrum.data() + first, scratch(0));
        takeRealParts(scratch(0), smallGrid.pieceStride(), smallOperator.data() + first);
    });
    smallGrid.clearRows(0, smallGrid.rows(), smallSpectrum.data());
}

void kernelSolver::rightHandSide(const floatArray &b) const
{
    inverseKernelRows(blurred.grid, side.data(), b, blurred.scale);
}

void kernelSolver::applyOperator(const floatArray &out, const floatArray &k, float lambdaSample,
                                 float lambdaSmooth) const
{
    laplacian(k, out, laplacianEdge::zero);
    scaleInto(out, out, lambdaSmooth);

    smallGrid.forwardRows(k.data, k.stride, k.cols, 0, k.rows, smallSpectrum.data());
    smallGrid.forPieces([&](int piece, const realTransform2d::pieceScratch &scratch) {
        const std::ptrdiff_t first = piece * smallGrid.pieceStride();
        smallGrid.forwardColumns(smallSpectrum.data() + first, scratch(0));
        multiplyByReal(scratch(0), smallOperator.data() + first, smallGrid.pieceStride());
        smallGrid.inverseColumns(scratch(0), smallResult.data() + first);
    });
    const float scale = 1.0f / (static_cast<float>(smallGrid.rows()) * static_cast<float>(smallGrid.cols()));
    smallGrid.inverseRows(smallResult.data(), 0, k.rows, correlated.data, correlated.stride, k.cols, scale);
    addInto(out, correlated, out);

    if (kernelWeights.empty())
    {
        combine(1.0f, out, lambdaSample, k, out);
        return;
    }
    multiplyInto(kernelWeights, k, correlated, lambdaSample);
    addInto(out, correlated, out);
}

void kernelSolver::solve(const floatArray &gradX, const floatArray &gradY, const floatArray &kernel, float lambdaSample,
                         float lambdaSmooth)
{
    prepare(gradX, gradY);
    const auto kernelSized = [&] { return floatArray::allocate(kernel.rows, kernel.cols); };
    const floatArray r = kernelSized(), product = kernelSized();
    rightHandSide(r);
    applyOperator(product, kernel, lambdaSample, lambdaSmooth);
    subtractInto(r, product, r);
    const floatArray p = cloned(r);
    float rr = dot(r, r);
    for (int pass = 0; pass < maxIterations && rr > 0.0f; ++pass)
    {
        applyOperator(product, p, lambdaSample, lambdaSmooth);
        const float alpha = rr / dot(p, product);
        combine(1.0f, kernel, alpha, p, kernel);
        combine(1.0f, r, -alpha, product, r);
        const float rrNew = dot(r, r);
        if (std::sqrt(rrNew) < tolerance)
            return;
        combine(rrNew / rr, p, 1.0f, r, p);
        rr = rrNew;
    }
}

void kernelSolver::cleanKernel(const floatArray &kernel)
{
    const float most = peak(kernel);
    // Written so that NaN samples, too, end in the fallback.
    if (!(most > 1e-7f))
    {
        gaussianFill(kernel, 0.5f);
        return;
    }
    thresholdInto(kernel, kernel, 0.05f * most);
    normaliseSum(kernel);
}

void kernelSolver::recentre(const floatArray &kernel)
{
    float cx = 0.0f, cy = 0.0f;
    for (int y = 0; y < kernel.rows; ++y)
        for (int x = 0; x < kernel.cols; ++x)
        {
            cx += kernel.row(y)[x] * static_cast<float>(x);
            cy += kernel.row(y)[x] * static_cast<float>(y);
        }
    const floatArray frame = floatArray::allocate(kernel.rows + 2, kernel.cols + 2);
    fill(frame, 0.0f);
    copyTo(kernel, frame.subRect(1, 1, kernel.rows, kernel.cols));
    const floatArray moved = floatArray::allocate(frame.rows, frame.cols);
    subPixelCrop(frame, moved, static_cast<float>(static_cast<int>(cx + 0.5f)) + 1.0f,
                 static_cast<float>(static_cast<int>(cy + 0.5f)) + 1.0f);
    copyTo(moved.subRect(1, 1, kernel.rows, kernel.cols), kernel);
}

} // namespace CorvaneDeblur
