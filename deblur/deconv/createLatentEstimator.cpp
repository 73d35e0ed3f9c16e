#include "deblur/deconv/latentEstimatorFastHyperLaplacian.h"
#include "deblur/deconv/latentEstimatorFastHyperLaplacian_Old.h"
#include "deblur/deconv/latentEstimatorWiener.h"

namespace CorvaneDeblur
{

std::unique_ptr<latentEstimator> createLatentEstimator(deconvolutionMethod method, shrinkageTableStore &tables)
{
    switch (method)
    {
    case deconvolutionMethod::wiener:
        return std::make_unique<latentEstimatorWiener>();
    case deconvolutionMethod::fast:
        return std::make_unique<latentEstimatorFastHyperLaplacian>(tables);
    case deconvolutionMethod::classic:
        break;
    }
    return std::make_unique<latentEstimatorFastHyperLaplacian_Old>(tables); // any other number, too
}

} // namespace CorvaneDeblur
