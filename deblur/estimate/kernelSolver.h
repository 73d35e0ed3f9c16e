#pragma once

#include "deblur/estimate/blurredGrid.h"

namespace CorvaneDeblur
{

/// Finds the kernel that best maps predicted sharp gradients onto the gradients of the blurred image:
///     (A + lambdaSample * diag(kernelWeights) + lambdaSmooth * laplacian) k = b
/// by conjugate gradients on the kernel's samples. A is the correlation of the sharp gradients with themselves, b their
/// correlation with the blurred ones (low-passed).
///
/// A is a circular convolution on the image's grid, but with a kernel going in and a kernel-sized crop coming out only
/// its lags within +-(K - 1) count. They are gathered once a solve, and the passes apply them on a grid of
/// fastSize(2K - 1): the same values to rounding as some forty transforms of the image's size.
class kernelSolver
{
public:
    /// `blurred` is kept by reference.
    kernelSolver(const blurredGrid &blurred, int kernelRows, int kernelCols, derivativeOrder order);

    static constexpr int maxIterations = 20;
    static constexpr float tolerance = 1e-5f; ///< on the residual's length

    void setLowPass(const lowPassProfile &profile) { lowPass = profile; }
    /// Weights of lambdaSample per kernel sample; empty: all 1.
    floatArray kernelWeights;

    /// gradX, gradY: predicted gradients, of the level image's shape. kernel: starting point and result.
    void solve(const floatArray &gradX, const floatArray &gradY, const floatArray &kernel, float lambdaSample,
               float lambdaSmooth);

    /// The two sides of the equation on their own, for the gradients of the last `prepare`.
    void prepare(const floatArray &gradX, const floatArray &gradY);
    void rightHandSide(const floatArray &b) const;
    void applyOperator(const floatArray &out, const floatArray &k, float lambdaSample, float lambdaSmooth) const;

    /// Samples at or below 5% of the peak become 0 and the rest is scaled to a sum of 1; a collapsed kernel (no sample
    /// above 1e-7) becomes a Gaussian of standard deviation 0.5.
    static void cleanKernel(const floatArray &kernel);
    /// Moves the centre of mass to the array's centre, to within a sample; what is shifted past the border is lost.
    static void recentre(const floatArray &kernel);

private:
    void multiplyColumns();
    void keepKernelRows(const complexSample *columns, int reach, complexSample *spectrum) const;

    const blurredGrid &blurred;
    int kernelRows, kernelCols;
    derivativeOrder order;
    lowPassProfile lowPass;
    pieceSpectrum sharpX, sharpY; ///< row transforms of the gradients; rows past the image stay 0
    int gradientRows = 0;         ///< rows of sharpX, sharpY that hold gradients
    pieceSpectrum side, lags;     ///< column-inverted right-hand side and operator, only the rows that are gathered
    realTransform2d smallGrid;    ///< fastSize(2K - 1) on each axis
    alignedBuffer<float> smallOperator;               ///< real spectrum of the operator's lags on the small grid
    mutable pieceSpectrum smallSpectrum, smallResult; ///< rows of smallSpectrum past a kernel's stay 0
    floatArray correlated;                            ///< kernel-sized scratch of applyOperator
};

} // namespace CorvaneDeblur
