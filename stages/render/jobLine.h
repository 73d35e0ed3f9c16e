#pragma once

#include <tbb/task_group.h>

#include <condition_variable>
#include <cstddef>
#include <deque>
#include <exception>
#include <memory>
#include <mutex>

namespace Project
{

/// A piece of work that needs nothing but itself.
class PLineJob
{
public:
    virtual ~PLineJob() = default;
    virtual void Run() = 0; ///< on any thread, once
};

/// Jobs are put in at one end, done on all threads of the current tbb arena in any order, and come out at the other end
/// in the order they were put in. One thread, the same all the time, puts them in and takes them out; while it waits
/// for a job it does one itself.
class PJobLine
{
public:
    /// capacity: jobs in the line at most, those that wait, those under way and those done together.
    explicit PJobLine(std::size_t capacity);
    PJobLine(const PJobLine &) = delete;
    PJobLine &operator=(const PJobLine &) = delete;
    /// Drops what has not begun and waits for what has.
    ~PJobLine();

    bool Full() const { return line.size() >= capacity; }
    bool Empty() const { return line.empty(); }
    /// Null is a job that is done already. Only while the line is not full.
    void Add(std::unique_ptr<PLineJob> job);
    /// The oldest job, done; throws what it threw. Only while the line is not empty. Call it when the line is full or
    /// when there is no more to add.
    std::unique_ptr<PLineJob> Take();

private:
    struct place
    {
        std::unique_ptr<PLineJob> job;
        std::exception_ptr error;
        bool done = false;
    };

    bool DoOne();
    bool HeadDone();

    const std::size_t capacity;
    std::deque<std::unique_ptr<place>> line; ///< of the owning thread, but for what the places hold
    std::mutex lock;                         ///< guards waiting and the places' `done`
    std::condition_variable oneDone;
    std::deque<place *> waiting; ///< not begun, oldest first
    tbb::task_group group;
};

} // namespace Project
