#pragma once

#include <functional>
#include <memory>

namespace Project
{

/// Worker threads for long tasks that run beside the main thread: those of the process's thread pool, and one thread
/// of its own in place of the main thread, which only looks on. So as many tasks run at once as the process may use
/// threads, and there is progress on a machine of a single processor. Tasks begin in the order in which they come;
/// their parallel loops are shared among the same threads.
class PTaskPool
{
public:
    /// The number of threads is what the calling thread may use now.
    PTaskPool();
    PTaskPool(const PTaskPool &) = delete;
    PTaskPool &operator=(const PTaskPool &) = delete;
    /// Waits until everything that was handed in has been worked off.
    ~PTaskPool();

    /// Tasks that run at the same time, at least 1.
    int Threads() const;
    /// Any thread. The task throws nothing.
    void Enqueue(std::function<void()> task);

private:
    class workers; ///< keeps the library's header out of this one
    const std::unique_ptr<workers> pool;
};

} // namespace Project
