#pragma once

#include "framework/messages/messages.h"
#include "framework/views/mouseEvent.h"
#include "framework/views/port.h"

#include <cstdint>

namespace Sarnik
{

class CView;
class CWindow;

/// A drag: a loop of its own from a press to the release of the button, while timers, idlers and painting go on. Made
/// on the stack by the view's MouseDown. It ends aborted where somebody calls Abort, the view or its window goes, the
/// window is to be closed or loses the keyboard, or a modal window opens, before which it cannot return; where the
/// display is lost, Run throws after the end.
class CTracker
{
public:
    enum options : std::uint32_t
    {
        none = 0,
        confine = 1 ///< points stay within the view's bounds, less 1 at right and bottom
    };

    explicit CTracker(CView &inView, std::uint32_t trackerOptions = none);
    virtual ~CTracker();
    CTracker(const CTracker &) = delete;
    CTracker &operator=(const CTracker &) = delete;

    /// Whether it ran to an end that was not aborted. Only one runs at a time: where another does, nothing happens.
    bool Run(const CMouseEvent &event);
    void Abort();
    bool Aborted() const { return (state & aborted) != 0; }
    bool Running() const { return (state & running) != 0; }

    /// The one that runs; null for none, and for one that has ended: what its End opens gets the input.
    static CTracker *Current() noexcept;
    /// Whether one has not come back from Run yet, running or ended.
    static bool AnyHeld() noexcept;
    /// A view is about to go.
    static void ViewGone(const CView &gone) noexcept;
    static void WindowGone(const CWindow &gone) noexcept;

    /// Null once the view has gone.
    CView *View() const { return trackedView; }
    CWindow *Window() const { return trackedWindow; }

protected:
    /// Whether to go on.
    virtual bool Begin() { return true; }
    /// For whatever the pointer does; for the release, too.
    virtual void Track() {}
    /// A key goes down; Escape aborts.
    virtual void KeyDown(CKeyboardMessage &message);
    /// Once after a Begin that was true.
    virtual void End(bool) {}

    CPoint StartPoint() const { return startPoint; }
    CPoint CurrentPoint() const { return currentPoint; }
    CPoint CurrentInWindow() const { return currentInWindow; }
    std::uint32_t Modifiers() const { return modifiers; }
    /// Seconds from the press to the release, once it has ended.
    double Duration() const { return endTime - startTime; }

private:
    friend class CApplication;
    friend class CWindow;
    void Mouse(const CMouseEvent &event, bool release);
    CPoint InView(CPoint inWindow) const;

    enum stateBits : std::uint32_t
    {
        running = 1,
        ended = 2,
        aborted = 4
    };

    CView *trackedView;
    CWindow *trackedWindow;
    CTracker *outer = nullptr; ///< one that has ended, in whose End this one runs
    std::uint32_t trackerOptions;
    std::uint32_t state = 0;
    int button = 1;
    CPoint startPoint, currentPoint, currentInWindow;
    std::uint32_t modifiers = 0;
    double startTime = 0, endTime = 0;
};

} // namespace Sarnik
