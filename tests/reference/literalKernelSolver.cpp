#include "tests/reference/literalKernelSolver.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/filters.h"
#include "deblur/estimate/fourier.h"
#include "deblur/estimate/resample.h"
#include "tests/reference/literalDerivatives.h"

#include <cmath>

using namespace CorvaneDeblur;

namespace Reference
{
namespace
{

constexpr int maxIterations = 20;
constexpr float tolerance = 1e-5f;

/// to += weight * a * conj(b)
void addProduct(const complexArray &to, float weight, const complexArray &a, const complexArray &b)
{
    for (int v = 0; v < to.rows; ++v)
        for (int u = 0; u < to.cols; ++u)
            to.at(v, u) = to.at(v, u) + a.at(v, u) * conj(b.at(v, u)) * weight;
}

/// to += weight * |a|^2
void addPower(const floatArray &to, float weight, const complexArray &a)
{
    for (int v = 0; v < to.rows; ++v)
        for (int u = 0; u < to.cols; ++u)
            to.at(v, u) += weight * norm(a.at(v, u));
}

} // namespace

literalKernelSolver::literalKernelSolver(const floatArray &padded, int derivativesOrder)
    : gridRows(padded.rows), gridCols(padded.cols), order(derivativesOrder),
      dataOperator(floatArray::allocate(gridRows, halfSpectrumCols(gridCols)))
{
    const complexArray image = spectrumOf(padded);
    blurred.dx = complexArray::allocate(gridRows, image.cols);
    blurred.dy = complexArray::allocate(gridRows, image.cols);
    for (int v = 0; v < gridRows; ++v)
        for (int u = 0; u < image.cols; ++u)
        {
            blurred.dx.at(v, u) = differenceSpectrum(u, gridCols) * image.at(v, u);
            blurred.dy.at(v, u) = differenceSpectrum(v, gridRows) * image.at(v, u);
        }
    addSecondOrder(blurred);
}

complexArray literalKernelSolver::spectrumOf(const floatArray &a) const
{
    const floatArray grid = floatArray::allocate(gridRows, gridCols);
    fill(grid, 0.0f);
    copyTo(a, grid);
    const complexArray spectrum = complexArray::allocate(gridRows, halfSpectrumCols(gridCols));
    forwardFFT(grid, spectrum);
    return spectrum;
}

void literalKernelSolver::addSecondOrder(derivatives &d) const
{
    if (order == 0)
        return;
    for (complexArray *second : {&d.dxx, &d.dyy, &d.dxy})
        *second = complexArray::allocate(d.dx.rows, d.dx.cols);
    for (int v = 0; v < d.dx.rows; ++v)
        for (int u = 0; u < d.dx.cols; ++u)
        {
            const complexSample dx = differenceSpectrum(u, gridCols), dy = differenceSpectrum(v, gridRows);
            d.dxx.at(v, u) = dx * d.dx.at(v, u);
            d.dyy.at(v, u) = dy * d.dy.at(v, u);
            d.dxy.at(v, u) = (dy * d.dx.at(v, u) + dx * d.dy.at(v, u)) * 0.5f;
        }
}

void literalKernelSolver::prepare(const floatArray &gradX, const floatArray &gradY)
{
    sharp.dx = spectrumOf(gradX);
    sharp.dy = spectrumOf(gradY);
    addSecondOrder(sharp);

    fill(dataOperator, 0.0f);
    const float first = order == 0 ? 1.0f : 25.0f;
    addPower(dataOperator, first, sharp.dx);
    addPower(dataOperator, first, sharp.dy);
    if (order == 1)
        for (const complexArray &second : {sharp.dxx, sharp.dyy, sharp.dxy})
            addPower(dataOperator, 12.5f, second);
}

void literalKernelSolver::rightHandSide(const floatArray &b) const
{
    const complexArray c = complexArray::allocate(gridRows, dataOperator.cols);
    const float first = order == 0 ? 1.0f : 25.0f;
    addProduct(c, first, blurred.dx, sharp.dx);
    addProduct(c, first, blurred.dy, sharp.dy);
    if (order == 1)
    {
        addProduct(c, 12.5f, blurred.dxx, sharp.dxx);
        addProduct(c, 12.5f, blurred.dyy, sharp.dyy);
        addProduct(c, 12.5f, blurred.dxy, sharp.dxy);
    }
    if (!lowPass.empty())
        multiplySpectrumByReal(c, lowPass, c);
    gatherCentred(c, b, gridCols, gridRows);
}

void literalKernelSolver::applyOperator(const floatArray &out, const floatArray &k, float lambdaSample,
                                        float lambdaSmooth) const
{
    const complexArray c = complexArray::allocate(gridRows, dataOperator.cols);
    placeCentred(k, c, gridCols, gridRows);
    multiplySpectrumByReal(c, dataOperator, c);
    gatherCentred(c, out, gridCols, gridRows);

    const floatArray term = floatArray::allocate(k.rows, k.cols);
    if (kernelWeights.empty())
        scaleInto(k, term, lambdaSample);
    else
        multiplyInto(kernelWeights, k, term, lambdaSample);
    addInto(out, term, out);
    laplacian(k, term, laplacianEdge::zero);
    combine(1.0f, out, lambdaSmooth, term, out);
}

void literalKernelSolver::solve(const floatArray &gradX, const floatArray &gradY, const floatArray &kernel,
                                float lambdaSample, float lambdaSmooth)
{
    prepare(gradX, gradY);
    const floatArray b = floatArray::allocate(kernel.rows, kernel.cols);
    rightHandSide(b);
    const floatArray ap = floatArray::allocate(kernel.rows, kernel.cols);
    applyOperator(ap, kernel, lambdaSample, lambdaSmooth);
    const floatArray r = floatArray::allocate(kernel.rows, kernel.cols);
    subtractInto(b, ap, r);
    const floatArray p = cloned(r);
    float rr = dot(r, r);

    for (int i = 0; i < maxIterations; ++i)
    {
        applyOperator(ap, p, lambdaSample, lambdaSmooth);
        const float alpha = rr / dot(p, ap);
        combine(1.0f, kernel, alpha, p, kernel);
        combine(1.0f, r, -alpha, ap, r);
        const float rrNew = dot(r, r);
        if (std::sqrt(rrNew) < tolerance)
            break;
        combine(1.0f, r, rrNew / rr, p, p);
        rr = rrNew;
    }
}

void literalCleanKernel(const floatArray &kernel)
{
    const float m = peak(kernel);
    if (1e-7f >= m)
    {
        gaussianFill(kernel, 0.5f);
        return;
    }
    thresholdInto(kernel, kernel, 0.05f * m);
    normaliseSum(kernel);
}

void literalRecentre(const floatArray &kernel)
{
    float cx = 0.0f, cy = 0.0f;
    for (int y = 0; y < kernel.rows; ++y)
        for (int x = 0; x < kernel.cols; ++x)
        {
            cx += kernel.at(y, x) * static_cast<float>(x);
            cy += kernel.at(y, x) * static_cast<float>(y);
        }

    const floatArray frame = floatArray::allocate(kernel.rows + 2, kernel.cols + 2);
    fill(frame, 0.0f);
    copyTo(kernel, frame.subRect(1, 1, kernel.rows, kernel.cols));
    const floatArray moved = floatArray::allocate(frame.rows, frame.cols);
    subPixelCrop(frame, moved, static_cast<float>(static_cast<int>(cx + 0.5f)) + 1.0f,
                 static_cast<float>(static_cast<int>(cy + 0.5f)) + 1.0f);
    copyTo(moved.subRect(1, 1, kernel.rows, kernel.cols), kernel);
}

} // namespace Reference
