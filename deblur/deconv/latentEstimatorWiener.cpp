#include "deblur/deconv/latentEstimatorWiener.h"

#include "deblur/estimate/gridKernel.h"
#include "platform/math/multiversion.h"

namespace CorvaneDeblur
{
namespace
{

STILLMARK_MULTIVERSION
void dividePiece(const complexSample *__restrict kernel, const complexSample *__restrict observed, float reg,
                 std::ptrdiff_t count, complexSample *__restrict out)
{
    for (std::ptrdiff_t i = 0; i < count; ++i)
    {
        const float kr = kernel[i].re, ki = kernel[i].im, yr = observed[i].re, yi = observed[i].im;
        const float denominator = kr * kr + ki * ki + reg;
        out[i].re = (kr * yr + ki * yi) / denominator;
        out[i].im = (kr * yi - ki * yr) / denominator;
    }
}

} // namespace

void wienerDeconvolve(const floatArray &padded, const floatArray &kernel, float smoothing, const floatArray &out,
                      workers who)
{
    const float reg = smoothing * smoothing * 0.095f + 0.005f;
    const realTransform2d grid(padded.rows, padded.cols, who);
    const pieceSpectrum plane(grid.spectrumCount()), kernelRows(grid.spectrumCount());
    grid.forwardRows(padded.data, padded.stride, padded.cols, 0, padded.rows, plane.data());
    grid.clearRows(0, padded.rows, kernelRows.data());
    forwardKernelRows(grid, kernel, kernelRows.data());
    grid.forPieces([&](int piece, const realTransform2d::pieceScratch &scratch) {
        const std::ptrdiff_t first = piece * grid.pieceStride();
        grid.forwardColumns(plane.data() + first, scratch(0));
        grid.forwardColumns(kernelRows.data() + first, scratch(1));
        dividePiece(scratch(1), scratch(0), reg, grid.pieceStride(), scratch(2));
        grid.inverseColumns(scratch(2), plane.data() + first);
    });
    const float scale = (1.0f + reg) / (static_cast<float>(padded.rows) * static_cast<float>(padded.cols));
    grid.inverseRows(plane.data(), 0, out.rows, out.data, out.stride, out.cols, scale);
}

void latentEstimatorWiener::deconvolvePlane(const floatArray &padded, const latentKernel &trace,
                                            const floatArray &out) const
{
    wienerDeconvolve(padded, trace.kernel, trace.smoothing, out, workers::one);
}

} // namespace CorvaneDeblur
