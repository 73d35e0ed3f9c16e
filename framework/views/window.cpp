#include "framework/views/window.h"

#include "framework/base/exceptions.h"
#include "framework/base/localisedString.h"
#include "framework/views/application.h"
#include "framework/views/dragDrop.h"
#include "framework/views/tracker.h"
#include "framework/views/view.h"

#include <cmath>
#include <utility>

namespace Sarnik
{
namespace
{

/// A corner from -100 to -1 is a share of the free room in hundredths.
CRect placed(const CRect &frame, const Platform::rectangle &area)
{
    const auto corner = [](std::int32_t wanted, double from, double to, std::int64_t size) {
        if (wanted < -100 || wanted > -1)
            return std::int64_t{wanted};
        const double room = std::max(0.0, to - from - static_cast<double>(size));
        return static_cast<std::int64_t>(std::lround(from + room * -wanted / 100));
    };
    const std::int64_t width = frame.Width(), height = frame.Height();
    const std::int64_t left = corner(frame.left, area.left, area.right, width);
    const std::int64_t top = corner(frame.top, area.top, area.bottom, height);
    return {CRect::Clamped(left), CRect::Clamped(top), CRect::Clamped(left + width), CRect::Clamped(top + height)};
}

CRect rounded(const Platform::rectangle &r)
{
    const auto whole = [](double v) { return CRect::Clamped(std::llround(v)); };
    const std::int32_t left = whole(r.left), top = whole(r.top);
    return {left, top, left + whole(r.width()), top + whole(r.height())};
}

} // namespace

CWindow::CWindow(CWindowSettings with) : settings(std::move(with))
{
}

CWindow::~CWindow()
{
    // Whoever deletes it has it.
    settings.features &= ~std::uint32_t{kWin_AutoDelete};
    Close();
    // Views still find their window as they go.
    DeleteChildren();
    CTracker::WindowGone(*this);
    CApplication::Gone(*this);
    if (drag != nullptr)
        drag->WindowGone();
}

void CWindow::SetSettings(CWindowSettings with)
{
    if (IsOpen())
        return;
    const CRect old = Bounds();
    settings = std::move(with);
    if (Bounds() == old)
        return;
    BoundsChanged(old);
    FrameChanged();
}

void CWindow::Open(CWindow *by)
{
    if (IsOpen())
        return;
    CApplication &application = *CApplication::Current();
    owner = by;
    try
    {
        Platform::display &display = application.Display();
        const CRect frame = settings.frame;
        Platform::windowSettings wanted{.title = Localize(settings.title),
                                        .kind = settings.kind,
                                        .resizable = (settings.features & kWin_CanSize) != 0,
                                        .placed = true,
                                        .place = toCanvas(placed(frame, display.workArea())),
                                        .owner = owner == nullptr ? nullptr : owner->screen.get()};
        screen = display.open(wanted);
        // Before the first window the size of the screen is a guess.
        settings.frame = placed(frame, display.workArea());
        if (toCanvas(settings.frame) != wanted.place)
            screen->setPlace(toCanvas(settings.frame));
    }
    catch (const Platform::displayError &e)
    {
        application.CheckDisplay();
        throw CError(e.what());
    }
    application.Opened(*this);
    Invalidate();
    if ((settings.features & kWin_OpenHidden) == 0)
        screen->show(true);
}

void CWindow::Close()
{
    if (!IsOpen())
        return;
    if (tracker != nullptr)
        tracker->Abort();
    tips.Hide();
    hovered = pressed = nullptr;
    pointerInside = false;
    if (CApplication *const application = CApplication::Current())
        application->DismissPopups(this);
    screen.reset();
    End(); // a modal loop, if it is one
    if (CApplication *const application = CApplication::Current())
        application->Closed(*this);
}

void CWindow::Show(bool visible)
{
    if (!IsOpen() || screen->visible() == visible)
        return;
    if (visible)
        Invalidate();
    else
        tips.Hide();
    screen->show(visible);
}

void CWindow::Activate()
{
    if (IsOpen())
        screen->activate();
}

bool CWindow::IsActive() const
{
    const CApplication *const application = CApplication::Current();
    return application != nullptr && application->Active() == this;
}

void CWindow::SetTitle(std::string title)
{
    settings.title = std::move(title);
    if (IsOpen())
        screen->setTitle(Localize(settings.title));
}

/// The user may have moved it.
CRect CWindow::Frame() const
{
    return IsOpen() ? rounded(screen->place()) : settings.frame;
}

CPoint CWindow::ToScreen(CPoint p) const
{
    const CRect frame = Frame();
    return {p.x + frame.left, p.y + frame.top};
}

CRect CWindow::Bounds() const
{
    return {0, 0, CRect::Clamped(settings.frame.Width()), CRect::Clamped(settings.frame.Height())};
}

void CWindow::SetFrame(const CRect &newFrame)
{
    const CRect old = Bounds();
    settings.frame = newFrame;
    if (IsOpen())
        screen->setPlace(toCanvas(newFrame));
    if (Bounds() == old)
        return;
    BoundsChanged(old);
    Invalidate();
    FrameChanged();
}

CRect CWindow::LargestFrame(std::int32_t margin) const
{
    const Platform::rectangle area = CApplication::Current()->Display().workArea();
    const Platform::rectangle border = IsOpen() ? screen->border() : Platform::rectangle{};
    CRect frame = wholeWithin({area.left + border.left + margin, area.top + border.top + margin,
                               area.right - border.right - margin, area.bottom - border.bottom - margin});
    frame.right = std::max(frame.right, frame.left + 1);
    frame.bottom = std::max(frame.bottom, frame.top + 1);
    return frame;
}

/// The display says that the size or the scale is another one.
void CWindow::HandleResize()
{
    const CRect old = Bounds();
    settings.frame = rounded(screen->place());
    BoundsChanged(old);
    damage.Clear();
    Invalidate();
    if (Bounds() != old)
        FrameChanged();
}

CWindow::modalSession::modalSession(CWindow &over, CWindow *owner) : application(*CApplication::Current()), window(over)
{
    // The release of a button that is down will not come to where it was pressed, and a tracker would keep its input
    // from the modal window.
    if (CTracker *const running = CTracker::Current())
        running->Abort();
    for (CWindow *w = application.windows.Head(); w != nullptr; w = w->Next())
        w->EndPress();
    application.DismissPopups();
    window.Open(owner);
    application.modal.push_back(&window);
}

CWindow::modalSession::~modalSession()
{
    std::erase(application.modal, &window);
    CWindow *const owner = window.IsActive() ? window.owner : nullptr;
    window.Close();
    // Not every window manager hands the keyboard back, and there may be none.
    if (owner != nullptr)
        owner->Activate();
}

CObjID CWindow::RunModal(CWindow *by)
{
    Restart();
    modalResult = {};
    const modalSession held(*this, by);
    while (!Ended())
        CApplication::Current()->ProcessOne();
    return modalResult;
}

void CWindow::EndModal(CObjID result)
{
    modalResult = result;
    End();
}

void CWindow::CloseRequested()
{
    if ((settings.features & kWin_CanClose) != 0)
        Close();
}

void CWindow::SetTracking(CTracker *by)
{
    tracker = by;
    trackerRan = trackerRan || by != nullptr;
    if (IsOpen())
        screen->capturePointer(by != nullptr);
    tips.Hide();
}

/// The pointer is no longer kept for a view, or for a tracker that has ended.
void CWindow::EndPress()
{
    pressed = nullptr;
    if (IsOpen() && (tracker == nullptr || !tracker->Running()))
        screen->capturePointer(false);
}

CView *CWindow::ViewAt(CPoint p) const
{
    if (!toCanvas(Bounds()).contains(p))
        return nullptr;
    for (auto child = Children().rbegin(); child != Children().rend(); ++child)
    {
        const CRect &frame = (*child)->Frame();
        if (CView *const found = (*child)->ViewAt({p.x - frame.left, p.y - frame.top}))
            return found;
    }
    return nullptr;
}

void CWindow::Forget(CView &view)
{
    const auto drop = [&](CView *&kept) {
        if (kept != nullptr && kept->IsWithin(view))
            kept = nullptr;
    };
    if (focus != nullptr && focus->IsWithin(view))
    {
        focus = nullptr;
        if (CContext *const above = view.Container())
            above->SetTarget(nullptr);
    }
    for (CView **const kept : {&hovered, &defaultView, &cancelView, &menuView})
        drop(*kept);
    if (pressed != nullptr && pressed->IsWithin(view))
        EndPress();
    if (drag != nullptr)
        drag->Forget(view);
}

void CWindow::ViewStateChanged(CView &view)
{
    if (pressed != nullptr && pressed->IsWithin(view) && !(pressed->IsVisible() && pressed->IsEnabled()))
        EndPress();
    if (focus != nullptr && focus->IsWithin(view) && !focus->CanFocus())
        SetFocus(nullptr);
}

} // namespace Sarnik
