#pragma once

#include "shell/blockPool.h"
#include "shell/pagePin.h"
#include "shell/tilePool.h"

#include <cstdint>
#include <mutex>
#include <vector>

namespace Sarnik
{

/// Somebody who holds tiles, to be told when there is no heap any more and the tiles are gone.
class CVirtualHeapClient
{
public:
    virtual void HeapGone() noexcept = 0;

protected:
    ~CVirtualHeapClient() = default;
};

/// Pictures that need not fit in memory: tiles of 16 size classes, 256 bytes to 8 MiB, that page between memory blocks,
/// of which there are no more than a limit allows, and scratch files. The tile used longest ago leaves first.
///
/// A new tile reads as zeros. Nothing is freed while the limit allows it, and a tile is written only when it has
/// changed. When a page cannot be written or read CError is thrown and nothing is lost: whatever was in memory stays
/// there, and the heap goes on working once the disk does.
///
/// Any thread may call at any time; one lock is held, also while pages travel.
class CVirtualHeap
{
public:
    /// The limit starts at half of the physical memory, and at 16 MiB at least.
    CVirtualHeap();
    CVirtualHeap(const CVirtualHeap &) = delete;
    CVirtualHeap &operator=(const CVirtualHeap &) = delete;
    /// No pin may live.
    ~CVirtualHeap();

    /// Makes the scratch files, one on each volume that takes one; with no list, one in the folder for temporary files.
    /// Only the first call counts. What needs files and finds none opened makes the first call, with no list.
    void Open();
    void Open(const std::vector<ScratchVolume> &volumes);
    bool IsOpen() const;

    /// A tile whose memory is of sizeClass and whose room on disk is of diskClass, both 0 to 15. Where the latter is
    /// smaller, bytes beyond it read as zeros once the tile has left memory. hint: how many the caller will want in
    /// all. Throws CError when there is no room left on disk. The tile is the heap's; its address stays.
    VirtualTile *AcquireTile(int sizeClass, int diskClass, std::uint64_t hint = 1);
    /// A tile that is not pinned. Its bytes are gone.
    void ReleaseTile(VirtualTile *tile) noexcept;

    /// Pages the tile in if need be and makes it the newest. Throws CError when a page cannot travel, std::bad_alloc
    /// when there is no memory even after pages were given up for it.
    CPagePin Pin(VirtualTile *tile, CPageAccess access);

    /// Brings a tile into memory, from where it may leave again at any time. Throws as Pin.
    void AttachMemory(VirtualTile *tile);
    /// Sends a tile out of memory, unless it is pinned. Throws as Pin.
    void DetachMemory(VirtualTile *tile);
    /// Makes a tile in memory the newest.
    void Touch(VirtualTile *tile) noexcept;

    /// Bytes of memory for blocks, free ones included. What is above a new limit is paged out and freed at once, pinned
    /// pages excepted. A page that is asked for gets memory even where the limit has no place for it.
    void SetLimit(std::uint64_t bytes);
    /// Makes room below the limit for an allocation elsewhere, and a little more: a sixteenth, 4 KiB to 64 KiB. Answers
    /// whether there is that much now. Nothing keeps later pages from taking it.
    bool Reserve(std::uint64_t bytes);

    /// The file of a tile's location, and the offset in it in units of 256 bytes.
    void FileAndOffset(DiskLocation location, CPageFile *&file, std::uint32_t &unit) const;

    bool InMemory(const VirtualTile *tile) const;
    std::uint64_t Limit() const;
    std::uint64_t TotalBytes() const; ///< memory of all blocks
    std::uint64_t FreeBytes() const;  ///< of those that belong to no tile

    void AddClient(CVirtualHeapClient *client);
    void RemoveClient(CVirtualHeapClient *client) noexcept;

private:
    friend class CPagePin;
    friend class CHeapPageStore;

    std::byte *Lock(VirtualTile &tile, CPageAccess access);
    void Unlock(VirtualTile &tile, bool changed) noexcept;

    void OpenWith(const std::vector<ScratchVolume> &volumes);
    void Attach(VirtualTile &tile, CPageAccess access);
    VirtualBlock *BlockFor(int sizeClass);
    VirtualBlock *MakeBlock(int sizeClass);
    void PageOut(std::uint64_t bytes);
    void ShrinkTo(std::uint64_t bytes);
    void Save(VirtualTile &tile);
    void Load(VirtualTile &tile);

    mutable std::mutex mutex;
    CTilePool tiles;
    CBlockPool blocks;
    std::uint64_t limit;
    bool opened = false;
    std::vector<CVirtualHeapClient *> clients;
};

} // namespace Sarnik
