#pragma once

#include "framework/pixels/pixmap.h"

#include <cstdlib>
#include <memory>

namespace Sarnik
{

/// A pixmap whose planes are arrays in memory: any rectangle of it is one piece.
class CBasicPixmap : public CPixmap
{
public:
    /// First sample of a plane, whatever type the depth asks for.
    virtual std::byte *PlaneData(int plane) const = 0;
    /// From a row to the next; the same in every plane.
    virtual std::ptrdiff_t RowBytes() const = 0;

    /// A plane's samples over the whole pixmap; threads may use it side by side.
    CPixelArea Plane(int plane) const { return {Bounds(), PlaneData(plane), RowBytes()}; }
};

/// Keeps its pixels itself. They start as 0.
class CMemoryPixmap final : public CBasicPixmap
{
public:
    /// Throws std::bad_alloc where there is no room, std::invalid_argument for a depth other than 8, 16, 32, 64.
    CMemoryPixmap(const CRect &newBounds, int sampleBits, int planes);
    CMemoryPixmap(std::int32_t width, std::int32_t height, int sampleBits, int planes)
        : CMemoryPixmap(CRect{0, 0, width, height}, sampleBits, planes)
    {
    }

    void SetOrigin(std::int32_t x, std::int32_t y) override;
    void GetBounds(CRect &rect) const override { rect = bounds; }
    int GetPlaneCount() const override { return planeCount; }
    int GetDepth() const override { return depth; }
    void SetSize(std::int32_t width, std::int32_t height) override;
    CPixelLock LockArea(const CRect &area, int plane, CPixelAccess access) override;
    CPixelLock LockPlanes(const CRect &area, int first, int count, CPixelAccess access) override;

    std::byte *PlaneData(int plane) const override { return planeTable[static_cast<std::size_t>(plane)]; }
    std::ptrdiff_t RowBytes() const override { return rowBytes; }

protected:
    void Unlock(std::span<const std::size_t>, CPixelAccess) noexcept override {}

private:
    void Build(const CRect &newBounds);

    struct freeMemory
    {
        void operator()(std::byte *p) const { std::free(p); }
    };

    CRect bounds;
    int depth;
    int planeCount;
    std::ptrdiff_t rowBytes = 0;
    std::unique_ptr<std::byte[], freeMemory> memory;
    std::vector<std::byte *> planeTable;
};

} // namespace Sarnik
