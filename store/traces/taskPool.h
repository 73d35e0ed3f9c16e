#pragma once

#include <condition_variable>
#include <functional>
#include <memory>
#include <mutex>

namespace Project
{

/// Worker threads for long tasks that run beside the main thread. Tasks begin in the order in which they come, as many
/// at once as there are workers, and at least one makes progress on a machine of a single processor while the main
/// thread does nothing but look whether it has ended.
class PTaskPool
{
public:
    PTaskPool();
    PTaskPool(const PTaskPool &) = delete;
    PTaskPool &operator=(const PTaskPool &) = delete;
    /// Waits until everything that was handed in has been worked off.
    ~PTaskPool();

    /// Any thread. The task throws nothing.
    void Enqueue(std::function<void()> task);

private:
    struct arenaOf; ///< keeps the library's header out of this one
    const std::unique_ptr<arenaOf> arena;
    std::mutex lock; ///< guards outstanding
    std::condition_variable idle;
    int outstanding = 0;
};

} // namespace Project
