#include "dialog/tasks/addKernelTask.h"

#include "store/traces/kernelCollection.h"

namespace Project
{

PAddKernelTask::PAddKernelTask(PTaskHost &home, const PKernel *source, int at)
    : PKernelTask(home, at == -1 ? home.Traces().Count() : at, false), sourceKernel(source)
{
}

PAddKernelTask::~PAddKernelTask() = default;

bool PAddKernelTask::GetName(std::string &text) const
{
    text = "$$$/Deblur/Task/Kernel/AddKernel=Add Blur Trace";
    return true;
}

void PAddKernelTask::PerformRedo()
{
    if (first)
    {
        PKernelCollection &traces = host.Traces();
        heldKernel = sourceKernel ? sourceKernel->Copy()
                                  : std::make_unique<PEstimatedKernel>(traces, Sarnik::CRect{},
                                                                       traces.Parameters().defaultSettings);
        wasApplied = sourceKernel != nullptr;
    }
    PutIn(heldKernel, wasApplied);
    first = false;
    sourceKernel = nullptr;
}

void PAddKernelTask::PerformUndo()
{
    TakeOut(heldKernel, wasApplied);
}

bool PDuplicateKernelTask::GetName(std::string &text) const
{
    text = "$$$/Deblur/Task/Kernel/DuplicateKernel=Duplicate Blur Trace";
    return true;
}

} // namespace Project
