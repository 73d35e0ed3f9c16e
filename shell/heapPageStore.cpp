#include "shell/heapPageStore.h"

#include "framework/base/exceptions.h"

namespace Sarnik
{

CHeapPageStore::CHeapPageStore(CVirtualHeap &owner) : heap(&owner)
{
    owner.AddClient(this);
}

CHeapPageStore::~CHeapPageStore()
{
    if (heap)
        heap->RemoveClient(this);
}

CVirtualHeap &CHeapPageStore::Heap() const
{
    if (!heap)
        throw CError("$$$/Sarnik/VirtualHeap/ClosedError=The virtual heap was closed while it was in use.");
    return *heap;
}

CPageStore::Page CHeapPageStore::AcquirePage(int sizeClass, std::size_t hint)
{
    return Heap().AcquireTile(sizeClass, sizeClass, hint);
}

void CHeapPageStore::ReleasePage(Page page) noexcept
{
    if (heap)
        heap->ReleaseTile(static_cast<VirtualTile *>(page));
}

std::byte *CHeapPageStore::LockPage(Page page, bool overwrite)
{
    return Heap().Lock(*static_cast<VirtualTile *>(page), overwrite ? CPageAccess::overwrite : CPageAccess::read);
}

void CHeapPageStore::UnlockPage(Page page, bool written) noexcept
{
    if (heap)
        heap->Unlock(*static_cast<VirtualTile *>(page), written);
}

} // namespace Sarnik
