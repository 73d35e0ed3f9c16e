#pragma once

#include <cstddef>

namespace Sarnik
{

/// Where paged pixels live: pages of `256 << sizeClass` bytes that cost memory only while they are locked or while
/// there is room. The virtual heap fills it. One thread at a time.
class CPageStore
{
public:
    using Page = void *; ///< the store's own; null is no page

    /// A page that reads as zeros. `hint`: how many of this class the caller will want in all. Throws where scratch
    /// space is used up.
    virtual Page AcquirePage(int sizeClass, std::size_t hint) = 0;
    /// A page that is not locked.
    virtual void ReleasePage(Page page) noexcept = 0;
    /// Brings the page into memory and keeps it there until as many unlocks have come. Throws where memory or the
    /// scratch file fails; the page is not locked then. overwrite: every byte that is ever looked at will be written
    /// under this lock, so what the page held need not be brought back.
    virtual std::byte *LockPage(Page page, bool overwrite) = 0;
    /// written: the bytes were changed since the lock.
    virtual void UnlockPage(Page page, bool written) noexcept = 0;

protected:
    ~CPageStore() = default;
};

} // namespace Sarnik
