#include "stages/imageHub.h"
#include "stages/preview.h"
#include "stages/result.h"
#include "stages/scaledStage.h"
#include "stages/source.h"

/// The hub's stages: their making, and what they tell one another.
namespace Project
{

using Sarnik::CRect;

PStageSet::PStageSet() = default;
PStageSet::~PStageSet() = default;

namespace
{

/// Makes a stage the first time.
template <class Stage, class... Arguments>
Stage &made(PImageHub &hub, std::unique_ptr<Stage> &stage, Arguments... arguments)
{
    if (!stage)
    {
        stage = std::make_unique<Stage>(hub, arguments...);
        hub.MarkDirty();
    }
    return *stage;
}

} // namespace

PSource &PImageHub::Source()
{
    PSource &source = made(*this, stages.source);
    source.SetBounds(imageBounds);
    return source;
}

PSourceScaled &PImageHub::SourceAccurate()
{
    return made(*this, stages.sourceAccurate, PSourceScaled::From::source);
}

PSourceScaled &PImageHub::SourceFast()
{
    return made(*this, stages.sourceFast, PSourceScaled::From::accurate);
}

PSourceScaled &PImageHub::SourceExtra()
{
    return made(*this, stages.sourceExtra, PSourceScaled::From::source);
}

PResult &PImageHub::ResultRough()
{
    return made(*this, stages.resultRough, PResult::Role::rough);
}

PResult &PImageHub::ResultFast()
{
    return made(*this, stages.resultFast, PResult::Role::fast);
}

PResult &PImageHub::ResultFull()
{
    PResult &result = made(*this, stages.resultFull, PResult::Role::full);
    result.SetBounds(imageBounds);
    return result;
}

PResultScaled &PImageHub::ResultFullScaled()
{
    return made(*this, stages.resultFullScaled);
}

PPreview &PImageHub::PreviewRough()
{
    return made(*this, stages.previewRough, PPreview::Level::rough);
}

PPreview &PImageHub::PreviewFast()
{
    return made(*this, stages.previewFast, PPreview::Level::fast);
}

PPreview &PImageHub::PreviewAccurate()
{
    return made(*this, stages.previewAccurate, PPreview::Level::accurate);
}

void PImageHub::EmptyStages()
{
    for (PStage *stage : std::initializer_list<PStage *>{
             stages.previewRough.get(), stages.previewFast.get(), stages.previewAccurate.get(),
             stages.resultFullScaled.get(), stages.resultRough.get(), stages.resultFull.get(), stages.resultFast.get(),
             stages.sourceFast.get(), stages.sourceAccurate.get(), stages.sourceExtra.get(), stages.source.get()})
        if (stage != nullptr)
            stage->Reset();
    MarkDirty();
}

void PImageHub::SetView(const CRect &rect, double factor)
{
    const CRect wanted = rect.Empty() ? CRect{} : rect;
    const double wantedReduction = factor > 1.0 ? factor : 1.0; // a number that is none is 1, too
    if (wanted == viewBounds && wantedReduction == reduction)
        return;
    viewBounds = wanted;
    reduction = wantedReduction;
    suppressed = 0;
    hasView = !viewBounds.Empty();
    bool scaled = false;
    for (PPreview *preview : {&PreviewRough(), &PreviewFast(), &PreviewAccurate()})
    {
        preview->SetTarget(viewBounds, imageBounds);
        scaled |= preview->UsesScaled();
    }
    if (!scaled)
        // Nobody reads them in a view of the picture's own size: they would only be worked at.
        for (PStage *stage : std::initializer_list<PStage *>{stages.resultFullScaled.get(), stages.resultFast.get(),
                                                             stages.sourceFast.get(), stages.sourceAccurate.get()})
            if (stage != nullptr)
                stage->Reset();
    Rebuild();
}

void PImageHub::TellPreviews(const CRect &area, PNotice from)
{
    for (PPreview *preview : {stages.previewRough.get(), stages.previewFast.get(), stages.previewAccurate.get()})
        if (preview != nullptr)
            preview->Invalidate(area, from);
}

void PImageHub::InvalidateResults(bool rough, bool scaled, bool full)
{
    if (rough && stages.resultRough)
        stages.resultRough->InvalidateAll();
    if (scaled && stages.resultFast)
        stages.resultFast->InvalidateAll();
    if (full && stages.resultFull)
        stages.resultFull->InvalidateAll();
    MarkDirty();
}

void PImageHub::Refresh(bool keepRough)
{
    if (stages.previewRough && !keepRough)
        stages.previewRough->InvalidateAll();
    if (stages.previewFast)
        stages.previewFast->InvalidateAll();
    if (stages.previewAccurate)
        stages.previewAccurate->InvalidateAll();
    Rebuild();
}

void PImageHub::DrawPreview(Sarnik::CMemoryPixmap &to, const CRect &area)
{
    // From the worst to the best, each over what it has finished.
    for (PPreview *preview : {stages.previewRough.get(), stages.previewFast.get(), stages.previewAccurate.get()})
    {
        if (preview == nullptr || !preview->HasPixmap())
            continue;
        const Sarnik::CPixGrid::Range range = preview->Touched(area);
        for (std::int64_t row = range.row; row < range.row + range.rows; ++row)
            for (std::int64_t column = range.column; column < range.column + range.columns; ++column)
                if (preview->CellRemaining(column, row) == 0)
                    preview->Draw(to, preview->TileRect(column, row).Intersected(area));
    }
}

} // namespace Project
