#pragma once

#include "framework/base/alerts.h"
#include "framework/messages/messenger.h"

#include <string>
#include <string_view>

namespace Sarnik
{

/// Something that runs until it is told to end.
class CExecutable : public virtual CMessenger
{
public:
    void End() noexcept { ended = true; }
    bool Ended() const noexcept { return ended; }

protected:
    /// It runs again.
    void Restart() noexcept { ended = false; }

private:
    bool ended = false;
};

/// The program as a whole, as far as users meet it. Main thread.
class CProcess : public CExecutable
{
public:
    /// The name that titles its alerts, to be localised.
    virtual std::string ProcessName() const = 0;

    /// An alert titled with the name. `text` is localised already.
    CAlertAnswer Alert(CAlertKind kind, std::string_view text) const;

    /// Remembers the calling thread as the main thread.
    static void StoreMainThread() noexcept;
    static bool IsMainThread() noexcept;
};

} // namespace Sarnik
