#include "stages/preview.h"

#include "stages/displayConversion.h"
#include "stages/imageHub.h"
#include "stages/result.h"
#include "stages/scaledStage.h"
#include "stages/source.h"
#include "store/params.h"

#include <algorithm>
#include <cmath>

namespace Project
{

using Sarnik::CMemoryPixmap;
using Sarnik::CRect;

PPreview::PPreview(PImageHub &owner, Level quality)
    : PStage(owner, 2 + static_cast<std::uint32_t>(quality)), level(quality)
{
}

void PPreview::Reset()
{
    PStage::Reset();
    imageRect = reducedRect = {};
}

void PPreview::SetTarget(const CRect &viewRect, const CRect &wholeImage)
{
    if (viewRect.Empty() || wholeImage.Empty())
        return Reset();
    Place(viewRect, 32, 1);
    const CRect reduced = hub.ReducedView();
    if (wholeImage != imageRect || reduced.Width() != reducedRect.Width() || reduced.Height() != reducedRect.Height())
        InvalidateAll();
    imageRect = wholeImage;
    reducedRect = reduced;
    differentSize = viewRect.Width() != imageRect.Width() || viewRect.Height() != imageRect.Height();

    hub.Source();
    hub.ResultFull();
    if (!Direct())
    {
        hub.SourceAccurate().SetBounds(viewRect, imageRect);
        hub.SourceFast().SetBounds(reduced, viewRect);
        hub.ResultFullScaled().SetBounds(viewRect, imageRect);
        hub.ResultFast().SetBounds(reduced);
    }
    if (level == Level::rough)
        // At full size the picture's own place, so that it is the stage of that size.
        hub.ResultRough().SetBounds(Direct() ? imageRect : reduced);
    if (Enlarges())
        enlarger = Sarnik::CPixmapScaler(reduced, viewRect);
}

bool PPreview::Direct() const
{
    return !differentSize && (level == Level::accurate || hub.Reduction() <= 1.0);
}

bool PPreview::Enlarges() const
{
    return !Direct() && level != Level::accurate && hub.Reduction() > 1.0;
}

PStage &PPreview::SourceStage() const
{
    if (Direct())
        return hub.Source();
    return hub.SourceAccurate();
}

PStage &PPreview::ResultStage() const
{
    if (level == Level::rough)
        return hub.ResultRough();
    if (Direct())
        return hub.ResultFull();
    if (level == Level::fast)
        return hub.ResultFast();
    return hub.ResultFullScaled();
}

CRect PPreview::InSource(const CRect &area) const
{
    if (!Direct())
        return area;
    return area.Moved(std::int64_t{imageRect.left} - Rect().left, std::int64_t{imageRect.top} - Rect().top);
}

CRect PPreview::InResult(const CRect &area) const
{
    return Enlarges() ? enlarger.SourceOf(area) : InSource(area);
}

void PPreview::LookAhead(const CRect &area)
{
    if (ShowsResult())
        ResultStage().LookAhead(InResult(area));
}

bool PPreview::ShowsResult() const
{
    return hub.Host().Params().showPreview && !showOriginal;
}

std::uint64_t PPreview::ProcessCell(std::int64_t column, std::int64_t row, bool force)
{
    if (CellRemaining(column, row) == 0)
        return 0;
    const CRect cell = TileRect(column, row).Intersected(Rect());
    std::uint64_t count = 0;
    const auto bringForward = [&](PStage &stage, const CRect &area) {
        const std::uint64_t done = force ? stage.ForceRect(area) : stage.StepRect(area);
        count += done;
        return force ? stage.Finished(area) : done == 0;
    };
    if (!bringForward(SourceStage(), InSource(cell)))
        return count;
    if (ShowsResult() && !bringForward(ResultStage(), InResult(cell)))
        return count;
    Convert(cell);
    count += CellRemaining(column, row);
    State(column, row) = TargetState();
    hub.CellShown(cell);
    return count;
}

void PPreview::Convert(const CRect &cell)
{
    const PPlaneLayout layout = hub.Layout();
    CMemoryPixmap shown(cell, layout.depth, layout.ResultPlanes());
    PStage &stage = ShowsResult() ? ResultStage() : SourceStage();
    const CRect area = ShowsResult() ? InResult(cell) : InSource(cell);
    if (ShowsResult() && Enlarges())
    {
        CMemoryPixmap small(area, layout.depth, layout.ResultPlanes());
        copyPlanes(small, 0, stage.Pixmap(), 0, layout.ResultPlanes(), area);
        enlarger.Scale(small, 0, shown, 0, layout.ResultPlanes());
    }
    else
    {
        shown.SetOrigin(area.left, area.top);
        copyPlanes(shown, 0, stage.Pixmap(), 0, layout.ResultPlanes(), area);
        shown.SetOrigin(cell.left, cell.top);
    }
    CMemoryPixmap packed(cell, 32, 1);
    ConvertForDisplay({hub.Host().Format(), layout.transparency && composeMask, hub.Host().CmykConverter()}, shown,
                      packed);
    copyPlanes(Pixmap(), 0, packed, 0, 1, cell);
}

void PPreview::Invalidate(const CRect &changed, PNotice from)
{
    if (!HasPixmap())
        return;
    CRect area = changed;
    if (Direct())
    {
        const PNotice result = level == Level::rough ? PNotice::resultRough : PNotice::resultFull;
        if (from != PNotice::source && from != result)
            return;
        area = changed.Moved(std::int64_t{Rect().left} - imageRect.left, std::int64_t{Rect().top} - imageRect.top);
    }
    else
    {
        const PNotice result = level == Level::rough  ? PNotice::resultRough
                               : level == Level::fast ? PNotice::resultFast
                                                      : PNotice::resultFullScaled;
        if (from != PNotice::sourceScaled && from != result)
            return;
        if (from == result && Enlarges())
            area = enlarger.AreaOf(changed);
    }
    LowerState(area.Intersected(Rect()), 0);
}

void PPreview::InvalidateAll()
{
    LowerState(Rect(), 0);
    hub.MarkDirty();
}

void PPreview::SetComposeMask(bool compose)
{
    if (composeMask == compose)
        return;
    composeMask = compose;
    InvalidateAll();
}

void PPreview::SetShowOriginal(bool show, std::uint8_t limit)
{
    overflowLimit = limit;
    if (showOriginal == show)
        return;
    showOriginal = show;
    if (hub.Host().Params().showPreview)
        InvalidateAll();
}

void PPreview::Draw(CMemoryPixmap &to, const CRect &area)
{
    copyPlanes(to, 0, Pixmap(), 0, 1, area);
    if (!showOriginal)
        return;
    const CRect inside = area.Intersected(Rect()).Intersected(to.Bounds());
    const std::uint32_t colour = hub.Host().Params().overflowColour;
    const Sarnik::CPixelArea plane = to.Plane(0);
    for (std::int32_t y = inside.top; y < inside.bottom; ++y)
    {
        std::uint32_t *row = plane.Row<std::uint32_t>(y) - plane.rect.left;
        for (std::int32_t x = inside.left; x < inside.right; ++x)
        {
            const std::uint32_t brightest = std::max({row[x] >> 16 & 255u, row[x] >> 8 & 255u, row[x] & 255u});
            if (brightest > overflowLimit)
                row[x] = colour;
        }
    }
}

} // namespace Project
