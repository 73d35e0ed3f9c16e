#pragma once

#include "deblur/deconv/latentEstimator.h"

namespace CorvaneDeblur
{

/// Method 1, an earlier form of the hyper-Laplacian method, kept as an experimental choice (classicDeconvolver).
class latentEstimatorFastHyperLaplacian_Old final : public latentEstimator
{
public:
    /// The store builds its tables for this method's own betas on first use.
    explicit latentEstimatorFastHyperLaplacian_Old(shrinkageTableStore &store) : tables(store) {}

protected:
    void deconvolvePlane(const floatArray &padded, const latentKernel &trace, const floatArray &out) const override;

private:
    shrinkageTableStore &tables;
};

} // namespace CorvaneDeblur
