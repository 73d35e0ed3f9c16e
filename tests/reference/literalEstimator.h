#pragma once

#include "deblur/estimate/floatArray.h"

#include <vector>

namespace Reference
{

struct estimatorSettings
{
    float sigma = 3.0f / 255.0f;   ///< noise figure of the image
    bool trackFinestLevels = true; ///< sparsify and stop early on the last three levels
    int derivativesOrder = 0;
    int pyramidLevel = 0;
    int iterations = 7;
};

/// The estimation of a kernel step by step: no seed search, no cancelling. `guide`: the image, or its copy with
/// saturated parts blurred away; `weights`: 1 on good pixels, 0 near saturation. Writes `kernel`; levelKernels, when
/// given, receives the kernel that each level ended with, coarsest first.
void literalEstimate(const estimatorSettings &settings, const CorvaneDeblur::floatArray &guide,
                     const CorvaneDeblur::floatArray &weights, const CorvaneDeblur::floatArray &kernel,
                     std::vector<CorvaneDeblur::floatArray> *levelKernels = nullptr);

} // namespace Reference
