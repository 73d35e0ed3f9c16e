#pragma once

#include "deblur/estimate/floatArray.h"

namespace Reference
{

/// Kernel that best maps sharp gradients onto those of the blurred image: conjugate gradients on
///     (A + lambdaSample diag(kernelWeights) + lambdaSmooth laplacian) k = b,
/// the data operator A applied on the image's grid every time.
class literalKernelSolver
{
public:
    literalKernelSolver(const CorvaneDeblur::floatArray &padded, int derivativesOrder);

    /// kernel: start and result.
    void solve(const CorvaneDeblur::floatArray &gradX, const CorvaneDeblur::floatArray &gradY,
               const CorvaneDeblur::floatArray &kernel, float lambdaSample, float lambdaSmooth);

    CorvaneDeblur::floatArray lowPass;       ///< factor of the right-hand side, on the half spectrum; empty for none
    CorvaneDeblur::floatArray kernelWeights; ///< the kernel's shape; empty means all 1

    /// The steps of solve.
    void prepare(const CorvaneDeblur::floatArray &gradX, const CorvaneDeblur::floatArray &gradY);
    void rightHandSide(const CorvaneDeblur::floatArray &b) const;
    void applyOperator(const CorvaneDeblur::floatArray &out, const CorvaneDeblur::floatArray &k, float lambdaSample,
                       float lambdaSmooth) const;

private:
    struct derivatives
    {
        CorvaneDeblur::complexArray dx, dy;        ///< first order
        CorvaneDeblur::complexArray dxx, dyy, dxy; ///< empty in order 0
    };
    CorvaneDeblur::complexArray spectrumOf(const CorvaneDeblur::floatArray &a) const;
    void addSecondOrder(derivatives &d) const;

    int gridRows, gridCols, order;
    derivatives blurred, sharp;
    CorvaneDeblur::floatArray dataOperator; ///< real spectrum of A
};

/// Drops what is at most 5 % of the peak and scales to a sum of 1; a collapsed kernel becomes a small Gaussian.
void literalCleanKernel(const CorvaneDeblur::floatArray &kernel);

/// Shifts the kernel by whole samples so that its centre of mass is at the array's centre.
void literalRecentre(const CorvaneDeblur::floatArray &kernel);

} // namespace Reference
