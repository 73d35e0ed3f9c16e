#include "dialog/tasks/kernelTask.h"

#include "store/traces/kernelCollection.h"

namespace Project
{

PKernel *PKernelTask::Trace() const
{
    return host.Traces().At(index);
}

void PKernelTask::Select(int at)
{
    host.Traces().Select(at);
    host.View().SelectThumbnail(at);
}

void PKernelTask::Reselect(int before)
{
    host.Traces().Select(before);
    host.View().RebuildThumbnails();
}

void PKernelTask::PutIn(std::unique_ptr<PKernel> &trace, bool active)
{
    if (!trace)
        return;
    PKernelCollection &traces = host.Traces();
    const int before = traces.SelectedIndex();
    index = traces.IndexOf(&traces.Insert(std::move(trace), index));
    ShowListOr(
        before,
        [&] {
            if (active)
                traces.Activate(index);
            host.View().InsertThumbnail(index);
            Select(index);
        },
        [&] { trace = traces.Remove(index); });
}

void PKernelTask::TakeOut(std::unique_ptr<PKernel> &trace, bool &active)
{
    PKernelCollection &traces = host.Traces();
    PTaskView &view = host.View();
    const int before = traces.SelectedIndex();
    if (!Trace())
        return;
    active = traces.IsActive(index);
    trace = traces.Remove(index);
    ShowListOr(
        before,
        [&] {
            view.RemoveThumbnail(index);
            if (traces.SelectedIndex() >= 0)
                view.SelectThumbnail(traces.SelectedIndex());
        },
        [&] {
            traces.Insert(std::move(trace), index);
            if (active)
                traces.Activate(index);
        });
}

} // namespace Project
