#include "framework/views/tracker.h"

#include "framework/views/application.h"
#include "framework/views/view.h"
#include "framework/views/window.h"

#include <algorithm>

namespace Sarnik
{
namespace
{

CTracker *current = nullptr;

} // namespace

CTracker::CTracker(CView &inView, std::uint32_t withOptions)
    : trackedView(&inView), trackedWindow(inView.Window()), trackerOptions(withOptions)
{
}

CTracker::~CTracker()
{
    if (current == this)
        current = nullptr;
}

CTracker *CTracker::Current() noexcept
{
    return current;
}

void CTracker::ViewGone(const CView &gone) noexcept
{
    if (current == nullptr || current->trackedView == nullptr || !current->trackedView->IsWithin(gone))
        return;
    current->Abort();
    current->trackedView = nullptr;
}

void CTracker::WindowGone(const CWindow &gone) noexcept
{
    if (current == nullptr || current->trackedWindow != &gone)
        return;
    current->Abort();
    current->trackedWindow = nullptr;
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
    if (current != nullptr || trackedWindow == nullptr || trackedView == nullptr)
        return false;

    /// Whatever way the loop is left.
    struct capture
    {
        explicit capture(CTracker &t) : tracker(t)
        {
            current = &tracker;
            tracker.trackedWindow->SetTracking(&tracker);
        }
        ~capture()
        {
            if (tracker.trackedWindow != nullptr)
                tracker.trackedWindow->SetTracking(nullptr);
            current = nullptr;
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
        state = ended;
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
    if (!Running() || (release && event.button != button))
        return;
    modifiers = event.modifiers;
    currentInWindow = event.inWindow;
    currentPoint = InView(event.inWindow);
    Track();
    if (release)
        state &= ~running;
}

} // namespace Sarnik
