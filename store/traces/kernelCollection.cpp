#include "store/traces/kernelCollection.h"

#include "store/traces/manualKernel.h"
#include "store/traces/readOnlyKernel.h"

#include <algorithm>
#include <utility>

namespace Project
{
namespace
{

bool Contains(const std::vector<PKernel *> &set, const PKernel *trace)
{
    return std::find(set.begin(), set.end(), trace) != set.end();
}

} // namespace

PKernelCollection::PKernelCollection(PTracePicture &image, PParams &record, PTraceEvents &listener, std::string tables)
    : picture(image), parameters(record), events(listener), tableDirectory(std::move(tables))
{
}

PKernelCollection::~PKernelCollection()
{
    Clear();
}

PKernel *PKernelCollection::At(int index) const
{
    return index >= 0 && index < Count() ? kernels[static_cast<std::size_t>(index)].get() : nullptr;
}

int PKernelCollection::IndexOf(const PKernel *trace) const
{
    const auto found = std::find_if(kernels.begin(), kernels.end(),
                                    [trace](const std::unique_ptr<PKernel> &k) { return k.get() == trace; });
    return found == kernels.end() ? -1 : static_cast<int>(found - kernels.begin());
}

PKernel *PKernelCollection::Selected() const
{
    return events.MultiPreview() ? nullptr : At(selected);
}

void PKernelCollection::Select(int index)
{
    selected = At(index) ? index : -1;
}

/// What every change of the list begins with.
void PKernelCollection::ListChanges()
{
    events.JoinDetail();
    ForgetSolo();
}

PKernel &PKernelCollection::Insert(std::unique_ptr<PKernel> &&trace, int at)
{
    ListChanges();
    const int place = at >= 0 && at <= Count() ? at : Count();
    return **kernels.insert(kernels.begin() + place, std::move(trace));
}

PKernel &PKernelCollection::InsertCopy(const PKernel &trace, int at)
{
    return Insert(trace.Copy(), at);
}

void PKernelCollection::Move(int from, int to)
{
    if (!At(from) || !At(to))
        return;
    ListChanges();
    auto trace = std::move(kernels[static_cast<std::size_t>(from)]);
    kernels.erase(kernels.begin() + from);
    kernels.insert(kernels.begin() + to, std::move(trace));
}

std::unique_ptr<PKernel> PKernelCollection::Remove(int index)
{
    if (!At(index))
        return nullptr;
    ListChanges();
    Deactivate(index);
    auto trace = std::move(kernels[static_cast<std::size_t>(index)]);
    kernels.erase(kernels.begin() + index);
    if (auto *estimated = dynamic_cast<PEstimatedKernel *>(trace.get()))
        estimated->StopEstimation();
    trace->DropPendingChange();
    if (selected > index)
        --selected;
    else if (selected == index)
        selected = std::min(index, Count() - 1);
    return trace;
}

void PKernelCollection::Clear()
{
    ListChanges();
    active.clear();
    StopAll();
    kernels.clear();
    lone = nullptr;
    selected = -1;
}

bool PKernelCollection::IsActive(int index) const
{
    const PKernel *trace = At(index);
    return trace && Contains(active, trace);
}

void PKernelCollection::Activate(int index)
{
    PKernel *trace = At(index);
    if (!trace || Contains(active, trace))
        return;
    active.push_back(trace);
    if (trace->IsApplied())
        Invalidate(PInvalidation::Normal);
}

void PKernelCollection::Deactivate(int index)
{
    if (!IsActive(index))
        return;
    const PKernel *trace = At(index);
    std::erase(active, trace);
    if (trace->IsApplied())
        Invalidate(PInvalidation::Normal);
}

void PKernelCollection::DeactivateAll()
{
    if (active.empty())
        return;
    active.clear();
    Invalidate(PInvalidation::Normal);
}

void PKernelCollection::Solo(int index)
{
    savedActive = active;
    soloIndex = index;
}

void PKernelCollection::EndSolo()
{
    active = savedActive;
    Invalidate(PInvalidation::Normal);
    ForgetSolo();
}

void PKernelCollection::ForgetSolo()
{
    savedActive.clear();
    soloIndex = -1;
}

std::vector<PKernel *> PKernelCollection::RenderTraces() const
{
    std::vector<PKernel *> traces;
    const auto take = [&](PKernel *trace) {
        if (trace && Contains(active, trace) && trace->IsApplied())
            traces.push_back(trace);
    };
    for (const auto &trace : kernels)
        take(trace.get());
    take(lone.get());
    return traces;
}

PKernel *PKernelCollection::FirstTrace() const
{
    return kernels.empty() ? lone.get() : kernels.front().get();
}

std::vector<PKernel *> PKernelCollection::ActiveFirst() const
{
    std::vector<PKernel *> traces = SelectedFirst();
    std::erase_if(traces, [this](const PKernel *trace) { return !Contains(active, trace); });
    return traces;
}

std::vector<PKernel *> PKernelCollection::SelectedFirst() const
{
    std::vector<PKernel *> traces;
    for (const auto &trace : kernels)
        traces.push_back(trace.get());
    if (At(selected))
        std::rotate(traces.begin(), traces.begin() + selected, traces.begin() + selected + 1);
    return traces;
}

int PKernelCollection::LargestActiveKernel() const
{
    int rows = 0;
    for (const PKernel *trace : RenderTraces())
        rows = std::max(rows, trace->KernelImage().rows);
    return rows;
}

void PKernelCollection::Invalidate(PInvalidation reason)
{
    needsRestart = needsRestart || renderRunning;
    renderRunning = true;
    resultStale = !parameters.showPreview;
    if (parameters.showPreview)
        events.MarkDirty({reason == PInvalidation::Normal, true, true});
    events.TracesChanged();
    if (parameters.showPreview)
        events.RefreshPreview(reason == PInvalidation::KeepRough);
}

void PKernelCollection::RefreshPreview()
{
    if (parameters.showPreview && resultStale)
        Invalidate(PInvalidation::Normal);
    else
        events.RefreshPreview(false);
}

bool PKernelCollection::EndRender()
{
    renderRunning = false;
    return std::exchange(needsRestart, false);
}

bool PKernelCollection::HasChanged() const
{
    return events.UndoPosition() != savedMark; // both are 0 where nothing happened
}

CorvaneDeblur::shrinkageTableStore &PKernelCollection::ShrinkageTables()
{
    std::call_once(tablesOnce,
                   [this] { shrinkageTables = std::make_unique<CorvaneDeblur::shrinkageTableStore>(tableDirectory); });
    return *shrinkageTables;
}

} // namespace Project
