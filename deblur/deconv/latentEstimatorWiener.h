#pragma once

#include "deblur/deconv/latentEstimator.h"
#include "platform/math/workers.h"

namespace CorvaneDeblur
{

/// Method 0, in closed form: one division per frequency.
class latentEstimatorWiener final : public latentEstimator
{
protected:
    void deconvolvePlane(const floatArray &padded, const latentKernel &trace, const floatArray &out) const override;
};

/// Wiener solution of one plane:  X = conj(K) * Y / (|K|^2 + reg),  reg = 0.095 * smoothing^2 + 0.005,
/// times 1 + reg, which keeps the mean of the plane for a kernel that sums to 1.
/// padded: the periodic grid. out: its top left part is written. smoothing: 0..1.
void wienerDeconvolve(const floatArray &padded, const floatArray &kernel, float smoothing, const floatArray &out,
                      workers who);

} // namespace CorvaneDeblur
