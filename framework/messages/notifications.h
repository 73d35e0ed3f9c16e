#pragma once

#include <memory>

namespace Sarnik
{

class CMessage;
class CMessenger;

/// Messages that wait for the message loop, in the order of their posting. One queue for the program.
class CNotifications
{
public:
    /// Any thread, while the messenger surely lives.
    static void Post(CMessenger &to, std::unique_ptr<CMessage> message);
    /// Delivers what has been posted so far; what handlers post waits for the next call. Interface thread. Whether
    /// there was any.
    static bool Deliver();
    /// A messenger goes: nothing that waits reaches it.
    static void Forget(const CMessenger &messenger) noexcept;
    /// Called after each Post, from its thread; to end a wait of the message loop. Null for none.
    static void SetWaker(void (*wake)(void *), void *argument);
};

} // namespace Sarnik
