#pragma once

#include "deblur/deconv/latentEstimator.h"

#include <vector>

namespace Project
{

/// What a render depends on, taken over at its start: nothing that changes meanwhile reaches it.
struct renderSettings
{
    float deconvWeight = 0.0005f; ///< of the first trace, as the two flags and the iterations; kept, not computed with
    bool deconvFlagA = true;
    CorvaneDeblur::deconvolutionMethod method = CorvaneDeblur::deconvolutionMethod::wiener;
    bool deconvFlagB = false;
    int deconvIterations = 20;
    float scale = 1.0f;         ///< 1: full resolution
    std::vector<bool> channels; ///< a flag for each colour plane: deconvolved, or passed on as it is
    std::vector<CorvaneDeblur::latentKernel> kernels; ///< at full resolution, samples of their own

    bool Deconvolves(int plane) const
    {
        return static_cast<std::size_t>(plane) < channels.size() && channels[static_cast<std::size_t>(plane)];
    }
    /// Whether an estimator made for these settings serves the others.
    bool SameEstimator(const renderSettings &other) const
    {
        return deconvFlagA == other.deconvFlagA && deconvFlagB == other.deconvFlagB && method == other.method;
    }
};

} // namespace Project
