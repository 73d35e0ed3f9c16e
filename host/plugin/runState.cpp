#include "host/plugin/runState.h"

#include "platform/error.h"

#include <algorithm>
#include <new>
#include <stdexcept>

namespace Stillmark
{

runState::runState(faultScript *script) : faults(script)
{
    if (faults)
        faults->restart();
}

hostLie runState::lie(hostCall call, std::string_view name)
{
    const std::lock_guard guard(lock);
    return faults ? faults->next(call, name) : hostLie{};
}

void runState::misuse(const std::string &sentence) noexcept
try
{
    const std::lock_guard guard(lock);
    if (notes.size() < mostNotes && std::find(notes.begin(), notes.end(), sentence) == notes.end())
        notes.push_back(sentence);
}
catch (...)
{
    // A note that finds no memory is left out.
}

bool runState::failed() const
{
    const std::lock_guard guard(lock);
    return cause != nullptr;
}

void runState::rethrow(bool runFailed) const
{
    const std::lock_guard guard(lock);
    if (cause)
        std::rethrow_exception(cause);
    if (shortage && runFailed)
        std::rethrow_exception(shortage);
}

bool runState::onMainThread(const char *function) noexcept
try
{
    if (std::this_thread::get_id() == mainThread)
        return true;
    misuse(std::string(function) + " was called on another thread than the run's");
    return false;
}
catch (...)
{
    return false;
}

TNError runState::keep() noexcept
{
    const std::lock_guard guard(lock);
    const auto first = [](std::exception_ptr &slot) {
        if (!slot)
            slot = std::current_exception();
    };
    try
    {
        throw;
    }
    catch (const std::bad_alloc &)
    {
        first(shortage);
        return TNErrMemoryFull;
    }
    catch (const std::length_error &) // a container beyond its largest size
    {
        first(shortage);
        return TNErrMemoryFull;
    }
    catch (const Platform::cancelled &)
    {
        first(cause);
        return TNErrUserCanceled;
    }
    catch (const Platform::fileError &)
    {
        first(cause);
        return TNErrInputOutput;
    }
    catch (...)
    {
        first(cause);
        return TNErrParameter;
    }
}

} // namespace Stillmark
