#pragma once

#include "framework/pixels/rect.h"

#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace Sarnik
{

/// Samples of one plane over a rectangle, where they lie in memory.
struct CPixelArea
{
    CRect rect;                ///< in the pixmap's coordinates
    std::byte *data = nullptr; ///< the sample at (rect.left, rect.top)
    std::ptrdiff_t rowBytes = 0;

    /// Samples y of the rows rect.top..rect.bottom-1, from rect.left on.
    template <class Sample> Sample *Row(std::int32_t y) const
    {
        return reinterpret_cast<Sample *>(data + (std::int64_t{y} - rect.top) * rowBytes);
    }
};

enum class CPixelAccess
{
    read,
    write
};

class CPixmap;

/// Holds memory of a pixmap; given back when it goes. Every plane has the same rectangle.
class CPixelLock
{
public:
    CPixelLock() = default;
    CPixelLock(CPixelLock &&other) noexcept { Swap(other); }
    CPixelLock &operator=(CPixelLock &&other) noexcept
    {
        Swap(other);
        return *this;
    }
    ~CPixelLock();

    /// What the lock holds: it starts where the wanted rectangle starts (cut to the pixmap) and ends where the pixmap's
    /// memory stops being in one piece. Empty where the two share nothing.
    const CRect &Rect() const { return rect; }
    std::span<const CPixelArea> Planes() const { return planes; }
    const CPixelArea &operator[](std::size_t plane) const { return planes[plane]; }

private:
    friend class CPixmap;
    friend class CMemoryPixmap;
    friend class CVirtualPixmap;
    void Swap(CPixelLock &other) noexcept;

    CRect rect;
    std::vector<CPixelArea> planes;
    CPixmap *pixmap = nullptr; ///< set while something must be told of the end
    std::vector<std::size_t> pins;
    CPixelAccess access = CPixelAccess::read;
};

/// A store of pixels: planes of equal size, 8, 16, 32 (float) or 64 (double) bits a sample, over a rectangle of the
/// picture. 16-bit samples are whatever their owner says: the host's run from 0 to 32768.
class CPixmap
{
public:
    virtual ~CPixmap() = default;
    /// Moves the rectangle; the pixels go with it.
    virtual void SetOrigin(std::int32_t x, std::int32_t y) = 0;
    virtual void GetBounds(CRect &rect) const = 0;
    virtual int GetPlaneCount() const = 0;
    virtual int GetDepth() const = 0; ///< bits
    /// A new size at the same origin; the pixels are lost and read as 0. Negative counts as 0.
    virtual void SetSize(std::int32_t width, std::int32_t height) = 0;
    /// One plane of a rectangle. What is written under a lock for reading may be lost.
    virtual CPixelLock LockArea(const CRect &area, int plane, CPixelAccess access) = 0;
    /// Some planes of a rectangle.
    virtual CPixelLock LockPlanes(const CRect &area, int first, int count, CPixelAccess access) = 0;

    CRect Bounds() const
    {
        CRect rect;
        GetBounds(rect);
        return rect;
    }

protected:
    friend class CPixelLock;
    CPixmap() = default;
    CPixmap(const CPixmap &) = delete;
    CPixmap &operator=(const CPixmap &) = delete;
    virtual void Unlock(std::span<const std::size_t> pins, CPixelAccess access) noexcept = 0;
};

/// Visits a rectangle of a pixmap (cut to its bounds) in pieces that lie in memory, row of pieces by row:
/// visit(const CPixelLock &).
template <class Visit>
void forEachPiece(CPixmap &pixmap, const CRect &rect, int first, int count, CPixelAccess access, Visit visit)
{
    const CRect inside = rect.Intersected(pixmap.Bounds());
    if (inside.Empty())
        return;
    for (std::int32_t top = inside.top, next = top; top < inside.bottom; top = next)
        for (std::int32_t left = inside.left; left < inside.right;)
        {
            const CPixelLock lock = pixmap.LockPlanes({left, top, inside.right, inside.bottom}, first, count, access);
            left = lock.Rect().right;
            next = lock.Rect().bottom;
            visit(lock);
        }
}

/// Copies `count` planes over what the rectangle and both pixmaps share. Both have one depth; otherwise throws
/// std::invalid_argument.
void copyPlanes(CPixmap &destination, int firstDestination, CPixmap &source, int firstSource, int count,
                const CRect &rect);

} // namespace Sarnik
