#pragma once

#include <cstddef>
#include <memory>

namespace Sarnik
{

/// Where the virtual heap asks for the memory of its blocks before it turns to the process's own. Called under the
/// heap's lock, so one thread at a time.
class CVirtualAllocator
{
public:
    virtual ~CVirtualAllocator() = default;

    /// size bytes, or null when there are none: the heap falls back on the process's memory. May throw.
    virtual void *Allocate(std::size_t size) = 0;
    virtual void Free(void *memory) noexcept = 0;

    /// The allocator for blocks made from now on. A block keeps the one that it came from, and with it that allocator,
    /// until it is freed. Main thread only.
    static void Install(std::shared_ptr<CVirtualAllocator> allocator);
    /// From now on blocks are made of the process's own memory.
    static void Clear() noexcept;
    /// Null when none is installed.
    static const std::shared_ptr<CVirtualAllocator> &Current() noexcept;
};

} // namespace Sarnik
