#include "shell/tilePool.h"

#include <algorithm>
#include <cassert>

namespace Sarnik
{

namespace
{

/// Tiles below this class are cut in bulk, as many as fill one of this class.
constexpr int bulkClass = 8;
/// Tiles are made in pieces of at most this many, however many a caller announces.
constexpr std::uint64_t chunkTiles = 65536;

} // namespace

void CTilePool::Open(const std::vector<ScratchVolume> &volumes)
{
    for (const ScratchVolume &volume : volumes)
    {
        if (files.size() == locationFiles)
            break;
        try
        {
            files.push_back(std::make_unique<CPageFile>(volume));
        }
        catch (const Platform::fileError &)
        {
            // Another volume may do; with none the first tile is refused.
        }
    }
}

VirtualTile *CTilePool::Take(int diskClass, std::uint64_t hint)
{
    freeList &list = freeTiles[static_cast<std::size_t>(diskClass)];
    if (!list.head)
    {
        const std::uint64_t bulk = diskClass < bulkClass ? std::uint64_t{1} << (bulkClass - diskClass) : 1;
        CutTiles(diskClass, std::max(hint, bulk));
    }
    VirtualTile *tile = list.head;
    if (tile)
    {
        list.head = tile->next;
        if (!list.head)
            list.tail = nullptr;
        --list.count;
        tile->next = nullptr;
    }
    return tile;
}

void CTilePool::GiveBack(VirtualTile *tile) noexcept
{
    freeList &list = freeTiles[static_cast<std::size_t>(tile->DiskClass())];
    tile->next = nullptr;
    (list.tail ? list.tail->next : list.head) = tile;
    list.tail = tile;
    ++list.count;
}

void CTilePool::CutTiles(int diskClass, std::uint64_t count)
{
    for (std::size_t file = 0; file < files.size(); ++file)
        while (count > 0)
        {
            // The tiles first: if there is no memory for them, no room in the file is lost.
            const std::uint64_t wanted = std::min(count, chunkTiles);
            auto chunk = std::make_unique<VirtualTile[]>(wanted);
            chunks.reserve(chunks.size() + 1);

            std::uint32_t unit = 0;
            const std::uint64_t got = files[file]->Cut(diskClass, wanted, unit);
            for (std::uint64_t i = 0; i < got; ++i)
            {
                const std::uint64_t at = unit + i * (tileBytes(diskClass) / locationUnitBytes);
                chunk[i].location = static_cast<DiskLocation>(file << locationUnitBits | at);
                chunk[i].SetClasses(diskClass, diskClass);
                GiveBack(&chunk[i]);
            }
            if (got > 0)
                chunks.push_back(std::move(chunk));
            count -= got;
            if (got < wanted)
                break;
        }
}

CPageFile &CTilePool::FileAndOffset(DiskLocation location, std::uint32_t &unit) const
{
    unit = location % locationUnits;
    assert(location / locationUnits < files.size());
    return *files[location / locationUnits];
}

} // namespace Sarnik
