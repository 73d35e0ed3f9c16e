#pragma once

#include "framework/messages/messages.h"
#include "framework/views/timer.h"

namespace Sarnik
{

/// The edit phases of a control whose value changes by keys, typing or the wheel: one begin, any number of edits, one
/// end. For a control to derive from. Every call may end with the control gone.
class CEditPhases
{
public:
    /// Seconds after the last notch of a wheel until the change counts as ended.
    static constexpr double rest = 0.4;

    CEditPhases() : timer(rest, Rested, this) {}
    virtual ~CEditPhases() = default;

    bool IsEditing() const { return open; }

protected:
    /// Nothing where a change is under way.
    void BeginEdit();
    /// After each change.
    void Edited() { SendPhase(kValue_Edit); }
    /// Nothing where no change is under way.
    void EndEdit();
    /// Unless something else happens first.
    void EndEditAfterRest() { timer.Start(); }

    /// Fine wheels turn by parts of a notch: how many whole ones have come together.
    double WholeNotches(double turned);

    virtual void SendPhase(EValuePhase phase) = 0;

private:
    static void Rested(void *phases);

    CTimer timer;
    double turnedSoFar = 0;
    bool open = false;
};

} // namespace Sarnik
