#pragma once

#include "framework/pixels/tileShape.h"
#include "shell/virtualAllocator.h"

#include <cstddef>
#include <cstdint>
#include <memory>

namespace Sarnik
{

struct VirtualBlock;

/// Where a tile lies on disk: the top 4 bits are the number of the scratch file, the low 28 bits count units of 256
/// bytes from its start. So there are 16 files at most, of 64 GiB each.
using DiskLocation = std::uint32_t;

constexpr int locationUnitBits = 28;
constexpr std::uint64_t locationUnitBytes = 256;
constexpr std::uint32_t locationUnits = std::uint32_t{1} << locationUnitBits;
constexpr std::size_t locationFiles = 16;

enum VirtualTileFlags : std::uint8_t
{
    tileInUse = 1,
    tileOnDisk = 2,     ///< the disk holds its bytes, if perhaps not the newest
    tileChanged = 4,    ///< its memory is newer than the disk
    tileSmallerDisk = 8 ///< its room on disk is smaller than its memory: the bytes behind that are not kept
};

/// A piece of paged storage: room on disk always, memory while it is wanted or while there is enough.
struct VirtualTile
{
    VirtualTile *next = nullptr;   ///< link while free
    VirtualBlock *block = nullptr; ///< null while the tile has no memory
    DiskLocation location = 0;
    std::uint8_t flags = 0;
    std::uint8_t classes = 0; ///< low nibble: of the memory; high nibble: of the room on disk

    int MemoryClass() const { return classes & 15; }
    int DiskClass() const { return classes >> 4; }
    void SetClasses(int memory, int disk) { classes = static_cast<std::uint8_t>(disk << 4 | memory); }
    bool Has(std::uint8_t flag) const { return (flags & flag) != 0; }
};

/// The memory of a tile, or memory kept for the next one.
struct VirtualBlock
{
    VirtualBlock *newer = nullptr; ///< in the recency list; the link of a free list
    VirtualBlock *older = nullptr;
    VirtualTile *owner = nullptr; ///< null while free
    std::byte *data = nullptr;
    std::shared_ptr<CVirtualAllocator> source; ///< null: the memory is the process's own
    std::uint32_t locks = 0;                   ///< above 0: may not lose its memory
    std::uint8_t sizeClass = 0;

    bool fromSystem() const { return !source; }
    std::size_t Size() const { return tileBytes(sizeClass); }
};

} // namespace Sarnik
