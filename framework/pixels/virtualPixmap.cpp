#include "framework/pixels/virtualPixmap.h"

#include <cassert>
#include <stdexcept>

namespace Sarnik
{

CVirtualPixmap::CVirtualPixmap(CPageStore &pages, int sampleBitsLog, std::int32_t width, std::int32_t height,
                               int planes, std::uint32_t tileSpec, bool planesTogether, bool acquireAll)
    : store(pages), depthLog(sampleBitsLog), planeCount(planes), shape(tileShape(tileSpec, sampleBitsLog)),
      interleaved(planesTogether), prepare(acquireAll)
{
    if (planes < 0)
        throw std::invalid_argument("a pixmap has no negative number of planes");
    SetSize(width, height);
}

CVirtualPixmap::~CVirtualPixmap()
{
    ReleaseTiles();
}

void CVirtualPixmap::ReleaseTiles() noexcept
{
    for (const CPageStore::Page page : tiles)
        if (page != nullptr)
            store.ReleasePage(page);
    tiles.clear();
}

void CVirtualPixmap::SetOrigin(std::int32_t x, std::int32_t y)
{
    bounds = bounds.Moved(std::int64_t{x} - bounds.left, std::int64_t{y} - bounds.top);
}

void CVirtualPixmap::SetSize(std::int32_t width, std::int32_t height)
{
    ReleaseTiles();
    bounds = {bounds.left, bounds.top, CRect::Clamped(std::int64_t{bounds.left} + std::max(0, width)),
              CRect::Clamped(std::int64_t{bounds.top} + std::max(0, height))};
    tilesX = (bounds.Width() + shape.width - 1) / shape.width;
    tilesY = (bounds.Height() + shape.height - 1) / shape.height;
    std::size_t count = 0;
    if (__builtin_mul_overflow(tilesX * tilesY, planeCount, &count))
        throw std::length_error("more tiles than can be counted");
    try
    {
        tiles.resize(count);
        if (prepare)
            for (CPageStore::Page &page : tiles)
                page = store.AcquirePage(shape.sizeClass, count);
    }
    catch (...)
    {
        ReleaseTiles();
        bounds.right = bounds.left;
        bounds.bottom = bounds.top;
        tilesX = tilesY = 0;
        throw;
    }
}

std::size_t CVirtualPixmap::TileNumber(std::int64_t tx, std::int64_t ty, int plane) const
{
    return static_cast<std::size_t>(interleaved ? (ty * tilesX + tx) * planeCount + plane
                                                : (plane * tilesY + ty) * tilesX + tx);
}

CPixelLock CVirtualPixmap::LockArea(const CRect &area, int plane, CPixelAccess access)
{
    return LockPlanes(area, plane, 1, access);
}

CPixelLock CVirtualPixmap::LockPlanes(const CRect &area, int first, int count, CPixelAccess access)
{
    assert(first >= 0 && count >= 0 && first + count <= planeCount);
    CPixelLock lock;
    const CRect inside = area.Intersected(bounds);
    if (inside.Empty())
        return lock;

    // The part of the rectangle that lies in the tile of its top left corner.
    const std::int64_t tx = (std::int64_t{inside.left} - bounds.left) / shape.width;
    const std::int64_t ty = (std::int64_t{inside.top} - bounds.top) / shape.height;
    const CRect tileRect =
        CRect{CRect::Clamped(bounds.left + tx * shape.width), CRect::Clamped(bounds.top + ty * shape.height),
              CRect::Clamped(bounds.left + (tx + 1) * shape.width),
              CRect::Clamped(bounds.top + (ty + 1) * shape.height)}
            .Intersected(bounds);
    const CRect rect = inside.Intersected(tileRect);
    const bool wholeWrite = access == CPixelAccess::write && rect == tileRect;

    const std::ptrdiff_t sampleBytes = GetDepth() / 8;
    const std::ptrdiff_t rowBytes = shape.width * sampleBytes;
    const std::ptrdiff_t offset =
        (std::int64_t{rect.top} - tileRect.top) * rowBytes + (std::int64_t{rect.left} - tileRect.left) * sampleBytes;
    lock.planes.reserve(static_cast<std::size_t>(count));
    lock.pins.reserve(static_cast<std::size_t>(count));
    lock.access = access;
    lock.pixmap = this; // from here on a failure gives back what is locked
    for (int p = first; p < first + count; ++p)
    {
        const std::size_t number = TileNumber(tx, ty, p);
        if (tiles[number] == nullptr)
            tiles[number] = store.AcquirePage(shape.sizeClass, 1);
        std::byte *data = store.LockPage(tiles[number], wholeWrite);
        lock.pins.push_back(number);
        lock.planes.push_back({rect, data + offset, rowBytes});
    }
    lock.rect = rect;
    return lock;
}

void CVirtualPixmap::Unlock(std::span<const std::size_t> pins, CPixelAccess access) noexcept
{
    for (const std::size_t number : pins)
        store.UnlockPage(tiles[number], access == CPixelAccess::write);
}

} // namespace Sarnik
