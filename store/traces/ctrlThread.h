#pragma once

#include "store/traces/taskPool.h"

#include <chrono>
#include <exception>
#include <functional>
#include <memory>

namespace Project
{

/// Counts the tasks that somebody has under way on the pool, and waits for them. What a task wrote may be read once the
/// count has been seen at 0. One owner at a time calls the operations; tasks end on any thread.
class PCtrlThread
{
public:
    explicit PCtrlThread(PTaskPool &taskPool);
    PCtrlThread(const PCtrlThread &) = delete;
    PCtrlThread &operator=(const PCtrlThread &) = delete;
    /// Withdraws and waits.
    ~PCtrlThread();

    /// Raises the count and queues the task; the count falls when the task has ended, and nothing of it is held then.
    void Queue(std::function<void()> task);
    /// Tasks queued or running.
    int Running() const;
    /// Takes back the tasks that no thread has begun, so that nobody waits for a free worker in order to stop.
    void Withdraw();
    void Wait() const;
    /// False when the time is over and tasks are still under way.
    bool WaitFor(std::chrono::milliseconds time) const;
    /// What the first failing task since the last call threw; null if none did.
    std::exception_ptr TakeError();

private:
    struct sharedState;
    PTaskPool &pool;
    const std::shared_ptr<sharedState> state; ///< shared with the closures in the pool, which may outlive this object
};

} // namespace Project
