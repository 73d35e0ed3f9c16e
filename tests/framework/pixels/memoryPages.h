#pragma once

#include "framework/pixels/pageStore.h"

#include <algorithm>
#include <memory>
#include <new>
#include <vector>

namespace TestSupport
{

/// A page store that behaves as badly as one may: an unlocked page's memory goes away and comes back elsewhere, what
/// was not reported as written is lost, a page to be overwritten holds rubbish, and the Nth acquire or lock can be made
/// to fail.
class memoryPages final : public Sarnik::CPageStore
{
public:
    int failAcquireAt = -1, failLockAt = -1; ///< counted from 0

    int Live() const { return static_cast<int>(pages.size()); }
    int Locked() const
    {
        int sum = 0;
        for (const auto &p : pages)
            sum += p->locks;
        return sum;
    }

    Page AcquirePage(int sizeClass, std::size_t) override
    {
        if (acquires++ == failAcquireAt)
            throw std::bad_alloc();
        auto p = std::make_unique<page>();
        p->disk.assign(std::size_t{256} << sizeClass, std::byte{0});
        pages.push_back(std::move(p));
        return pages.back().get();
    }

    void ReleasePage(Page wanted) noexcept override
    {
        std::erase_if(pages, [&](const auto &p) { return p.get() == wanted; });
    }

    std::byte *LockPage(Page wanted, bool overwrite) override
    {
        if (lockCalls++ == failLockAt)
            throw std::bad_alloc();
        page &p = *static_cast<page *>(wanted);
        if (p.locks++ == 0)
            p.memory = std::make_unique<std::vector<std::byte>>(p.disk);
        if (overwrite)
            std::fill(p.memory->begin(), p.memory->end(), std::byte{0xA5});
        return p.memory->data();
    }

    void UnlockPage(Page wanted, bool written) noexcept override
    {
        page &p = *static_cast<page *>(wanted);
        p.written = p.written || written;
        if (--p.locks > 0)
            return;
        if (p.written)
            p.disk = *p.memory;
        p.memory.reset();
        p.written = false;
    }

private:
    struct page
    {
        std::vector<std::byte> disk;
        std::unique_ptr<std::vector<std::byte>> memory;
        int locks = 0;
        bool written = false;
    };
    std::vector<std::unique_ptr<page>> pages;
    int acquires = 0, lockCalls = 0;
};

} // namespace TestSupport
