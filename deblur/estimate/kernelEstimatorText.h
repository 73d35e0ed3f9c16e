#pragma once

#include "deblur/estimate/floatArray.h"
#include "deblur/estimate/kernelEstimatorThread.h"

namespace CorvaneDeblur
{

/// The place of an estimator for pictures of text. It takes what one would need and leaves the kernel as it is.
class kernelEstimatorText : public kernelEstimatorThread
{
public:
    void estimate(floatArray /*kernel*/, byteArray /*mask*/, floatArray /*image*/, int /*iterations*/, float /*weight*/,
                  float /*tolerance*/, bool /*flag*/)
    {
    }
};

} // namespace CorvaneDeblur
