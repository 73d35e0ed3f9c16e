#pragma once

#include "framework/pixels/pageStore.h"
#include "framework/pixels/pixmap.h"
#include "framework/pixels/tileShape.h"

namespace Sarnik
{

/// A pixmap in tiles of a page store, for pictures larger than memory. Pixels that were never written read as 0. Locks
/// hold the tiles of one rectangle in memory: keep them short. One thread at a time, as the store.
class CVirtualPixmap final : public CPixmap
{
public:
    /// depthLog: 3, 4, 5 for 8, 16, 32 bits. tileSpec: see tileShape. interleaved: the planes of a tile follow one
    /// another, else the tiles of a plane. prepare: every tile is acquired here, so that lack of scratch space shows at
    /// once. The store outlives the pixmap.
    CVirtualPixmap(CPageStore &store, int depthLog, std::int32_t width, std::int32_t height, int planes,
                   std::uint32_t tileSpec, bool interleaved, bool prepare);
    ~CVirtualPixmap() override;

    void SetOrigin(std::int32_t x, std::int32_t y) override;
    void GetBounds(CRect &rect) const override { rect = bounds; }
    int GetPlaneCount() const override { return planeCount; }
    int GetDepth() const override { return 1 << depthLog; }
    void SetSize(std::int32_t width, std::int32_t height) override;
    CPixelLock LockArea(const CRect &area, int plane, CPixelAccess access) override;
    CPixelLock LockPlanes(const CRect &area, int first, int count, CPixelAccess access) override;

    const CTileShape &TileShape() const { return shape; }
    std::int64_t TilesX() const { return tilesX; }
    std::int64_t TilesY() const { return tilesY; }
    std::size_t TileNumber(std::int64_t tx, std::int64_t ty, int plane) const;

protected:
    void Unlock(std::span<const std::size_t> pins, CPixelAccess access) noexcept override;

private:
    void ReleaseTiles() noexcept;
    CPageStore &store;
    const int depthLog;
    const int planeCount;
    const CTileShape shape;
    const bool interleaved;
    const bool prepare;
    CRect bounds;
    std::int64_t tilesX = 0, tilesY = 0;
    std::vector<CPageStore::Page> tiles; ///< null: nothing was asked of the tile yet
};

} // namespace Sarnik
