#include "framework/base/localisedString.h"
#include "framework/views/application.h"
#include "framework/views/view.h"
#include "framework/views/window.h"

#include <algorithm>

namespace Sarnik
{
namespace
{

char32_t lowerCase(char32_t c)
{
    return c >= 'A' && c <= 'Z' ? c + ('a' - 'A') : c;
}

template <class Visit> void forEachView(const CContext &context, Visit visit)
{
    for (const auto &child : context.Children())
        if (visit(*child))
            forEachView(*child, visit);
}

} // namespace

bool CWindow::SetFocus(CView *view)
{
    if (view == focus)
        return true;
    if (view != nullptr && (view->Window() != this || !view->CanFocus()))
        return false;
    CView *const old = std::exchange(focus, view);
    // The chain of targets leads from the window to the view with the focus.
    for (CView *at = old; at != nullptr; at = at->ParentView())
        at->SetTarget(nullptr);
    SetTarget(nullptr);
    for (CView *at = view; at != nullptr; at = at->ParentView())
        at->Container()->SetTarget(at);
    for (CView *const end : {old, view})
        for (CView *at = end; at != nullptr && at->ParentView() != nullptr; at = at->ParentView())
            at->ParentView()->FocusWithinChanged();
    const CApplication::witness alive(*this);
    if (old != nullptr)
        old->FocusChanged(false);
    // Whoever lost it may have given it to a third one, or its last word has closed all.
    const bool given = alive && focus == view;
    if (given && view != nullptr)
        view->FocusChanged(true);
    return given;
}

void CWindow::SetShowsFocus(bool shows)
{
    if (std::exchange(showsFocus, shows) == shows)
        return;
    if (focus != nullptr)
        focus->Invalidate();
    // Some mark the focus around a view within, and a menu bar its access keys.
    for (CView *at = focus; at != nullptr && at->ParentView() != nullptr; at = at->ParentView())
        at->ParentView()->FocusWithinChanged();
    if (menuView != nullptr)
        menuView->Invalidate();
}

std::vector<CView *> CWindow::TabOrder() const
{
    std::vector<CView *> order;
    forEachView(*this, [&](CView &view) {
        if (view.HasOption(kView_Invisible) || view.HasOption(kView_Disabled) || view.HasOption(kView_NoTabNavigate))
            return false;
        if (view.IsTabStop() && view.CanFocus())
            order.push_back(&view);
        return true;
    });
    return order;
}

bool CWindow::MoveFocus(bool forward)
{
    const std::vector<CView *> order = TabOrder();
    if (order.empty())
        return false;
    const auto at = std::find(order.begin(), order.end(), focus);
    if (at == order.end())
        return SetFocus(forward ? order.front() : order.back());
    const auto place = static_cast<std::size_t>(at - order.begin());
    return SetFocus(order[(place + (forward ? 1 : order.size() - 1)) % order.size()]);
}

bool CWindow::HandleKeyboard(CKeyboardMessage &message)
{
    using Platform::key;
    const CApplication::witness alive(*this);
    tips.Hide();
    const bool navigates = message.Key() == key::tab || (message.Key() >= key::left && message.Key() <= key::pageDown);
    if (message.IsDown() && (navigates || (message.Modifiers() & Platform::altModifier) != 0))
        SetShowsFocus(true);
    if (KeyboardFilter(message) || !alive)
        return true;
    if (Leaf().Dispatch(message) || !alive)
        return true;
    if (!message.IsDown())
        return false;

    if (const auto shortcut = shortcuts.find(message.Shortcut()); shortcut != shortcuts.end())
    {
        // A command that cannot be carried out still owns its keys.
        const CObjID command = shortcut->second;
        if (QueryCommand(command).enabled && alive)
            SendCommand(command);
        return true;
    }
    const bool shiftF10 = message.Key() == key::f10 && message.Modifiers() == Platform::shiftModifier;
    if ((message.Key() == key::menu || shiftF10) && ContextClickByKey())
        return true;
    const std::uint32_t withAlt = message.Modifiers() & Platform::altModifier;
    const std::uint32_t others = message.Modifiers() & ~std::uint32_t{Platform::shiftModifier};
    if (withAlt != 0 && PressAccessKey(message.Character()))
        return true;
    if (others != 0)
        return false;
    if (message.Key() == key::f10 && message.Modifiers() == 0 && menuView != nullptr && menuView->IsVisible() &&
        menuView->IsEnabled())
    {
        menuView->Press();
        return true;
    }
    if (message.Key() == key::tab)
        return MoveFocus((message.Modifiers() & Platform::shiftModifier) == 0);
    const bool accept = message.Key() == key::enter || message.Key() == key::keypadEnter;
    CView *const standsFor = accept ? defaultView : message.Key() == key::escape ? cancelView : nullptr;
    if (standsFor == nullptr || !standsFor->IsVisible() || !standsFor->IsEnabled())
        return false;
    standsFor->Press();
    return true;
}

bool CWindow::ContextClickByKey()
{
    for (CView *view = focus; view != nullptr; view = view->ParentView())
    {
        CMouseEvent e;
        e.at = view->ContextPoint();
        e.inWindow = view->ToWindow(e.at);
        if (view->HasOption(kView_ContextClick) && view->ContextClick(e))
            return true;
    }
    return false;
}

bool CWindow::PressAccessKey(char32_t character)
{
    if (character == 0)
        return false;
    CView *found = nullptr;
    forEachView(*this, [&](CView &view) {
        if (found != nullptr || view.HasOption(kView_Invisible) || view.HasOption(kView_Disabled))
            return false;
        if (view.TakesAccessKey(lowerCase(character)))
            found = &view;
        return true;
    });
    if (found != nullptr)
        found->PressAccessKey(lowerCase(character));
    return found != nullptr;
}

CMessenger &CWindow::Leaf()
{
    CMessenger *leaf = this;
    while (leaf->Target() != nullptr)
        leaf = leaf->Target();
    return *leaf;
}

bool CWindow::SendCommand(CObjID command)
{
    CCommandMessage message(command);
    return Leaf().Dispatch(message);
}

CWindow::commandState CWindow::QueryCommand(CObjID command)
{
    CCommandMessage message(command, CCommandMessage::purpose::update);
    if (!Leaf().Dispatch(message))
        return {};
    return {message.enabled, message.checked, Localize(message.text)};
}

} // namespace Sarnik
