#include "store/traces/taskPool.h"

#include <tbb/task_arena.h>

#include <condition_variable>
#include <deque>
#include <mutex>
#include <thread>

namespace Project
{

/// Tasks wait in a queue of ours. For each of them the arena is asked to take one from there, and so is the thread of
/// our own: whoever comes first. An arena's worker that finds nothing left has nothing to do.
class PTaskPool::workers
{
public:
    workers() : threads(tbb::this_task_arena::max_concurrency()), arena(threads, 1) {}

    ~workers()
    {
        std::unique_lock hold(lock);
        ending = true;
        wake.notify_all();
        idle.wait(hold, [this] { return asked == 0 && running == 0 && queue.empty(); });
        hold.unlock();
        if (own.joinable())
            own.join();
    }

    int Threads() const { return threads; }

    void Enqueue(std::function<void()> task)
    {
        {
            const std::lock_guard hold(lock);
            if (!own.joinable())
                own = std::thread([this] { ServeAlone(); });
            queue.push_back(std::move(task));
            if (threads > 1)
                ++asked;
        }
        wake.notify_one();
        if (threads > 1)
            arena.enqueue([this] {
                std::unique_lock hold(lock);
                RunNext(hold);
                --asked;
                TellWhenIdle();
            });
    }

private:
    /// With the lock held before and after, and given up while the task runs.
    void RunNext(std::unique_lock<std::mutex> &hold)
    {
        if (queue.empty())
            return;
        std::function<void()> task = std::move(queue.front());
        queue.pop_front();
        ++running;
        hold.unlock();
        // Isolated: a thread that waits inside one task must not begin another on top of it.
        tbb::this_task_arena::isolate([&] { task(); });
        task = nullptr;
        hold.lock();
        --running;
        TellWhenIdle();
    }

    void TellWhenIdle()
    {
        if (asked == 0 && running == 0 && queue.empty())
            idle.notify_all();
    }

    void ServeAlone()
    {
        std::unique_lock hold(lock);
        while (true)
        {
            wake.wait(hold, [this] { return ending || !queue.empty(); });
            if (queue.empty())
                return;
            hold.unlock();
            arena.execute([this] {
                std::unique_lock inside(lock);
                RunNext(inside);
            });
            hold.lock();
        }
    }

    const int threads;
    tbb::task_arena arena; ///< its reserved place is for the thread of our own
    std::mutex lock;       ///< guards all that follows
    std::condition_variable wake, idle;
    std::deque<std::function<void()>> queue;
    std::thread own;
    int asked = 0;   ///< requests that the arena has not answered yet
    int running = 0; ///< tasks
    bool ending = false;
};

PTaskPool::PTaskPool() : pool(std::make_unique<workers>())
{
}

PTaskPool::~PTaskPool() = default;

int PTaskPool::Threads() const
{
    return pool->Threads();
}

void PTaskPool::Enqueue(std::function<void()> task)
{
    pool->Enqueue(std::move(task));
}

} // namespace Project
