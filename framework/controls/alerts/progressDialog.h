#pragma once

#include "framework/controls/dialog.h"

#include <cstdint>
#include <optional>
#include <string>

namespace Sarnik
{

class CProgressBar;
class CPushButton;

/// How far a long work on the interface thread has come, in a modal window with a Cancel button. Who works calls Show
/// again and again; what the user does in the meantime is handled there.
///
///     CProgressDialog progress(title, message);
///     progress.Begin(&window);
///     while (!progress.Cancelled() && done < total)
///         done += someWork(), progress.Show(done, total);
class CProgressDialog : public CDialog
{
public:
    /// Texts to be localised.
    CProgressDialog(const std::string &title, const std::string &message);

    /// Opens it, until Finish or its end. Throws CError where there is no display.
    void Begin(CWindow *over);
    void Finish() { session.reset(); }
    /// Throws CError where the display is lost.
    void Show(std::uint64_t done, std::uint64_t total);
    /// By the button, Escape or the window's closing.
    bool Cancelled() const { return cancelled; }

    bool ReceiveCommand(CCommandMessage &message) override;
    void CloseRequested() override { Cancel(); }

private:
    void Cancel();

    CProgressBar *bar;
    CPushButton *button;
    bool cancelled = false;
    std::optional<modalSession> session;
};

} // namespace Sarnik
