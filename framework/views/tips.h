#pragma once

#include "framework/pixels/rect.h"
#include "framework/views/port.h"
#include "framework/views/timer.h"

#include <memory>
#include <string>

namespace Sarnik
{

class CView;
class CWindow;

/// Shows the tip of the view under a window's pointer after it has rested there, and offers the help text at once.
class CTipWatch
{
public:
    /// Seconds of rest, and of reading.
    static constexpr double delay = 0.6, duration = 12;

    explicit CTipWatch(CWindow &window);
    ~CTipWatch();

    /// The pointer is over a view (null for none), in the window's coordinates.
    void Moved(CView *view, CPoint at);
    /// A press, a key, or anything else that makes a tip stale.
    void Hide();
    /// The tip's window; null while none is shown.
    CWindow *Shown() const { return shown.get(); }

private:
    static void TimerFired(void *watch);
    void ShowNow();

    CWindow &window;
    CTimer timer;
    std::unique_ptr<CWindow> shown;
    std::string text, help;
    CRect rect;        ///< in the window's coordinates: where the text holds
    bool done = false; ///< shown or hidden for this text already
    CPoint at;
};

} // namespace Sarnik
