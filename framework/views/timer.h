#pragma once

#include "framework/base/link.h"

namespace Sarnik
{

class CMessenger;

/// Calls a function again and again from the message loop, as long as it runs. Stops with its destructor. The callback
/// may start, stop and delete timers, this one included; a one-shot stops itself there.
class CTimer : public CLink<CTimer>
{
public:
    using callback = void (*)(void *argument);

    /// period in seconds; 0 or less (or no number) fires every time the loop comes by. The owner is for whoever asks.
    CTimer(double seconds, callback function, void *functionArgument, CMessenger *timerOwner = nullptr)
        : period(seconds), call(function), argument(functionArgument), owner(timerOwner)
    {
    }
    ~CTimer() { Stop(); }

    /// First fires one period from now; starts the period anew where it runs already.
    void Start();
    void Stop();
    bool IsRunning() const { return (flags & running) != 0; }
    double Period() const { return period; }
    /// Counts from the last firing.
    void SetPeriod(double seconds) { period = seconds; }
    CMessenger *Owner() const { return owner; }

    /// Fires each running timer whose period has passed, once.
    static void FireDue(double now);
    /// When the next one is due; infinity for never.
    static double NextDue();

private:
    static constexpr unsigned running = 1;
    double Due() const { return period > 0 ? last + period : last; }

    unsigned flags = 0;
    double period;
    callback call;
    void *argument;
    CMessenger *owner;
    double last = 0;
    unsigned long pass = 0;
};

} // namespace Sarnik
