#include "platform/clock.h"
#include "stages/imageHub.h"
#include "stages/preview.h"
#include "stages/result.h"
#include "stages/scaledStage.h"
#include "stages/source.h"
#include "stages/stageView.h"
#include "store/params.h"
#include "store/timeLog.h"

#include <algorithm>

/// Who makes the stages move, and in which order.
namespace Project
{

using Sarnik::CRect;

bool PImageHub::ViewActive() const
{
    return view != nullptr && hasView && view->Active();
}

bool PImageHub::IsPreviewFinal() const
{
    return host.Params().fineResult ? !fastEnabled : !roughEnabled;
}

void PImageHub::Rebuild()
{
    const PParams &params = host.Params();
    dirty = false;
    abandoned = 0;
    const PResult *full = stages.resultFull.get();
    const bool fullBehind = full != nullptr && full->RemainingAll() != 0;

    if (!stages.previewRough)
        roughEnabled = false;
    else if (!params.showPreview)
        roughEnabled = true; // it shows the source
    else if (suppressed == 1)
        roughEnabled = false;
    else if (!params.accuratePreview)
        roughEnabled = true;
    else
        roughEnabled = (params.fineResult || stages.previewRough->DifferentSize() || reduction > 1.0) && fullBehind;

    if (!stages.previewFast || !params.fineResult)
        fastEnabled = false;
    else if (!params.showPreview || !params.accuratePreview)
        fastEnabled = true;
    else
        fastEnabled = (stages.previewFast->DifferentSize() || reduction > 1.0) && fullBehind;

    CountWork();
    if (params.showPreview && ViewActive())
    {
        const auto startTimer = [](std::unique_ptr<PTimeLogger> &timer, const PPreview &preview, const char *title) {
            if (timer || preview.RemainingAll() == 0)
                return;
            timer = std::make_unique<PTimeLogger>(title);
            timer->Start();
        };
        if (params.outputLog && roughEnabled)
            startTimer(roughTimer, *stages.previewRough, "Rough Preview");
        if (params.outputLog && fastEnabled)
            startTimer(fastTimer, *stages.previewFast, "Fast Preview");
    }
    if (view != nullptr && busyDepth == 0)
    {
        view->WantIdle(doneWork < totalWork);
        view->ShowProgress(shownTotal == 0 ? 1.0
                                           : static_cast<double>(std::min(shownDone, shownTotal)) /
                                                 static_cast<double>(shownTotal));
    }
}

void PImageHub::CountWork()
{
    const PParams &params = host.Params();
    totalWork = doneWork = shownTotal = shownDone = 0;
    const auto add = [this](const PStage *stage, bool shown) {
        if (stage == nullptr)
            return;
        const std::uint64_t total = stage->TotalAll(), done = stage->DoneAll();
        totalWork += total;
        doneWork += done;
        shownTotal += shown ? total : 0;
        shownDone += shown ? done : 0;
    };
    if (ViewActive())
    {
        if (roughEnabled)
            add(stages.previewRough.get(), true);
        if (fastEnabled)
            add(stages.previewFast.get(), true);
        if (params.accuratePreview)
            add(stages.previewAccurate.get(), IsPreviewFinal());
    }
    add(stages.source.get(), stages.previewFast != nullptr);
    add(stages.sourceFast.get(), stages.previewFast != nullptr);
    add(stages.sourceAccurate.get(), stages.previewFast != nullptr);
    if (params.showPreview && params.accuratePreview)
        add(stages.resultFull.get(), !(params.fineResult ? fastEnabled : roughEnabled));
    add(stages.sourceExtra.get(), false);
}

void PImageHub::SetSuppressed(int value)
{
    if (suppressed == value)
        return;
    suppressed = value;
    if (stages.previewRough)
        stages.previewRough->InvalidateAll();
    if (stages.previewFast)
        stages.previewFast->InvalidateAll();
    if (stages.previewAccurate && host.Params().accuratePreview)
        stages.previewAccurate->InvalidateAll();
    MarkDirty();
}

void PImageHub::CellShown(const CRect &cell)
{
    if (view != nullptr)
        view->Redraw(cell);
}

void PImageHub::SetIndicator(int value)
{
    if (indicator == value)
        return;
    indicator = value;
    if (view != nullptr)
        view->RedrawIndicator();
}

void PImageHub::StopTimer(std::unique_ptr<PTimeLogger> &timer)
{
    if (!timer)
        return;
    timer->Stop();
    timer.reset();
}

std::uint64_t PImageHub::StepVisible(PPreview &preview)
{
    const CRect visible = view->Visible().Intersected(viewBounds);
    const CRect focus = view->Focus();
    const CRect first =
        CRect{CRect::Clamped(std::int64_t{focus.left} - 1), CRect::Clamped(std::int64_t{focus.top} - 1),
              CRect::Clamped(std::int64_t{focus.right} + 1), CRect::Clamped(std::int64_t{focus.bottom} + 1)}
            .Intersected(visible);
    if (!preview.Finished(visible))
        preview.LookAhead(visible);
    const std::uint64_t done = focus.Empty() || first.Empty() ? 0 : preview.StepRect(first);
    return done != 0 || visible.Empty() ? done : preview.StepRect(visible);
}

std::uint64_t PImageHub::StepLevel(PPreview &preview, const PStage *result, int shows)
{
    const std::uint64_t done = StepVisible(preview);
    if (done != 0 && host.Params().showPreview && result != nullptr && result->RemainingAll() != 0)
        SetIndicator(shows);
    return done;
}

std::uint64_t PImageHub::StepStage(PStage *stage)
{
    if (stage == nullptr || stage->RemainingAll() == 0)
        return 0;
    stage->LookAhead(stage->Rect());
    return stage->StepAll();
}

std::uint64_t PImageHub::Step()
{
    const PParams &params = host.Params();
    const bool active = ViewActive();
    const bool rough = active && roughEnabled, fast = active && fastEnabled;
    const bool accurate = active && params.accuratePreview && stages.previewAccurate != nullptr;
    std::uint64_t done = 0;
    if (rough && (done = StepLevel(*stages.previewRough, stages.resultRough.get(), 1)) != 0)
        return done;
    if ((done = StepStage(stages.sourceExtra.get())) != 0)
        return done;
    if (fast)
    {
        StopTimer(roughTimer);
        const PStage *result = stages.resultFast && stages.resultFast->HasPixmap()
                                   ? static_cast<const PStage *>(stages.resultFast.get())
                                   : stages.resultFull.get();
        if ((done = StepLevel(*stages.previewFast, result, 2)) != 0)
            return done;
    }
    if (rough && (done = StepStage(stages.previewRough.get())) != 0)
        return done;
    if (fast && (done = StepStage(stages.previewFast.get())) != 0)
        return done;
    if ((done = StepStage(stages.source.get())) != 0 || (done = StepStage(stages.sourceFast.get())) != 0)
        return done;
    if (accurate)
    {
        StopTimer(fastTimer);
        if ((done = StepLevel(*stages.previewAccurate, stages.resultFull.get(), 3)) != 0 ||
            (done = StepStage(stages.previewAccurate.get())) != 0)
            return done;
    }
    if ((done = StepStage(stages.sourceAccurate.get())) != 0)
        return done;
    // What nobody is shown is computed only for the sake of the final quality.
    return params.showPreview && params.accuratePreview ? StepStage(stages.resultFull.get()) : 0;
}

bool PImageHub::Idle(double budget)
{
    if (busyDepth > 0)
        return false;
    if (dirty)
        Rebuild();
    const std::uint64_t start = Platform::systemClock().ticks();
    const auto spent = [start] { return static_cast<double>(Platform::systemClock().ticks() - start) / 1000.0; };
    abandoned = 0;
    bool stepped = doneWork < totalWork;
    while (stepped && Step() != 0 && abandoned == 0 && !dirty)
        stepped = spent() < budget;
    abandoned = 0;
    // Counted from the cells' states: exact, whatever a step has brought forward on the way.
    Rebuild();
    if (doneWork < totalWork)
        return true;
    StopTimer(roughTimer);
    StopTimer(fastTimer);
    if (hasView)
        SetIndicator(4);
    return false;
}

} // namespace Project
