#pragma once

#include "stages/render/renderSettings.h"

namespace Project
{

class PKernel;
class PKernelCollection;
struct PParams;

/// Takes over what a render of all traces depends on: those that are active and ready, in list order; in a replay its
/// one active trace, which is not in the list. offsetX, offsetY: taken off the traces' regions. colourPlanes: of the
/// picture. False where no trace is ready; nothing is to be deconvolved then.
bool collectAllKernels(const PKernelCollection &manager, const PParams &params, int colourPlanes, float scale,
                       int offsetX, int offsetY, renderSettings &settings);
/// The same for one trace, active or not.
bool collectOneKernel(const PKernelCollection &manager, const PKernel &trace, const PParams &params, int colourPlanes,
                      float scale, int offsetX, int offsetY, renderSettings &settings);
/// One trace as the deconvolution sees it, with samples of its own. False where it is not ready: it has no kernel, or a
/// poor one that the user has not asked for in spite of that.
bool fillLatentKernel(const PKernel &trace, int offsetX, int offsetY, CorvaneDeblur::latentKernel &out);

/// The largest width among the kernels of a render of all traces, at full resolution; 0 for none.
int largestReadyKernel(const PKernelCollection &manager);

} // namespace Project
