#pragma once

#include "framework/pixels/pageStore.h"
#include "shell/virtualHeap.h"

namespace Sarnik
{

/// The virtual heap as pixmaps see it. It may outlive the heap: pages cannot be had any more then, and giving them back
/// does nothing.
class CHeapPageStore final : public CPageStore, private CVirtualHeapClient
{
public:
    explicit CHeapPageStore(CVirtualHeap &heap);
    CHeapPageStore(const CHeapPageStore &) = delete;
    CHeapPageStore &operator=(const CHeapPageStore &) = delete;
    ~CHeapPageStore();

    Page AcquirePage(int sizeClass, std::size_t hint) override;
    void ReleasePage(Page page) noexcept override;
    std::byte *LockPage(Page page, bool overwrite) override;
    void UnlockPage(Page page, bool written) noexcept override;

private:
    void HeapGone() noexcept override { heap = nullptr; }
    CVirtualHeap &Heap() const;

    CVirtualHeap *heap;
};

} // namespace Sarnik
