#include "store/traces/kernelCollection.h"

#include <algorithm>
#include <exception>

/// The estimations of a collection's traces: which run, and how they are waited for.
namespace Project
{
namespace
{

constexpr auto pollTime = std::chrono::milliseconds(50);

double MeanProgress(const std::vector<PEstimatedKernel *> &traces)
{
    double sum = 0.0;
    for (const PEstimatedKernel *trace : traces)
        sum += trace->Progress();
    return traces.empty() ? 1.0 : sum / static_cast<double>(traces.size());
}

} // namespace

std::vector<PEstimatedKernel *> PKernelCollection::BusyTraces() const
{
    std::vector<PEstimatedKernel *> busy;
    const auto take = [&](PKernel *trace) {
        if (auto *estimated = dynamic_cast<PEstimatedKernel *>(trace); estimated && estimated->Busy())
            busy.push_back(estimated);
    };
    for (const auto &trace : kernels)
        take(trace.get());
    take(lone.get());
    return busy;
}

bool PKernelCollection::AllIdle() const
{
    return std::all_of(kernels.begin(), kernels.end(),
                       [](const std::unique_ptr<PKernel> &trace) { return trace->EstimationState() != 1; }) &&
           !(lone && lone->EstimationState() == 1);
}

bool PKernelCollection::AnyActiveEstimating() const
{
    return std::any_of(active.begin(), active.end(),
                       [](const PKernel *trace) { return trace->EstimationState() == 1; });
}

void PKernelCollection::JoinAll()
{
    for (const PEstimatedKernel *trace : BusyTraces())
        trace->Join();
    events.JoinDetail();
}

int PKernelCollection::PollAll()
{
    int finished = 0;
    std::exception_ptr failure;
    for (PEstimatedKernel *trace : BusyTraces())
    {
        try
        {
            finished += trace->PollEstimation() ? 1 : 0;
        }
        catch (...)
        {
            failure = std::current_exception();
        }
    }
    if (failure)
        std::rethrow_exception(failure);
    return finished;
}

void PKernelCollection::StopAll()
{
    const auto busy = BusyTraces();
    // First all are told, so that none of those that wait for a worker begins when another one stops.
    for (PEstimatedKernel *trace : busy)
        trace->CancelEstimation();
    for (PEstimatedKernel *trace : busy)
        trace->StopEstimation();
}

double PKernelCollection::Progress() const
{
    return MeanProgress(BusyTraces());
}

bool PKernelCollection::WaitForEstimations(const std::function<bool(double)> &progress)
{
    const auto watched = BusyTraces();
    for (auto busy = watched; !busy.empty(); busy = BusyTraces())
    {
        if (progress && !progress(MeanProgress(watched)))
        {
            StopAll();
            return false;
        }
        busy.front()->JoinFor(pollTime);
        PollAll();
    }
    return true;
}

} // namespace Project
