#include "framework/messages/notifications.h"

#include "framework/messages/messages.h"
#include "framework/messages/messenger.h"

#include <atomic>
#include <deque>
#include <mutex>

namespace Sarnik
{
namespace
{

struct posted
{
    CMessenger *to;
    std::unique_ptr<CMessage> message;
};

struct queue
{
    std::mutex mutex;
    std::deque<posted> waiting;
    void (*wake)(void *) = nullptr;
    void *argument = nullptr;
};

/// Messengers with static life may outlive any other static object: the queue is never destroyed.
queue &notifications()
{
    static queue &theQueue = *new queue;
    return theQueue;
}

/// How many wait: messengers come and go much more often than notifications.
std::atomic<std::size_t> count{0};

} // namespace

void CNotifications::Post(CMessenger &to, std::unique_ptr<CMessage> message)
{
    queue &q = notifications();
    const std::lock_guard lock(q.mutex);
    q.waiting.push_back({&to, std::move(message)});
    count = q.waiting.size();
    if (q.wake != nullptr)
        q.wake(q.argument);
}

bool CNotifications::Deliver()
{
    queue &q = notifications();
    bool any = false;
    for (std::size_t left = count; left > 0; --left)
    {
        posted next{};
        {
            const std::lock_guard lock(q.mutex);
            if (q.waiting.empty()) // forgotten, or delivered by a loop within a handler
                break;
            next = std::move(q.waiting.front());
            q.waiting.pop_front();
            count = q.waiting.size();
        }
        any = true;
        next.to->Dispatch(*next.message);
    }
    return any;
}

void CNotifications::Forget(const CMessenger &messenger) noexcept
{
    if (count == 0)
        return;
    queue &q = notifications();
    const std::lock_guard lock(q.mutex);
    std::erase_if(q.waiting, [&](const posted &p) { return p.to == &messenger; });
    count = q.waiting.size();
}

void CNotifications::SetWaker(void (*wake)(void *), void *argument)
{
    queue &q = notifications();
    const std::lock_guard lock(q.mutex);
    q.wake = wake;
    q.argument = argument;
}

} // namespace Sarnik
