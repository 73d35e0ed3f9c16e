#include "framework/pixels/memoryPixmap.h"

#include <cassert>
#include <new>
#include <stdexcept>

namespace Sarnik
{
namespace
{

/// Rows begin on these, counted from the first: a cache line, so that no two rows share one.
constexpr std::int64_t rowAlignment = 64;

} // namespace

CMemoryPixmap::CMemoryPixmap(const CRect &newBounds, int sampleBits, int planes) : depth(sampleBits), planeCount(planes)
{
    if (depth != 8 && depth != 16 && depth != 32 && depth != 64)
        throw std::invalid_argument("a pixmap has 8, 16, 32 or 64 bits a sample");
    if (planes < 0)
        throw std::invalid_argument("a pixmap has no negative number of planes");
    Build(newBounds);
}

void CMemoryPixmap::Build(const CRect &newBounds)
{
    const CRect wanted =
        newBounds.Empty() ? CRect{newBounds.left, newBounds.top, newBounds.left, newBounds.top} : newBounds;
    const std::int64_t bytes = (wanted.Width() * (depth / 8) + rowAlignment - 1) / rowAlignment * rowAlignment;
    std::size_t planeBytes = 0, total = 0;
    if (__builtin_mul_overflow(bytes, wanted.Height(), &planeBytes) ||
        __builtin_mul_overflow(planeBytes, planeCount, &total) || total > PTRDIFF_MAX)
        throw std::bad_alloc();

    // calloc has large blocks from the system, which come zeroed without a sweep.
    std::unique_ptr<std::byte[], freeMemory> block(static_cast<std::byte *>(std::calloc(total + 1, 1)));
    if (!block)
        throw std::bad_alloc();
    std::vector<std::byte *> table(static_cast<std::size_t>(planeCount));
    for (std::size_t p = 0; p < table.size(); ++p)
        table[p] = block.get() + p * planeBytes;

    bounds = wanted;
    rowBytes = bytes;
    memory = std::move(block);
    planeTable = std::move(table);
}

void CMemoryPixmap::SetOrigin(std::int32_t x, std::int32_t y)
{
    bounds = bounds.Moved(std::int64_t{x} - bounds.left, std::int64_t{y} - bounds.top);
}

void CMemoryPixmap::SetSize(std::int32_t width, std::int32_t height)
{
    Build({bounds.left, bounds.top, CRect::Clamped(std::int64_t{bounds.left} + width),
           CRect::Clamped(std::int64_t{bounds.top} + height)});
}

CPixelLock CMemoryPixmap::LockArea(const CRect &area, int plane, CPixelAccess access)
{
    return LockPlanes(area, plane, 1, access);
}

CPixelLock CMemoryPixmap::LockPlanes(const CRect &area, int first, int count, CPixelAccess)
{
    assert(first >= 0 && count >= 0 && first + count <= planeCount);
    CPixelLock lock;
    lock.rect = area.Intersected(bounds);
    if (lock.rect.Empty())
        return lock;
    const std::ptrdiff_t offset = (std::int64_t{lock.rect.top} - bounds.top) * rowBytes +
                                  (std::int64_t{lock.rect.left} - bounds.left) * (depth / 8);
    lock.planes.reserve(static_cast<std::size_t>(count));
    for (int p = first; p < first + count; ++p)
        lock.planes.push_back({lock.rect, PlaneData(p) + offset, rowBytes});
    return lock;
}

} // namespace Sarnik
