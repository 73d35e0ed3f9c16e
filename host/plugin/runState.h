#pragma once

#include "host/plugin/faultScript.h"
#include "shell/tintorel.h"

#include <exception>
#include <mutex>
#include <string>
#include <string_view>
#include <thread>
#include <vector>

namespace Stillmark
{

/// What the tables of one run share: the scripted faults, the exceptions that may not cross the interface, and notes of
/// what the plug-in did wrong. Belongs to the thread that makes it; any thread may call its functions.
class runState
{
public:
    static constexpr std::size_t mostNotes = 50;

    explicit runState(faultScript *script);

    hostLie lie(hostCall call, std::string_view name = {});
    void misuse(const std::string &sentence) noexcept;
    const std::vector<std::string> &misuses() const { return notes; }

    /// Whether the host has failed by itself: the run is to end soon.
    bool failed() const;
    /// Throws what the host's own functions threw first: always where more than memory was lacking, after a shortage
    /// of memory only where the run failed.
    void rethrow(bool runFailed) const;

    /// Does a callback's work. An exception is kept and becomes an error code; a call on a wrong thread is noted and
    /// refused.
    template <class Work> TNError code(const char *function, Work &&work) noexcept
    {
        return onMainThread(function) ? codeAnywhere(work) : TNError{TNErrParameter};
    }
    /// The same for the functions that any thread may call.
    template <class Work> TNError codeAnywhere(Work &&work) noexcept
    {
        try
        {
            return work();
        }
        catch (...)
        {
            return keep();
        }
    }
    /// The same for functions that have no error code: `otherwise` stands for a failure.
    template <class Value, class Work> Value value(const char *function, Value otherwise, Work &&work) noexcept
    {
        Value result = otherwise;
        code(function, [&] {
            result = work();
            return TNNoError;
        });
        return result;
    }

private:
    bool onMainThread(const char *function) noexcept;
    TNError keep() noexcept; ///< the exception that is being handled

    const std::thread::id mainThread = std::this_thread::get_id();
    mutable std::mutex lock; ///< of all below
    faultScript *faults;
    std::exception_ptr cause, shortage;
    std::vector<std::string> notes;
};

} // namespace Stillmark
