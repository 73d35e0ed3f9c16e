#include "stages/render/jobLine.h"

#include <tbb/task_arena.h>

#include <cassert>
#include <utility>

namespace Project
{

PJobLine::PJobLine(std::size_t mostJobs) : capacity(mostJobs)
{
}

PJobLine::~PJobLine()
{
    {
        const std::lock_guard guard(lock);
        waiting.clear();
    }
    group.wait();
}

void PJobLine::Add(std::unique_ptr<PLineJob> job)
{
    assert(!Full());
    line.push_back(std::make_unique<place>());
    place &added = *line.back();
    if (!job)
    {
        added.done = true;
        return;
    }
    added.job = std::move(job);
    {
        const std::lock_guard guard(lock);
        waiting.push_back(&added);
    }
    // A task is a right to do one job, not this job: the oldest that waits is always next.
    group.run([this] { DoOne(); });
}

bool PJobLine::DoOne()
{
    place *mine = nullptr;
    {
        const std::lock_guard guard(lock);
        if (waiting.empty())
            return false;
        mine = waiting.front();
        waiting.pop_front();
    }
    std::exception_ptr error;
    try
    {
        // Isolated: while it waits for planes on other threads, this one must not start a second job.
        tbb::this_task_arena::isolate([mine] { mine->job->Run(); });
    }
    catch (...)
    {
        error = std::current_exception();
    }
    const std::lock_guard guard(lock);
    mine->error = error;
    mine->done = true;
    oneDone.notify_one();
    return true;
}

bool PJobLine::HeadDone()
{
    const std::lock_guard guard(lock);
    return line.front()->done;
}

std::unique_ptr<PLineJob> PJobLine::Take()
{
    assert(!Empty());
    const bool atTheEnd = !Full();
    while (!HeadDone())
    {
        if (DoOne())
            continue;
        // All are under way. At the end the other threads' planes are the only work that is left to share; before it,
        // the sooner the oldest job is out the sooner there is new work for everybody.
        if (atTheEnd)
            group.wait();
        std::unique_lock guard(lock);
        oneDone.wait(guard, [this] { return line.front()->done; });
    }
    const std::unique_ptr<place> head = std::move(line.front());
    line.pop_front();
    if (head->error)
        std::rethrow_exception(head->error);
    return std::move(head->job);
}

} // namespace Project
