#include "stages/source.h"

#include "stages/imageHub.h"
#include "stages/result.h"
#include "stages/scaledStage.h"

namespace Project
{

using Sarnik::CMemoryPixmap;
using Sarnik::CRect;

void PSource::SetBounds(const CRect &newRect)
{
    const PPlaneLayout layout = hub.Layout();
    if (newRect == Rect() && HasPixmap())
        return;
    Reset(); // moved pixels would be those of another place
    Place(newRect, layout.depth, layout.SourcePlanes());
}

void PSource::Invalidate(const CRect &wanted)
{
    const CRect area = wanted.Intersected(Rect());
    if (area.Empty())
        return;
    LowerState(area, 0);
    const PStageSet &stages = hub.Stages();
    for (PSourceScaled *scaled : {stages.sourceAccurate.get(), stages.sourceExtra.get()})
        if (scaled != nullptr)
            scaled->Notify(area);
    for (PResult *result : {stages.resultFull.get(), stages.resultRough.get(), stages.resultFast.get()})
        if (result != nullptr && !result->Scaled())
            result->Notify(area);
    hub.TellPreviews(area, PNotice::source);
    hub.MarkDirty();
}

std::uint64_t PSource::ProcessCell(std::int64_t column, std::int64_t row, bool)
{
    if (CellRemaining(column, row) == 0)
        return 0;
    const CRect cell = TileRect(column, row).Intersected(Rect());
    if (!cell.Empty())
    {
        const PPlaneLayout layout = hub.Layout();
        CMemoryPixmap pixels(cell, layout.depth, layout.ResultPlanes());
        hub.Host().ReadSource(pixels);
        copyPlanes(Pixmap(), 0, pixels, 0, layout.ResultPlanes(), cell);
        if (layout.selection)
        {
            CMemoryPixmap selected(cell, layout.depth, 1);
            hub.Host().ReadSelection(selected, 0);
            copyPlanes(Pixmap(), layout.SelectionPlane(), selected, 0, 1, cell);
        }
    }
    ++State(column, row);
    return 1;
}

} // namespace Project
