#include "dialog/tasks/kernelSettingsTask.h"

#include "store/traces/kernelCollection.h"
#include "store/traces/manualKernel.h"

#include <utility>

namespace Project
{
namespace
{

Sarnik::CObjID NudgeSource()
{
    return "Project/Tool/ManualKernel";
}

/// A trace's open change.
class pendingTask final : public PPendingSettings
{
public:
    pendingTask(PTaskHost &home, std::unique_ptr<PKernelSettingsTask> made) : host(home), task(std::move(made)) {}

    void SetSource(std::uint32_t sourceId) override { task->SetSource(Sarnik::CObjID(sourceId)); }

protected:
    void Push(std::unique_ptr<PPendingSettings>, int index) override
    {
        if (index < 0)
            return;
        task->SetIndex(index); // others came and went meanwhile
        host.Tasks().Push(std::move(task));
    }

private:
    PTaskHost &host;
    std::unique_ptr<PKernelSettingsTask> task;
};

} // namespace

PKernelSettingsTask::PKernelSettingsTask(PTaskHost &home, const PKernel &trace, int at, Sarnik::CObjID source)
    : PKernelTask(home, at, true), sourceId(source), settings(trace.PreviousSettings()),
      kernelImage(trace.KernelImage()), region(trace.Region())
{
    // An estimated trace has its new region by now. Of the others the region's owner puts the old one back to record.
    if (trace.KernelType() == PKernelKind::Estimated)
        region = trace.CommittedRegion();
    if (const auto *manual = dynamic_cast<const PManualKernel *>(&trace))
    {
        endpoints[0] = manual->LineStart();
        endpoints[1] = manual->LineEnd();
    }
}

bool PKernelSettingsTask::GetName(std::string &text) const
{
    text = sourceId == NudgeSource() ? "$$$/Deblur/Task/Setting/Nudge=Nudge"
                                     : "$$$/Deblur/Task/Setting/KernelSetting=Blur Estimation Setting";
    return true;
}

bool PKernelSettingsTask::IsNudgeOf(int at) const
{
    return mask == ~0u && sourceId == NudgeSource() && index == at;
}

std::unique_ptr<PPendingSettings> PKernelSettingsTask::Begin(PTaskHost &home, const PKernel &trace,
                                                             Sarnik::CObjID source)
{
    const int at = home.Traces().IndexOf(&trace);
    if (at < 0)
        return nullptr;
    return std::make_unique<pendingTask>(home, std::make_unique<PKernelSettingsTask>(home, trace, at, source));
}

void PKernelSettingsTask::Swap()
{
    PKernel *trace = Trace();
    if (!trace)
        return;
    const int before = host.Traces().SelectedIndex();
    Exchange(*trace);
    ShowListOr(
        before, [&] { Show(); }, [&] { Exchange(*trace); });
}

void PKernelSettingsTask::Exchange(PKernel &trace)
{
    const KernelSettings oldSettings = trace.Settings();
    const CorvaneDeblur::floatArray oldImage = trace.KernelImage();
    const Sarnik::CRect oldRegion = trace.Region();

    trace.SetKernel(kernelImage); // first: the only one that can fail
    trace.RestoreRegion(region);
    trace.RestoreSettings(mask, settings);
    if (auto *manual = dynamic_cast<PManualKernel *>(&trace))
    {
        const PLinePoint start = manual->LineStart(), end = manual->LineEnd();
        manual->RestoreLine(endpoints[0], endpoints[1]);
        endpoints[0] = start;
        endpoints[1] = end;
    }

    settings = oldSettings;
    kernelImage = oldImage;
    region = oldRegion;
}

void PKernelSettingsTask::Show()
{
    PKernelCollection &traces = host.Traces();
    PTaskView &view = host.View();
    if (traces.Events().MultiPreview())
    {
        view.RefreshMultiPreview();
        return;
    }
    if (traces.SelectedIndex() != index)
        Select(index);
    if (traces.IsActive(index))
        traces.Invalidate(PInvalidation::Normal);
    view.RedrawThumbnail(index);
    view.SyncControls();
    view.Focus(sourceId);
}

void RecordNudge(PTaskHost &host, PKernel &trace)
{
    // After an undo a nudge is a step of its own: it would otherwise change what the redo stands on.
    const PTaskStack &stack = host.Tasks();
    const auto *last = dynamic_cast<const PKernelSettingsTask *>(stack.LastDone());
    if (last && !stack.CanRedo() && last->IsNudgeOf(host.Traces().IndexOf(&trace)))
        return;
    trace.RecordSettingChange(kMaskGeometry, NudgeSource().Number());
}

} // namespace Project
