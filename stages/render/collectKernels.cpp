#include "stages/render/collectKernels.h"

#include "deblur/estimate/arrayOps.h"
#include "store/params.h"
#include "store/traces/kernel.h"
#include "store/traces/kernelCollection.h"

#include <algorithm>

namespace Project
{

using CorvaneDeblur::deconvolutionMethod;
using CorvaneDeblur::latentKernel;

namespace
{

/// Every number but 0 and 2 is the classic method.
deconvolutionMethod methodOf(const PParams &params)
{
    if (!params.fineResult || params.deconvType == 0)
        return deconvolutionMethod::wiener;
    return params.deconvType == 2 ? deconvolutionMethod::fast : deconvolutionMethod::classic;
}

void collectCommon(const PKernelCollection &manager, const PParams &params, int colourPlanes, float scale,
                   renderSettings &settings)
{
    settings = {};
    if (const PKernel *first = manager.FirstTrace())
    {
        const KernelSettings &its = first->Settings();
        settings.deconvWeight = its.deconvWeight;
        settings.deconvFlagA = its.deconvFlagA;
        settings.deconvFlagB = its.deconvFlagB;
        settings.deconvIterations = static_cast<int>(its.deconvIterations);
    }
    settings.scale = scale;
    settings.method = methodOf(params);
    settings.channels.resize(static_cast<std::size_t>(std::max(colourPlanes, 0)));
    for (const std::uint32_t channel : params.deconvChannels)
        if (channel < settings.channels.size())
            settings.channels[channel] = true;
}

} // namespace

bool fillLatentKernel(const PKernel &trace, int offsetX, int offsetY, latentKernel &out)
{
    if (!trace.IsApplied())
        return false;
    out.kernel = CorvaneDeblur::cloned(trace.KernelImage());
    const Sarnik::CRect region = trace.Region().Moved(-std::int64_t{offsetX}, -std::int64_t{offsetY});
    out.regionLeft = region.left;
    out.regionTop = region.top;
    out.regionRight = region.right;
    out.regionBottom = region.bottom;
    out.smoothing = trace.Settings().smoothing;
    out.suppression = trace.Settings().suppression;
    out.isManual = trace.KernelType() == PKernelKind::Manual;
    return true;
}

bool collectAllKernels(const PKernelCollection &manager, const PParams &params, int colourPlanes, float scale,
                       int offsetX, int offsetY, renderSettings &settings)
{
    collectCommon(manager, params, colourPlanes, scale, settings);
    for (const PKernel *trace : manager.RenderTraces())
    {
        latentKernel kernel;
        if (fillLatentKernel(*trace, offsetX, offsetY, kernel))
            settings.kernels.push_back(std::move(kernel));
    }
    return !settings.kernels.empty();
}

bool collectOneKernel(const PKernelCollection &manager, const PKernel &trace, const PParams &params, int colourPlanes,
                      float scale, int offsetX, int offsetY, renderSettings &settings)
{
    collectCommon(manager, params, colourPlanes, scale, settings);
    latentKernel kernel;
    if (!fillLatentKernel(trace, offsetX, offsetY, kernel))
        return false;
    settings.kernels.push_back(std::move(kernel));
    return true;
}

int largestReadyKernel(const PKernelCollection &manager)
{
    int cols = 0;
    for (const PKernel *trace : manager.RenderTraces())
        cols = std::max(cols, trace->KernelImage().cols);
    return cols;
}

} // namespace Project
