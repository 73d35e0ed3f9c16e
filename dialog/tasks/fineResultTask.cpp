#include "dialog/tasks/fineResultTask.h"

#include "store/traces/kernelCollection.h"

namespace Project
{

bool PFineResultTask::GetName(std::string &text) const
{
    text = enable ? "$$$/Deblur/Task/FineResult/Enable=Enable Artifact Suppression"
                  : "$$$/Deblur/Task/FineResult=Disable Artifact Suppression";
    return true;
}

void PFineResultTask::Apply(bool on)
{
    PKernelCollection &traces = host.Traces();
    PTaskView &view = host.View();
    view.CancelTool();
    bool &flag = traces.Parameters().fineResult;
    if (flag == on)
        return;
    flag = on;
    for (int i = 0; i < traces.Count(); ++i)
        traces.At(i)->MarkChanged();
    ShowOr(
        [&] {
            traces.Invalidate(PInvalidation::Normal);
            view.SyncControls();
            view.InvalidateDialog();
        },
        [&] {
            flag = !on;
            traces.Invalidate(PInvalidation::Normal);
        });
}

} // namespace Project
