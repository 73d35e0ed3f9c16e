#include "framework/views/application.h"

#include "framework/base/exceptions.h"
#include "framework/base/reporter.h"
#include "framework/messages/messages.h"
#include "framework/messages/notifications.h"
#include "framework/views/idler.h"
#include "framework/views/timer.h"
#include "framework/views/tracker.h"
#include "framework/views/view.h"
#include "framework/views/window.h"
#include "platform/utf8.h"

#include <algorithm>
#include <chrono>

namespace Sarnik
{
namespace
{

using Platform::eventKind;

/// A steady stream of events does not keep the screen from following for longer than this; seconds.
constexpr double longestUnpainted = 1.0 / 30;

/// Between the keyboard's leaving a window and its coming to the window's popup; seconds.
constexpr double keyboardGrace = 0.1;

CApplication *currentApplication = nullptr;
CApplication::witness *witnesses = nullptr;

void wakeDisplay(void *display)
{
    static_cast<Platform::display *>(display)->wake();
}

bool isInput(eventKind kind)
{
    switch (kind)
    {
    case eventKind::pointerMove:
    case eventKind::pointerDown:
    case eventKind::pointerUp:
    case eventKind::wheel:
    case eventKind::keyDown:
    case eventKind::keyUp:
    case eventKind::text:
    case eventKind::close:
    case eventKind::dropFiles:
        return true;
    default:
        return false;
    }
}

} // namespace

CApplication::witness::witness(const CWindow &seen) : window(&seen), outer(std::exchange(witnesses, this))
{
}

CApplication::witness::~witness()
{
    witnesses = outer;
}

CApplication::CApplication(Platform::display &on)
    : display(on), previous(std::exchange(currentApplication, this)),
      losing(
          keyboardGrace, [](void *application) { static_cast<CApplication *>(application)->KeyboardLost(); }, this)
{
    CNotifications::SetWaker(wakeDisplay, &display);
}

CApplication::~CApplication()
{
    while (CWindow *const window = windows.Tail())
        window->Close();
    leaving.clear();
    currentApplication = previous;
    CNotifications::SetWaker(previous == nullptr ? nullptr : wakeDisplay,
                             previous == nullptr ? nullptr : &previous->display);
}

CApplication *CApplication::Current() noexcept
{
    return currentApplication;
}

double CApplication::Now()
{
    if (currentApplication != nullptr)
        return currentApplication->display.now();
    return std::chrono::duration<double>(std::chrono::steady_clock::now().time_since_epoch()).count();
}

void CApplication::Opened(CWindow &window)
{
    windows.PushTail(window);
}

void CApplication::Closed(CWindow &window)
{
    windows.Unlink(window);
    std::erase(popups, &window);
    if (active == &window)
        active = nullptr;
    // It does not go back by itself everywhere.
    if (keyboardPopup == &window)
    {
        keyboardPopup = nullptr;
        if (window.owner != nullptr)
            window.owner->Activate();
    }
    for (CWindow *w = windows.Head(); w != nullptr; w = w->Next())
        if (w->owner == &window)
            w->owner = window.owner;
    if ((window.settings.features & kWin_AutoDelete) != 0)
        leaving.emplace_back(&window);
}

void CApplication::Gone(const CWindow &window) noexcept
{
    for (witness *w = witnesses; w != nullptr; w = w->outer)
        if (w->window == &window)
            w->window = nullptr;
}

void CApplication::CheckDisplay() const
{
    if (display.lost())
        throw CError("$$$/Sarnik/Application/Error/DisplayLost=The connection to the display was lost.");
}

template <class Action> bool CApplication::Guarded(Action action)
{
    try
    {
        action();
        return true;
    }
    catch (const CException &e)
    {
        // Within a lost display there is nothing to go on with, nor anybody to tell.
        if (display.lost())
            throw;
        CReporter::Get()->Report(e);
        return false;
    }
}

bool CApplication::ProcessOne(double mostWait)
{
    /// Windows that closed in an inner loop may still be on the stack of an outer one.
    struct nesting
    {
        explicit nesting(int &d) : depth(d) { ++depth; }
        ~nesting() { --depth; }
        int &depth;
    };

    CheckDisplay();
    if (depth == 0)
        leaving.clear();
    const nesting nested(depth);
    bool any = CloseLate();
    // What waits behind one that failed comes with the next turn.
    any = !Guarded([&] { any = CNotifications::Deliver() || any; }) || any;
    const bool due = CTimer::NextDue() <= display.now();
    Guarded([&] { CTimer::FireDue(display.now()); });
    settled = settled && !any && !due;

    Platform::event e;
    bool came = display.next(e, 0);
    if (!came)
    {
        bool more = PaintAll();
        if (!more && !settled)
            Guarded([&] { more = CIdler::RunAll(); });
        if (more || any)
        {
            settled = false;
            return true;
        }
        // What a callback or an idler marked or posted meanwhile must not wait, nor a loop that it has ended.
        if (!std::exchange(settled, true))
            return false;
        const double untilTimer = std::max(0.0, CTimer::NextDue() - display.now());
        came = display.next(e, std::min(mostWait, untilTimer));
    }
    if (came)
    {
        Guarded([&] { Handle(e); });
        settled = false;
    }
    CheckDisplay();

    for (CWindow *w = windows.Head(); came && w != nullptr; w = w->Next())
        if (!w->Damage().Empty() && display.now() - w->DamagedSince() > longestUnpainted)
        {
            PaintAll();
            break;
        }
    return came;
}

void CApplication::ProcessAll()
{
    while (ProcessOne(0))
    {
    }
    settled = false; // there may be other idlers by the next turn
}

/// What was to be closed while a tracker ran.
bool CApplication::CloseLate()
{
    if (closing.empty() || CTracker::AnyHeld())
        return false;
    for (const Platform::event &e : std::exchange(closing, {}))
        Guarded([&] { Handle(e); });
    return true;
}

bool CApplication::PaintAll()
{
    bool any = false;
    for (CWindow *w = windows.Head(); w != nullptr; w = w->Next())
        Guarded([&] { any = w->Paint() || any; });
    return any;
}

bool CApplication::TakesInput(const CWindow &window) const
{
    if (modal.empty() || IsPopup(window))
        return true;
    for (const CWindow *at = &window; at != nullptr; at = at->owner)
        if (at == modal.back())
            return true;
    return false;
}

bool CApplication::IsPopup(const CWindow &window) const
{
    return std::find(popups.begin(), popups.end(), &window) != popups.end();
}

void CApplication::DismissPopups(const CWindow *of)
{
    const auto belongs = [of](const CWindow *popup) {
        for (const CWindow *at = popup->owner; of != nullptr && at != of; at = at->owner)
            if (at == nullptr)
                return false;
        return true;
    };
    // From the front; each may take others with it.
    for (;;)
    {
        const auto front = std::find_if(popups.rbegin(), popups.rend(), belongs);
        if (front == popups.rend())
            return;
        CWindow *const popup = *front;
        std::erase(popups, popup);
        popup->Dismiss();
    }
}

CWindow *CApplication::WindowOf(Platform::windowId id) const
{
    for (CWindow *w = windows.Head(); w != nullptr; w = w->Next())
        if (w->screen->id() == id)
            return w;
    return nullptr;
}

/// The window that a press goes on in: moves and the release are its, also where another window has come under the
/// pointer and gets them. Null for none.
CWindow *CApplication::PressHolder() const
{
    if (CTracker::Current() != nullptr)
        return CTracker::Current()->Window();
    for (CWindow *w = windows.Head(); w != nullptr; w = w->Next())
        if (w->pressed != nullptr)
            return w;
    return nullptr;
}

void CApplication::Handle(const Platform::event &e)
{
    CWindow *const window = WindowOf(e.window);
    if (e.kind == eventKind::displayLost || window == nullptr)
        return;
    CTracker *const tracker = CTracker::Current();
    switch (e.kind)
    {
    case eventKind::focusIn:
    case eventKind::focusOut:
        HandleFocus(*window, e.kind == eventKind::focusIn);
        return;
    case eventKind::keyDown:
    case eventKind::keyUp:
        HandleKey(e);
        return;
    case eventKind::text:
        HandleText(e);
        return;
    default:
        break;
    }
    if (e.kind == eventKind::pointerMove || e.kind == eventKind::pointerUp)
        if (CWindow *const holder = PressHolder(); holder != nullptr && holder != window)
        {
            Platform::event there = e;
            const CPoint at = window->ToScreen(e.at), corner = holder->ToScreen({});
            there.window = holder->screen->id();
            there.at = {at.x - corner.x, at.y - corner.y};
            holder->Handle(there);
            return;
        }
    if (isInput(e.kind))
    {
        if (tracker != nullptr && e.kind == eventKind::close)
        {
            // The tracker's view must not go while it runs.
            tracker->Abort();
            closing.push_back(e);
            return;
        }
        if (tracker != nullptr && tracker->Window() != window)
            return;
        if (tracker == nullptr && e.kind == eventKind::pointerDown && !popups.empty() && !IsPopup(*window))
        {
            DismissPopups();
            return;
        }
        if (!TakesInput(*window))
        {
            if (e.kind == eventKind::pointerDown)
                Modal()->Activate();
            return;
        }
    }
    window->Handle(e);
}

void CApplication::HandleFocus(CWindow &window, bool gained)
{
    if (IsPopup(window))
        return HandlePopupFocus(window, gained);
    if (gained && losing.IsRunning() && active != &window)
        KeyboardLost();
    losing.Stop();
    if (gained == (active == &window))
        return;
    if (!gained && CTracker::Current() != nullptr && CTracker::Current()->Window() == &window)
        CTracker::Current()->Abort();
    if (!gained && !popups.empty())
        losing.Start();
    else
        SetActive(window, gained);
}

/// Without a window manager, and with some, a popup gets the keyboard though nobody wants that. The window that has
/// opened it counts as active all the same.
void CApplication::HandlePopupFocus(CWindow &popup, bool gained)
{
    keyboardPopup = gained ? &popup : nullptr;
    if (gained)
        losing.Stop();
    else
        losing.Start();
}

void CApplication::KeyboardLost()
{
    losing.Stop();
    DismissPopups();
    if (active != nullptr)
        SetActive(*active, false);
}

void CApplication::SetActive(CWindow &window, bool isActive)
{
    active = isActive ? &window : nullptr;
    const witness alive(window);
    window.ActiveChanged(isActive);
    if (!alive)
        return;
    // Those that look different.
    const auto mark = [](const auto &self, const CContext &context) -> void {
        for (const auto &child : context.Children())
        {
            if (child->HasOption(kView_InvalidOnActivate))
                child->Invalidate();
            self(self, *child);
        }
    };
    mark(mark, window);
}

CWindow *CApplication::KeyboardWindow(CWindow *from) const
{
    if (!popups.empty())
        return popups.back();
    return from != nullptr && TakesInput(*from) ? from : nullptr;
}

void CApplication::HandleKey(const Platform::event &e)
{
    const bool down = e.kind == eventKind::keyDown, system = (e.modifiers & Platform::altModifier) != 0;
    const CObjID kind = down ? (system ? CKeyboardMessage::SysKeyDown : CKeyboardMessage::KeyDown)
                             : (system ? CKeyboardMessage::SysKeyUp : CKeyboardMessage::KeyUp);
    CKeyboardMessage message(kind, e.pressed, e.character, e.modifiers, e.repeat);
    swallowText = false;
    if (CTracker *const tracker = CTracker::Current())
    {
        swallowText = down;
        if (down)
            tracker->KeyDown(message);
        return;
    }
    if (CWindow *const window = KeyboardWindow(WindowOf(e.window)))
        swallowText = window->HandleKeyboard(message) && down && !message.TextWanted();
}

void CApplication::HandleText(const Platform::event &e)
{
    if (swallowText || CTracker::Current() != nullptr)
        return;
    const CObjID kind =
        (e.modifiers & Platform::altModifier) != 0 ? CKeyboardMessage::SysKeyChar : CKeyboardMessage::KeyChar;
    // Each character may close the window or open another one.
    const std::u32string characters = Platform::codePoints(e.text);
    for (const char32_t c : characters)
        if (CWindow *const window = KeyboardWindow(WindowOf(e.window)))
        {
            CKeyboardMessage message(kind, Platform::keyOf(c), c, e.modifiers, e.repeat);
            window->HandleKeyboard(message);
        }
}

} // namespace Sarnik
