#include "shell/virtualHeap.h"

#include "framework/base/exceptions.h"
#include "platform/physicalMemory.h"

#include <algorithm>
#include <cassert>
#include <cstring>

namespace Sarnik
{

namespace
{

/// The limit starts at this much at least, and failures of the allocator lower it no further once memory is down here.
constexpr std::uint64_t smallestLimit = std::uint64_t{16} << 20;

/// How much of a tile is kept on disk.
std::size_t keptBytes(const VirtualTile &tile)
{
    return tileBytes(std::min(tile.MemoryClass(), tile.DiskClass()));
}

} // namespace

CVirtualHeap::CVirtualHeap() : limit(std::max(Platform::physicalMemory() / 2, smallestLimit))
{
}

CVirtualHeap::~CVirtualHeap()
{
    for (CVirtualHeapClient *client : clients)
        client->HeapGone();
#ifndef NDEBUG
    for (const VirtualBlock *block = blocks.Oldest(); block; block = block->newer)
        assert(block->locks == 0);
#endif
}

void CVirtualHeap::Open()
{
    Open({ScratchVolume{Platform::scratchFile::defaultFolder()}});
}

void CVirtualHeap::Open(const std::vector<ScratchVolume> &volumes)
{
    const std::lock_guard hold(mutex);
    OpenWith(volumes);
}

void CVirtualHeap::OpenWith(const std::vector<ScratchVolume> &volumes)
{
    if (!opened)
        tiles.Open(volumes);
    opened = true;
}

bool CVirtualHeap::IsOpen() const
{
    const std::lock_guard hold(mutex);
    return opened;
}

VirtualTile *CVirtualHeap::AcquireTile(int sizeClass, int diskClass, std::uint64_t hint)
{
    assert(sizeClass >= 0 && sizeClass < tileClassCount && diskClass >= 0 && diskClass < tileClassCount);
    const std::lock_guard hold(mutex);
    OpenWith({ScratchVolume{Platform::scratchFile::defaultFolder()}});
    VirtualTile *tile = tiles.Take(diskClass, hint);
    if (!tile)
        throw CError("$$$/Sarnik/VirtualHeap/AcquireTileError=No more virtual tiles can be allocated.");
    tile->SetClasses(sizeClass, diskClass);
    tile->flags = diskClass < sizeClass ? tileInUse | tileSmallerDisk : tileInUse;
    return tile;
}

void CVirtualHeap::ReleaseTile(VirtualTile *tile) noexcept
{
    const std::lock_guard hold(mutex);
    assert(tile->Has(tileInUse) && (!tile->block || tile->block->locks == 0));
    if (tile->block)
        blocks.TakeBack(tile->block);
    tile->flags = 0;
    tiles.GiveBack(tile);
}

CPagePin CVirtualHeap::Pin(VirtualTile *tile, CPageAccess access)
{
    return CPagePin(*this, *tile, access);
}

std::byte *CVirtualHeap::Lock(VirtualTile &tile, CPageAccess access)
{
    const std::lock_guard hold(mutex);
    Attach(tile, access);
    blocks.Touch(tile.block);
    ++tile.block->locks;
    if (access != CPageAccess::read)
        tile.flags |= tileChanged;
    return tile.block->data;
}

void CVirtualHeap::Unlock(VirtualTile &tile, bool changed) noexcept
{
    const std::lock_guard hold(mutex);
    assert(tile.block && tile.block->locks > 0);
    --tile.block->locks;
    if (changed)
        tile.flags |= tileChanged;
}

void CVirtualHeap::AttachMemory(VirtualTile *tile)
{
    const std::lock_guard hold(mutex);
    Attach(*tile, CPageAccess::read);
}

void CVirtualHeap::DetachMemory(VirtualTile *tile)
{
    const std::lock_guard hold(mutex);
    if (!tile->block || tile->block->locks > 0)
        return;
    Save(*tile);
    blocks.TakeBack(tile->block);
}

void CVirtualHeap::Touch(VirtualTile *tile) noexcept
{
    const std::lock_guard hold(mutex);
    if (tile->block)
        blocks.Touch(tile->block);
}

void CVirtualHeap::SetLimit(std::uint64_t bytes)
{
    const std::lock_guard hold(mutex);
    limit = bytes;
    ShrinkTo(limit);
}

bool CVirtualHeap::Reserve(std::uint64_t bytes)
{
    const std::lock_guard hold(mutex);
    const std::uint64_t margin = std::clamp<std::uint64_t>(bytes / 16, 4096, 65536);
    const bool fits = bytes <= limit && margin <= limit - bytes;
    const std::uint64_t rest = fits ? limit - bytes - margin : 0;
    ShrinkTo(rest);
    return fits && blocks.TotalBytes() <= rest;
}

void CVirtualHeap::FileAndOffset(DiskLocation location, CPageFile *&file, std::uint32_t &unit) const
{
    const std::lock_guard hold(mutex);
    file = &tiles.FileAndOffset(location, unit);
}

bool CVirtualHeap::InMemory(const VirtualTile *tile) const
{
    const std::lock_guard hold(mutex);
    return tile->block != nullptr;
}

std::uint64_t CVirtualHeap::Limit() const
{
    const std::lock_guard hold(mutex);
    return limit;
}

std::uint64_t CVirtualHeap::TotalBytes() const
{
    const std::lock_guard hold(mutex);
    return blocks.TotalBytes();
}

std::uint64_t CVirtualHeap::FreeBytes() const
{
    const std::lock_guard hold(mutex);
    return blocks.FreeBytes();
}

void CVirtualHeap::AddClient(CVirtualHeapClient *client)
{
    const std::lock_guard hold(mutex);
    clients.push_back(client);
}

void CVirtualHeap::RemoveClient(CVirtualHeapClient *client) noexcept
{
    const std::lock_guard hold(mutex);
    std::erase(clients, client);
}

void CVirtualHeap::Attach(VirtualTile &tile, CPageAccess access)
{
    assert(tile.Has(tileInUse));
    if (tile.block)
        return;
    VirtualBlock *block = BlockFor(tile.MemoryClass());
    blocks.Give(block, &tile);
    if (access == CPageAccess::overwrite)
        return;
    try
    {
        Load(tile);
    }
    catch (...)
    {
        blocks.TakeBack(block);
        throw;
    }
}

/// A block that belongs to nobody: a free one, one that a tile gives up, or a new one in the room that is left or made.
VirtualBlock *CVirtualHeap::BlockFor(int sizeClass)
{
    if (VirtualBlock *block = blocks.TakeFree(sizeClass))
        return block;
    const std::uint64_t size = tileBytes(sizeClass);
    const std::uint64_t room = limit - std::min(limit, blocks.TotalBytes());
    const std::uint64_t available = blocks.FreeBytes() + room;
    if (size > available)
    {
        PageOut(size - available);
        if (VirtualBlock *block = blocks.TakeFree(sizeClass))
            return block;
    }
    if (size > room)
        blocks.FreeMemory(size - room);
    return MakeBlock(sizeClass);
}

/// The limit was more than there is: when memory runs out it is given back and asked for once more, and the limit comes
/// down a little so that this does not happen with every page.
VirtualBlock *CVirtualHeap::MakeBlock(int sizeClass)
{
    try
    {
        return blocks.Make(sizeClass);
    }
    catch (...)
    {
        ShrinkTo(blocks.TotalBytes() - std::min<std::uint64_t>(blocks.TotalBytes(), tileBytes(sizeClass)));
        if (blocks.TotalBytes() > smallestLimit)
            limit -= std::min(limit, blocks.TotalBytes() / 20);
    }
    return blocks.Make(sizeClass);
}

/// Takes the memory of the tiles used longest ago, pinned ones passed over, until there are that many bytes more on the
/// free lists.
void CVirtualHeap::PageOut(std::uint64_t bytes)
{
    std::uint64_t done = 0;
    for (VirtualBlock *block = blocks.Oldest(); block && done < bytes;)
    {
        VirtualBlock *const next = block->newer;
        if (block->locks == 0)
        {
            Save(*block->owner);
            blocks.TakeBack(block);
            done += block->Size();
        }
        block = next;
    }
}

void CVirtualHeap::ShrinkTo(std::uint64_t bytes)
{
    if (blocks.TotalBytes() <= bytes)
        return;
    const std::uint64_t excess = blocks.TotalBytes() - bytes;
    if (excess > blocks.FreeBytes())
        PageOut(excess - blocks.FreeBytes());
    blocks.FreeMemory(excess);
}

void CVirtualHeap::Save(VirtualTile &tile)
{
    if (!tile.Has(tileChanged))
        return;
    try
    {
        std::uint32_t unit = 0;
        tiles.FileAndOffset(tile.location, unit).Write(unit, tile.block->data, keptBytes(tile));
    }
    catch (const Platform::fileError &error)
    {
        throw CError(error.what());
    }
    tile.flags = static_cast<std::uint8_t>((tile.flags | tileOnDisk) & ~tileChanged);
}

void CVirtualHeap::Load(VirtualTile &tile)
{
    const std::size_t kept = tile.Has(tileOnDisk) ? keptBytes(tile) : 0;
    try
    {
        std::uint32_t unit = 0;
        if (kept > 0)
            tiles.FileAndOffset(tile.location, unit).Read(unit, tile.block->data, kept);
    }
    catch (const Platform::fileError &error)
    {
        throw CError(error.what());
    }
    std::memset(tile.block->data + kept, 0, tile.block->Size() - kept);
}

} // namespace Sarnik
