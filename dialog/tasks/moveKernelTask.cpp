#include "dialog/tasks/moveKernelTask.h"

#include "store/traces/kernelCollection.h"

#include <utility>

namespace Project
{

bool PMoveKernelTask::GetName(std::string &text) const
{
    text = "$$$/Deblur/Task/Kernel/MoveKernel=Move Blur Trace";
    return true;
}

void PMoveKernelTask::Swap()
{
    PKernelCollection &traces = host.Traces();
    if (!traces.At(index) || !traces.At(toIndex))
        return;
    const int before = traces.SelectedIndex();
    traces.Move(index, toIndex);
    ShowListOr(
        before,
        [&] {
            host.View().MoveThumbnail(index, toIndex);
            Select(toIndex);
        },
        [&] { traces.Move(toIndex, index); });
    std::swap(index, toIndex);
}

} // namespace Project
