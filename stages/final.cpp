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
    WriteCell(cell.Intersected(bounds), result);
    ++State(column, row);
    return count + 1;
}

void PFinal::WriteCell(const CRect &cell, PResult &result)
{
    if (cell.Empty())
        return;
    const PPlaneLayout layout = hub.Layout();
    Sarnik::CMemoryPixmap pixels(cell, layout.depth, layout.ResultPlanes());
    copyPlanes(pixels, 0, result.Pixmap(), 0, layout.ResultPlanes(), cell);
    hub.Host().Write(pixels, cell);
}

} // namespace Project
