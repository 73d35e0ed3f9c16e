#pragma once

#include "shell/pageFile.h"
#include "shell/virtualTile.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <vector>

namespace Sarnik
{

/// The tiles of a heap and the files that they lie in. Tiles stay where they are until the pool dies; free ones are
/// kept by the size of their room on disk. One thread at a time.
class CTilePool
{
public:
    CTilePool() = default;
    CTilePool(const CTilePool &) = delete;
    CTilePool &operator=(const CTilePool &) = delete;

    /// Makes one page file on each volume that takes one, 16 in all.
    void Open(const std::vector<ScratchVolume> &volumes);

    /// A free tile with room of diskClass on disk, or null when there is no room left. New tiles are cut hint at a
    /// time, small ones in bulk whatever the hint.
    VirtualTile *Take(int diskClass, std::uint64_t hint);
    /// To the end of its free list: tiles given back in order come again in order, and so are read in order.
    void GiveBack(VirtualTile *tile) noexcept;

    CPageFile &FileAndOffset(DiskLocation location, std::uint32_t &unit) const;

    std::size_t FreeCount(int diskClass) const { return freeTiles[static_cast<std::size_t>(diskClass)].count; }

private:
    struct freeList
    {
        VirtualTile *head = nullptr;
        VirtualTile *tail = nullptr;
        std::size_t count = 0;
    };

    void CutTiles(int diskClass, std::uint64_t count);

    std::vector<std::unique_ptr<CPageFile>> files;
    std::vector<std::unique_ptr<VirtualTile[]>> chunks;
    std::array<freeList, tileClassCount> freeTiles;
};

} // namespace Sarnik
