#pragma once

#include "shell/virtualTile.h"

#include <array>
#include <cstddef>
#include <cstdint>

namespace Sarnik
{

/// The memory blocks of a heap: those of tiles, in order of use, and the free ones by class. Knows nothing of disks and
/// limits. One thread at a time.
class CBlockPool
{
public:
    CBlockPool() = default;
    CBlockPool(const CBlockPool &) = delete;
    CBlockPool &operator=(const CBlockPool &) = delete;
    ~CBlockPool();

    /// A new block from the installed allocator or, when that has nothing, of the process's own memory. Throws what
    /// the allocator throws, and std::bad_alloc.
    VirtualBlock *Make(int sizeClass);
    /// One from the free list, or null.
    VirtualBlock *TakeFree(int sizeClass) noexcept;
    /// Frees whole blocks of the free lists, smallest class first, until that many bytes are given back.
    void FreeMemory(std::uint64_t bytes) noexcept;

    /// Makes the block the tile's, at the newest end.
    void Give(VirtualBlock *block, VirtualTile *tile) noexcept;
    /// Takes it from its tile and puts it on the free list.
    void TakeBack(VirtualBlock *block) noexcept;
    /// Moves it to the newest end.
    void Touch(VirtualBlock *block) noexcept;

    VirtualBlock *Oldest() const { return oldest; }
    std::uint64_t TotalBytes() const { return totalBytes; } ///< of all blocks
    std::uint64_t FreeBytes() const { return freeBytes; }   ///< of the blocks on free lists

private:
    void LinkNewest(VirtualBlock *block) noexcept;
    void Unlink(VirtualBlock *block) noexcept;
    void Destroy(VirtualBlock *block) noexcept;

    std::array<VirtualBlock *, tileClassCount> freeBlocks{};
    VirtualBlock *oldest = nullptr;
    VirtualBlock *newest = nullptr;
    std::uint64_t totalBytes = 0;
    std::uint64_t freeBytes = 0;
};

} // namespace Sarnik
