#include "platform/math/sampleMemory.h"

#include <algorithm>
#include <map>
#include <mutex>
#include <new>
#include <thread>
#include <vector>

namespace CorvaneDeblur
{
namespace
{

constexpr std::align_val_t alignment{64};
constexpr std::size_t smallestKept = 64 * 1024; ///< below, the allocator's own lists serve as well

#if defined(__SANITIZE_ADDRESS__)
constexpr bool keepBlocks = false;
#else
constexpr bool keepBlocks = true;
#endif

class idleBlocks
{
public:
    void *take(std::size_t bytes)
    {
        const std::lock_guard guard(lock);
        const auto found = blocks.find(bytes);
        if (found == blocks.end())
            return nullptr;
        void *memory = found->second.back();
        found->second.pop_back();
        if (found->second.empty())
            blocks.erase(found);
        idle -= bytes;
        return memory;
    }

    /// False when the block should be freed.
    bool keep(void *memory, std::size_t bytes)
    {
        const std::lock_guard guard(lock);
        if (idle + bytes > idleSampleMemoryLimit())
            return false;
        blocks[bytes].push_back(memory);
        idle += bytes;
        return true;
    }

    void trim()
    {
        std::map<std::size_t, std::vector<void *>> released;
        {
            const std::lock_guard guard(lock);
            released.swap(blocks);
            idle = 0;
        }
        for (const auto &[bytes, list] : released)
            for (void *memory : list)
                ::operator delete(memory, alignment);
    }

    std::size_t count() const
    {
        const std::lock_guard guard(lock);
        return idle;
    }

    ~idleBlocks() { trim(); }

private:
    mutable std::mutex lock;
    std::map<std::size_t, std::vector<void *>> blocks; ///< by size in bytes
    std::size_t idle = 0;
};

idleBlocks &pool()
{
    // Never destroyed before the arrays of other static objects: it is made at the first of them.
    static idleBlocks blocks;
    return blocks;
}

bool kept(std::size_t bytes)
{
    return keepBlocks && bytes >= smallestKept;
}

} // namespace

void *takeSampleMemory(std::size_t bytes)
{
    if (kept(bytes))
        if (void *memory = pool().take(bytes))
            return memory;
    return ::operator new(bytes, alignment);
}

void returnSampleMemory(void *memory, std::size_t bytes) noexcept
{
    if (!memory)
        return;
    try
    {
        if (kept(bytes) && pool().keep(memory, bytes))
            return;
    }
    catch (const std::bad_alloc &)
    {
        // No room to remember the block: it is freed.
    }
    ::operator delete(memory, alignment);
}

void trimSampleMemory() noexcept
{
    pool().trim();
}

std::size_t idleSampleMemory() noexcept
{
    return pool().count();
}

std::size_t idleSampleMemoryLimit() noexcept
{
    static const std::size_t limit = std::size_t{32} * 1024 * 1024 * std::max(1u, std::thread::hardware_concurrency());
    return limit;
}

} // namespace CorvaneDeblur
