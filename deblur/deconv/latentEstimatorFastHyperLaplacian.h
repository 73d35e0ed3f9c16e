#pragma once

#include "deblur/deconv/latentEstimator.h"

namespace CorvaneDeblur
{

/// Method 2, the default: hyperLaplacianDeconvolver on every plane.
class latentEstimatorFastHyperLaplacian final : public latentEstimator
{
public:
    explicit latentEstimatorFastHyperLaplacian(const shrinkageTableStore &store) : tables(store) {}

protected:
    void deconvolvePlane(const floatArray &padded, const latentKernel &trace, const floatArray &out) const override;

private:
    const shrinkageTableStore &tables;
};

} // namespace CorvaneDeblur
