#pragma once

#include "framework/base/link.h"
#include "framework/views/timer.h"
#include "platform/window/display.h"

#include <limits>
#include <memory>
#include <vector>

namespace Sarnik
{

class CMessenger;
class CWindow;

/// The message loop over one display, and the windows that are open on it. At most one is current: the one built last.
/// Exceptions of the CException family that handlers let out of a message go to the reporter, and the loop goes on.
/// Interface thread.
class CApplication
{
public:
    /// The display is the caller's, and outlives it.
    explicit CApplication(Platform::display &on);
    /// Windows that are still open are closed.
    ~CApplication();
    CApplication(const CApplication &) = delete;
    CApplication &operator=(const CApplication &) = delete;

    static CApplication *Current() noexcept;
    /// The current display's time, or the machine's own; seconds.
    static double Now();

    Platform::display &Display() const { return display; }

    /// One turn of the loop: what was posted, timers that are due, and then one event; where there is none, painting;
    /// where nothing is to be painted, idlers; where they have nothing to do, waiting, at most so long. Throws CError
    /// where the display is lost. A turn in which timers or idlers have worked does not wait, as they may have ended
    /// what the turns are made for. Whether anything happened.
    bool ProcessOne(double mostWait = std::numeric_limits<double>::infinity());
    /// Turns until no event is left, nothing is marked and no idler wants more.
    void ProcessAll();
    bool PaintAll();

    /// The window with the keyboard; null for none.
    CWindow *Active() const { return active; }
    /// The innermost modal window; null for none.
    CWindow *Modal() const { return modal.empty() ? nullptr : modal.back(); }
    /// Whether no modal window keeps input from this one.
    bool TakesInput(const CWindow &window) const;

    /// A popup gets every key and sees every press outside of it as a dismissal, in the reverse order of their opening.
    /// It leaves with its closing.
    void PushPopup(CWindow &window) { popups.push_back(&window); }
    /// All of them, or those that a window owns, through other windows too.
    void DismissPopups(const CWindow *of = nullptr);

    /// Notices whether a window was deleted meanwhile.
    class witness
    {
    public:
        explicit witness(const CWindow &seen);
        ~witness();
        witness(const witness &) = delete;
        witness &operator=(const witness &) = delete;
        explicit operator bool() const { return window != nullptr; }

    private:
        friend class CApplication;
        const CWindow *window;
        witness *outer;
    };

private:
    friend class CWindow;
    void Opened(CWindow &window);
    void Closed(CWindow &window);
    static void Gone(const CWindow &window) noexcept;
    /// Throws CError where the display is lost.
    void CheckDisplay() const;

    void Handle(const Platform::event &e);
    void HandleKey(const Platform::event &e);
    void HandleText(const Platform::event &e);
    void HandleFocus(CWindow &window, bool gained);
    void HandlePopupFocus(CWindow &popup, bool gained);
    void KeyboardLost();
    void SetActive(CWindow &window, bool isActive);
    bool CloseLate();
    bool IsPopup(const CWindow &window) const;
    CWindow *WindowOf(Platform::windowId id) const;
    CWindow *PressHolder() const;
    CWindow *KeyboardWindow(CWindow *from) const;
    /// Whether it came to its end.
    template <class Action> bool Guarded(Action action);

    Platform::display &display;
    CApplication *previous;
    CLinkList<CWindow> windows;
    std::vector<CWindow *> modal, popups;
    std::vector<std::unique_ptr<CWindow>> leaving; ///< closed, and to be deleted by the loop
    std::vector<Platform::event> closing;          ///< windows to be closed after a tracker
    CWindow *active = nullptr;
    CWindow *keyboardPopup = nullptr; ///< a popup that the keyboard was given to
    CTimer losing;                    ///< the keyboard has left a window, perhaps for its popup
    bool swallowText = false;         ///< the key that writes it was used for something else
    bool settled = false;             ///< the last turn has found nothing to do
    int depth = 0;                    ///< of loops within handlers
};

} // namespace Sarnik
