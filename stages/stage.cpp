#include "stages/stage.h"

#include "stages/imageHub.h"

#include <bit>

namespace Project
{

using Sarnik::CRect;
using Sarnik::CVirtualPixmap;

namespace
{

/// Squares of 256 pixels: four to a cell, small enough for a heap that must page.
constexpr std::uint32_t tiles = Sarnik::tilePreset | 2u;

} // namespace

void PStage::Reset()
{
    Clear();
    pixmap.reset();
    rect = {};
}

bool PStage::Place(const CRect &newRect, int depth, int planes)
{
    const CRect wanted = newRect.Empty() ? CRect{newRect.left, newRect.top, newRect.left, newRect.top} : newRect;
    if (pixmap && wanted.Width() == rect.Width() && wanted.Height() == rect.Height() && depth == pixmap->GetDepth() &&
        planes == pixmap->GetPlaneCount() && tileWidth == hub.CellSize())
    {
        pixmap->SetOrigin(wanted.left, wanted.top);
        rect = wanted;
        left = wanted.left;
        top = wanted.top;
        return false;
    }
    Reset();
    if (!wanted.Empty())
    {
        pixmap =
            std::make_unique<CVirtualPixmap>(hub.Host().PageStore(), std::countr_zero(static_cast<unsigned>(depth)),
                                             static_cast<std::int32_t>(wanted.Width()),
                                             static_cast<std::int32_t>(wanted.Height()), planes, tiles, true, false);
        pixmap->SetOrigin(wanted.left, wanted.top);
        const CRect cell{wanted.left, wanted.top, CRect::Clamped(std::int64_t{wanted.left} + hub.CellSize()),
                         CRect::Clamped(std::int64_t{wanted.top} + hub.CellSize())};
        Allocate(wanted, cell);
    }
    rect = wanted;
    return true;
}

} // namespace Project
