#include "dialog/tasks/removeKernelTask.h"

#include "store/traces/kernel.h"

namespace Project
{

PRemoveKernelTask::PRemoveKernelTask(PTaskHost &home, int at) : PKernelTask(home, at, false)
{
}

PRemoveKernelTask::~PRemoveKernelTask() = default;

bool PRemoveKernelTask::GetName(std::string &text) const
{
    text = "$$$/Deblur/Task/Kernel/RemoveKernel=Remove Blur Trace";
    return true;
}

} // namespace Project
