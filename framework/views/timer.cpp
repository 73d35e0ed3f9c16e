#include "framework/views/timer.h"

#include "framework/views/application.h"

#include <algorithm>
#include <limits>

namespace Sarnik
{
namespace
{

CLinkList<CTimer> timers;
unsigned long passes = 0;

} // namespace

void CTimer::Start()
{
    last = CApplication::Now();
    // In the middle of a pass it waits for the next.
    pass = passes;
    if (IsRunning())
        return;
    flags |= running;
    timers.PushTail(*this);
}

void CTimer::Stop()
{
    if (!IsRunning())
        return;
    flags &= ~running;
    timers.Unlink(*this);
}

void CTimer::FireDue(double now)
{
    // The list may become another one with every call, and a loop within a call makes passes of its own: after each
    // call the search starts at the front, for those that this pass and later ones have not seen.
    const unsigned long thisPass = ++passes;
    const auto next = [&]() -> CTimer * {
        for (CTimer *t = timers.Head(); t != nullptr; t = t->Next())
            if (t->pass < thisPass && t->Due() <= now)
                return t;
        return nullptr;
    };
    while (CTimer *const due = next())
    {
        due->pass = thisPass;
        due->last = now;
        due->call(due->argument);
    }
}

double CTimer::NextDue()
{
    double due = std::numeric_limits<double>::infinity();
    for (const CTimer *t = timers.Head(); t != nullptr; t = t->Next())
        due = std::min(due, t->Due());
    return due;
}

} // namespace Sarnik
