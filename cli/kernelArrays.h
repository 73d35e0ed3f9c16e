#pragma once

#include "cli/options.h"
#include "deblur/deconv/latentKernel.h"
#include "deblur/estimate/floatArray.h"
#include "host/kernelFile.h"

/// Kernels between files, estimation and rendering.
namespace Stillmark
{

CorvaneDeblur::floatArray toArray(const kernelSamples &kernel);
kernelSamples toSamples(const CorvaneDeblur::floatArray &kernel);

/// The kernel in the middle of a square of zeros, or the kernel itself if it is a square. Rendering takes its margins
/// from a kernel's columns, so a narrow upright one must not stand alone. Sides are odd.
CorvaneDeblur::floatArray squareKernel(const CorvaneDeblur::floatArray &kernel);

CorvaneDeblur::latentKernel latentTrace(const CorvaneDeblur::floatArray &kernel, const rectangle &region,
                                        const traceStrength &strength);

} // namespace Stillmark
