#include "deblur/deconv/latentEstimatorFastHyperLaplacian.h"

#include "deblur/deconv/hyperLaplacianDeconvolver.h"

namespace CorvaneDeblur
{

void latentEstimatorFastHyperLaplacian::deconvolvePlane(const floatArray &padded, const latentKernel &trace,
                                                        const floatArray &out) const
{
    hyperLaplacianDeconvolver deconvolver(padded, tables, workers::one);
    deconvolver.run(out, trace.kernel, trace.smoothing, trace.suppression);
}

} // namespace CorvaneDeblur
