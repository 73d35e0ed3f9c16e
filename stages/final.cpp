#include "stages/final.h"

#include "stages/imageHub.h"
#include "stages/result.h"

namespace Project
{

using Sarnik::CRect;

void PFinal::SetBounds(const CRect &rect)
{
    bounds = rect.Intersected(hub.ImageBounds());
    if (bounds.Empty())
        return Reset();
    const CRect &image = hub.ImageBounds();
    Allocate(bounds, {image.left, image.top, CRect::Clamped(std::int64_t{image.left} + hub.CellSize()),
                      CRect::Clamped(std::int64_t{image.top} + hub.CellSize())});
}

std::uint64_t PFinal::ProcessCell(std::int64_t column, std::int64_t row, bool force)
{
    if (CellRemaining(column, row) == 0)
        return 0;
    const CRect cell = TileRect(column, row);
    PResult &result = hub.ResultFull();
    std::uint64_t count = 0;
    if (force)
        count = result.ForceRect(cell);
    else if ((count = result.StepRect(cell)) != 0)
        return count;
    WriteFrom(column, row, result);
    return count + 1;
}

void PFinal::WriteFrom(std::int64_t column, std::int64_t row, PStage &stage)
{
    const PPlaneLayout layout = hub.Layout();
    const CRect cell = TileRect(column, row);
    Sarnik::CMemoryPixmap pixels(cell, layout.depth, layout.ResultPlanes());
    copyPlanes(pixels, 0, stage.Pixmap(), 0, layout.ResultPlanes(), cell);
    Write(column, row, pixels);
}

void PFinal::Write(std::int64_t column, std::int64_t row, Sarnik::CMemoryPixmap &pixels)
{
    hub.Host().Write(pixels, TileRect(column, row));
    ++State(column, row);
}

} // namespace Project
