#include "framework/views/application.h"
#include "framework/views/dragDrop.h"
#include "framework/views/tracker.h"
#include "framework/views/view.h"
#include "framework/views/window.h"

namespace Sarnik
{

using Platform::eventKind;

void CWindow::Handle(const Platform::event &e)
{
    switch (e.kind)
    {
    case eventKind::pointerMove:
    case eventKind::pointerDown:
    case eventKind::pointerUp:
    case eventKind::pointerLeave:
    case eventKind::wheel:
        HandlePointer(e);
        break;
    case eventKind::dropFiles:
        HandleDrop(e);
        break;
    case eventKind::resize:
        HandleResize();
        break;
    case eventKind::expose:
        Invalidate();
        break;
    case eventKind::close:
        CloseRequested();
        break;
    default:
        break;
    }
}

void CWindow::HandlePointer(const Platform::event &e)
{
    CMouseEvent mouse{.at = e.at,
                      .inWindow = e.at,
                      .button = e.button,
                      .clicks = e.clicks,
                      .wheelX = e.wheelX,
                      .wheelY = e.wheelY,
                      .modifiers = e.modifiers};
    pointerInside = e.kind != eventKind::pointerLeave;
    if (pointerInside)
        pointer = e.at;
    if (tracker != nullptr)
    {
        if (pointerInside)
            tracker->Mouse(mouse, e.kind == eventKind::pointerUp);
        return;
    }
    switch (e.kind)
    {
    case eventKind::pointerLeave:
        if (pressed == nullptr)
            Hover(nullptr, mouse);
        break;
    case eventKind::pointerMove:
        if (pressed != nullptr)
            pressed->MouseMove(mouse.For(*pressed));
        else
            Hover(ViewAt(e.at), mouse);
        break;
    case eventKind::pointerDown:
        HandleDown(mouse);
        break;
    case eventKind::pointerUp:
        if (CView *const released = pressed; released != nullptr && e.button == 1)
        {
            EndPress();
            released->MouseUp(mouse.For(*released));
        }
        break;
    case eventKind::wheel:
        HandleWheel(mouse);
        break;
    default:
        break;
    }
}

void CWindow::HandleDown(CMouseEvent &e)
{
    tips.Hide();
    SetShowsFocus(false);
    CView *const front = ViewAt(e.inWindow);
    // A disabled view keeps the press from what lies below it.
    if (front == nullptr || !front->IsEnabled() || e.button == 2)
        return;
    if (e.button == 3)
    {
        for (CView *view = front; view != nullptr; view = view->ParentView())
            if (view->HasOption(kView_ContextClick) && view->ContextClick(e.For(*view)))
                return;
        return;
    }
    const CApplication::witness alive(*this);
    for (CView *view = front; view != nullptr; view = view->ParentView())
        if (view->CanFocus() && !view->HasOption(kView_NoFocusOnClick))
        {
            view->SetFocus();
            break;
        }
    // A change of the focus may have moved or removed what was there.
    if (!alive)
        return;
    for (CView *view = ViewAt(e.inWindow); view != nullptr; view = view->ParentView())
    {
        // Set before: a tracker runs within, and a view that goes takes it back.
        pressed = view;
        trackerRan = false;
        if (view->MouseDown(e.For(*view)))
        {
            // After a tracker the button is up already.
            if (alive && pressed != nullptr && IsOpen() && !trackerRan)
                screen->capturePointer(true);
            else if (alive)
                pressed = nullptr;
            break;
        }
        if (!alive || pressed == nullptr)
            return;
        pressed = nullptr;
    }
    if (alive)
        RefreshPointer();
}

void CWindow::HandleWheel(CMouseEvent &e)
{
    for (CView *view = ViewAt(e.inWindow); view != nullptr; view = view->ParentView())
        if (view->IsEnabled() && view->MouseWheel(e.For(*view)))
            return;
}

void CWindow::HandleDrop(const Platform::event &e)
{
    if ((settings.features & kWin_DropFiles) == 0)
        return;
    CDragSession session(*this, {e.files, {}, -1, nullptr});
    session.Drop(e.at);
}

void CWindow::Hover(CView *view, const CMouseEvent &e)
{
    const CApplication::witness alive(*this);
    if (view != hovered)
    {
        CView *const left = std::exchange(hovered, view);
        if (left != nullptr)
            left->MouseLeave();
        // Each may have changed the tree.
        if (alive && hovered != nullptr)
            hovered->MouseEnter();
    }
    if (alive && hovered != nullptr && hovered->IsEnabled())
        hovered->MouseMove(e.For(*hovered));
    if (!alive)
        return;
    tips.Moved(hovered, e.inWindow);
    UpdateCursor();
}

void CWindow::UpdateCursor()
{
    Platform::cursor wanted;
    for (CView *view = hovered; view != nullptr; view = view->ParentView())
        if (view->CursorAt(view->FromWindow(pointer), wanted))
            break;
    if (wanted == cursor)
        return;
    cursor = wanted;
    CApplication::Current()->Display().setCursor(cursor);
}

void CWindow::RefreshPointer()
{
    if (!IsOpen() || !pointerInside)
        return;
    if (tracker != nullptr || pressed != nullptr)
        return UpdateCursor();
    CMouseEvent e;
    e.at = e.inWindow = pointer;
    e.modifiers = CApplication::Current()->Display().modifiers();
    Hover(ViewAt(pointer), e);
}

} // namespace Sarnik
