#include "deblur/estimate/imageStructure.h"
#include "deblur/estimate/kernelMeasures.h"
#include "shell/plugin/filter.h"

#include <algorithm>
#include <thread>

namespace Project
{

using CorvaneDeblur::floatArray;

namespace
{

/// Estimations that are begun together: enough for all processors, and few enough that their regions fit in memory.
std::size_t tracesAtOnce()
{
    return std::max(4u, 2 * std::thread::hardware_concurrency());
}

} // namespace

bool PFilter::WaitForTraces(double from, double to)
{
    return GetKernels()->WaitForEstimations([&](double done) {
        Picture().EstimationProgress(from + (to - from) * done);
        return !Picture().Abort();
    });
}

/// Whether a trace has nothing to say: its region shows no edges, or its kernel is a point, for nothing has moved.
/// Removing it would add noise and take nothing away. A point may be what the user wants; what was seen where there is
/// nothing to see is not.
bool PFilter::IsUseless(PKernel &trace)
{
    if (!trace.HasKernel())
        return false;
    if (!trace.Settings().forcedApply && CorvaneDeblur::isPointKernel(trace.KernelImage()))
        return true;
    const Sarnik::CRect region =
        trace.Region().Empty() ? Picture().Bounds() : trace.Region().Intersected(Picture().Bounds());
    const auto grey = floatArray::allocate(static_cast<int>(region.Height()), static_cast<int>(region.Width()));
    Picture().ReadGrey(region, 255, grey, {});
    return !CorvaneDeblur::hasStructure(grey, trace.Settings().size);
}

void PFilter::LeaveOutUseless(const std::vector<PKernel *> &estimated)
{
    PKernelCollection &traces = *GetKernels();
    for (PKernel *trace : estimated)
        if (IsUseless(*trace))
        {
            if (trace == traces.LoneTrace())
                traces.DeactivateAll();
            else
                traces.Deactivate(traces.IndexOf(trace));
        }
}

/// Traces that came without a kernel, in a recording or from the picture itself, get theirs. One that the user wants
/// whatever it is stays so.
bool PFilter::EstimateMissing()
{
    PKernelCollection &traces = *GetKernels();
    std::vector<PEstimatedKernel *> missing;
    for (int i = 0; i < traces.Count(); ++i)
        if (auto *trace = dynamic_cast<PEstimatedKernel *>(traces.At(i)); trace != nullptr && !trace->HasKernel())
            missing.push_back(trace);
    if (missing.empty())
        return true;

    traces.BuildAnalysisImage(); // for the noise
    const double all = static_cast<double>(missing.size());
    for (std::size_t first = 0; first < missing.size(); first += tracesAtOnce())
    {
        const std::size_t end = std::min(missing.size(), first + tracesAtOnce());
        std::vector<PKernel *> forced;
        for (std::size_t i = first; i < end; ++i)
        {
            PEstimatedKernel &trace = *missing[i];
            if (trace.Settings().forcedApply)
                forced.push_back(&trace);
            trace.GrowRegion(trace.Settings().size);
            trace.StartEstimation(PEstimationRun::Background);
        }
        if (!WaitForTraces(static_cast<double>(first) / all, static_cast<double>(end) / all))
            return false;
        for (PKernel *trace : forced)
            trace->Settings().forcedApply = true;
    }
    LeaveOutUseless({missing.begin(), missing.end()});
    return true;
}

/// The traces of a replay: those of the recording, or the lone one that the picture itself gives.
bool PFilter::FindTraces()
{
    if (!autoMode)
        return EstimateMissing();
    PKernelCollection &traces = *GetKernels();
    if (!traces.AutoEstimate())
        return true; // nothing to see a blur by: the picture stays as it is
    if (!WaitForTraces(0.0, 1.0))
        return false;
    LeaveOutUseless({traces.LoneTrace()});
    return true;
}

} // namespace Project
