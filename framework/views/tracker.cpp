#include "framework/views/tracker.h"

#include "framework/views/application.h"
#include "framework/views/view.h"
#include "framework/views/window.h"

#include <algorithm>
#include <utility>

namespace Sarnik
{
namespace
{

CTracker *innermost = nullptr;

} // namespace

CTracker::CTracker(CView &inView, std::uint32_t withOptions)
    : trackedView(&inView), trackedWindow(inView.Window()), trackerOptions(withOptions)
{
}

CTracker::~CTracker()
{
    if (innermost == this)
        innermost = outer;
}

CTracker *CTracker::Current() noexcept
{
    return innermost != nullptr && innermost->Running() ? innermost : nullptr;
}

bool CTracker::AnyHeld() noexcept
{
    return innermost != nullptr;
}

void CTracker::ViewGone(const CView &gone) noexcept
{
    for (CTracker *t = innermost; t != nullptr; t = t->outer)
        if (t->trackedView != nullptr && t->trackedView->IsWithin(gone))
        {
            t->Abort();
            t->trackedView = nullptr;
        }
}

void CTracker::WindowGone(const CWindow &gone) noexcept
{
    for (CTracker *t = innermost; t != nullptr; t = t->outer)
        if (t->trackedWindow == &gone)
        {
            t->Abort();
            t->trackedWindow = nullptr;
        }
}

CPoint CTracker::InView(CPoint inWindow) const
{
    if (trackedView == nullptr)
        return currentPoint;
    CPoint p = trackedView->FromWindow(inWindow);
    if (trackerOptions & confine)
    {
        const CRect bounds = trackedView->Bounds();
        p.x = std::clamp(p.x, 0.0, std::max(0.0, bounds.right - 1.0));
        p.y = std::clamp(p.y, 0.0, std::max(0.0, bounds.bottom - 1.0));
    }
    return p;
}

bool CTracker::Run(const CMouseEvent &event)
{
    if (Current() != nullptr || trackedWindow == nullptr || trackedView == nullptr)
        return false;

    /// Whatever way the loop is left.
    struct capture
    {
        explicit capture(CTracker &t) : tracker(t)
        {
            tracker.outer = std::exchange(innermost, &tracker);
            tracker.trackedWindow->SetTracking(&tracker);
        }
        ~capture()
        {
            tracker.state &= ~std::uint32_t{running};
            if (tracker.trackedWindow != nullptr)
                tracker.trackedWindow->SetTracking(nullptr);
            innermost = tracker.outer;
        }
        CTracker &tracker;
    };

    const capture held(*this);
    state = running;
    button = event.button;
    modifiers = event.modifiers;
    currentInWindow = event.inWindow;
    startPoint = currentPoint = InView(event.inWindow);
    startTime = endTime = CApplication::Now();
    if (!Begin())
    {
        state = (state & aborted) | ended;
        return false;
    }

    try
    {
        while (Running())
            CApplication::Current()->ProcessOne();
    }
    catch (...)
    {
        Abort();
        state |= ended;
        End(true);
        throw;
    }
    endTime = CApplication::Now();
    state |= ended;
    End(Aborted());
    return !Aborted();
}

void CTracker::Abort()
{
    state = (state & ~running) | aborted;
}

void CTracker::KeyDown(CKeyboardMessage &message)
{
    if (message.Character() == 27)
        Abort();
}

void CTracker::Mouse(const CMouseEvent &event, bool release)
{
    if (!Running())
        return;
    modifiers = event.modifiers;
    currentInWindow = event.inWindow;
    currentPoint = InView(event.inWindow);
    Track();
    if (release && event.button == button)
        state &= ~running;
}

} // namespace Sarnik
