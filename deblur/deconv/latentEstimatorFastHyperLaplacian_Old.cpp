#include "deblur/deconv/latentEstimatorFastHyperLaplacian_Old.h"

#include "deblur/deconv/classicDeconvolver.h"

namespace CorvaneDeblur
{

void latentEstimatorFastHyperLaplacian_Old::deconvolvePlane(const floatArray &padded, const latentKernel &trace,
                                                            const floatArray &out) const
{
    classicDeconvolver deconvolver(padded, tables, workers::one);
    deconvolver.run(out, trace.kernel, trace.smoothing, trace.suppression);
}

} // namespace CorvaneDeblur
