#include "store/traces/ctrlThread.h"

#include <condition_variable>
#include <mutex>
#include <utility>
#include <vector>

namespace Project
{

struct PCtrlThread::sharedState
{
    struct job
    {
        std::function<void()> task;
        bool begun = false;
    };

    void Run(const std::shared_ptr<job> &what)
    {
        {
            const std::lock_guard hold(lock);
            if (!what->task)
                return; // withdrawn
            what->begun = true;
        }
        std::exception_ptr failure;
        try
        {
            what->task();
        }
        catch (...)
        {
            failure = std::current_exception();
        }
        what->task = nullptr;

        const std::lock_guard hold(lock);
        std::erase(jobs, what);
        if (failure && !error)
            error = failure;
        ended.notify_all();
    }

    mutable std::mutex lock; ///< guards all that follows, a task only until it has begun
    mutable std::condition_variable ended;
    std::vector<std::shared_ptr<job>> jobs; ///< queued or running
    std::exception_ptr error;
};

PCtrlThread::PCtrlThread(PTaskPool &taskPool) : pool(taskPool), state(std::make_shared<sharedState>())
{
}

PCtrlThread::~PCtrlThread()
{
    Withdraw();
    Wait();
}

void PCtrlThread::Queue(std::function<void()> task)
{
    const auto job = std::make_shared<sharedState::job>();
    job->task = std::move(task);
    {
        const std::lock_guard hold(state->lock);
        state->jobs.push_back(job);
    }
    try
    {
        pool.Enqueue([shared = state, job] { shared->Run(job); });
    }
    catch (...)
    {
        const std::lock_guard hold(state->lock);
        std::erase(state->jobs, job);
        throw;
    }
}

int PCtrlThread::Running() const
{
    const std::lock_guard hold(state->lock);
    return static_cast<int>(state->jobs.size());
}

void PCtrlThread::Withdraw()
{
    std::vector<std::function<void()>> dropped; // destroyed without the lock
    const std::lock_guard hold(state->lock);
    std::erase_if(state->jobs, [&](const std::shared_ptr<sharedState::job> &job) {
        if (!job->begun)
            dropped.push_back(std::exchange(job->task, nullptr));
        return !job->begun;
    });
    state->ended.notify_all();
}

void PCtrlThread::Wait() const
{
    std::unique_lock hold(state->lock);
    state->ended.wait(hold, [this] { return state->jobs.empty(); });
}

bool PCtrlThread::WaitFor(std::chrono::milliseconds time) const
{
    std::unique_lock hold(state->lock);
    return state->ended.wait_for(hold, time, [this] { return state->jobs.empty(); });
}

std::exception_ptr PCtrlThread::TakeError()
{
    const std::lock_guard hold(state->lock);
    return std::exchange(state->error, nullptr);
}

} // namespace Project
