#include "shell/blockPool.h"

#include <cassert>
#include <new>

namespace Sarnik
{

namespace
{

/// A cache line, and enough for any vector load.
constexpr std::align_val_t blockAlignment{64};

} // namespace

CBlockPool::~CBlockPool()
{
    while (oldest)
        TakeBack(oldest);
    FreeMemory(freeBytes);
}

VirtualBlock *CBlockPool::Make(int sizeClass)
{
    auto block = std::make_unique<VirtualBlock>();
    block->sizeClass = static_cast<std::uint8_t>(sizeClass);
    if (const auto &allocator = CVirtualAllocator::Current())
    {
        block->data = static_cast<std::byte *>(allocator->Allocate(block->Size()));
        if (block->data)
            block->source = allocator;
    }
    if (!block->data)
        block->data = static_cast<std::byte *>(::operator new(block->Size(), blockAlignment));
    totalBytes += block->Size();
    return block.release();
}

void CBlockPool::Destroy(VirtualBlock *block) noexcept
{
    totalBytes -= block->Size();
    if (block->fromSystem())
        ::operator delete(block->data, blockAlignment);
    else
        block->source->Free(block->data);
    delete block;
}

VirtualBlock *CBlockPool::TakeFree(int sizeClass) noexcept
{
    VirtualBlock *&list = freeBlocks[static_cast<std::size_t>(sizeClass)];
    VirtualBlock *block = list;
    if (block)
    {
        list = block->newer;
        block->newer = nullptr;
        freeBytes -= block->Size();
    }
    return block;
}

void CBlockPool::FreeMemory(std::uint64_t bytes) noexcept
{
    std::uint64_t done = 0;
    for (int sizeClass = 0; sizeClass < tileClassCount; ++sizeClass)
        while (done < bytes)
        {
            VirtualBlock *block = TakeFree(sizeClass);
            if (!block)
                break;
            done += block->Size();
            Destroy(block);
        }
}

void CBlockPool::Give(VirtualBlock *block, VirtualTile *tile) noexcept
{
    assert(!block->owner && !tile->block);
    block->owner = tile;
    tile->block = block;
    LinkNewest(block);
}

void CBlockPool::TakeBack(VirtualBlock *block) noexcept
{
    Unlink(block);
    block->owner->block = nullptr;
    block->owner = nullptr;
    VirtualBlock *&list = freeBlocks[block->sizeClass];
    block->newer = list;
    list = block;
    freeBytes += block->Size();
}

void CBlockPool::Touch(VirtualBlock *block) noexcept
{
    if (block == newest)
        return;
    Unlink(block);
    LinkNewest(block);
}

void CBlockPool::LinkNewest(VirtualBlock *block) noexcept
{
    block->older = newest;
    block->newer = nullptr;
    (newest ? newest->newer : oldest) = block;
    newest = block;
}

void CBlockPool::Unlink(VirtualBlock *block) noexcept
{
    (block->older ? block->older->newer : oldest) = block->newer;
    (block->newer ? block->newer->older : newest) = block->older;
    block->older = block->newer = nullptr;
}

} // namespace Sarnik
