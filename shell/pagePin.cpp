#include "shell/pagePin.h"

#include "shell/virtualHeap.h"

namespace Sarnik
{

CPagePin::CPagePin(CVirtualHeap &owner, VirtualTile &page, CPageAccess wanted)
    : heap(&owner), tile(&page), memory(owner.Lock(page, wanted)), size(tileBytes(page.MemoryClass())), access(wanted)
{
}

void CPagePin::Release() noexcept
{
    if (heap)
        heap->Unlock(*tile, false); // marked as changed when it was locked
    heap = nullptr;
    tile = nullptr;
    memory = nullptr;
    size = 0;
}

} // namespace Sarnik
