#include "framework/controls/buttons/pushButton.h"

namespace Sarnik
{

void CPushButton::SetDefault(bool is)
{
    isDefault = is;
    Invalidate();
    LayoutDone();
}

void CPushButton::SetCancel(bool is)
{
    cancel = is;
    LayoutDone();
}

void CPushButton::LayoutDone()
{
    CWindow *const window = Window();
    if (window == nullptr)
        return;
    if (isDefault)
        window->SetDefaultView(this);
    if (cancel)
        window->SetCancelView(this);
}

bool CPushButton::ReceiveKeyboard(CKeyboardMessage &message)
{
    using Platform::key;
    const bool enter = message.Key() == key::enter || message.Key() == key::keypadEnter;
    if (!enter || !message.IsDown() || message.Modifiers() != 0)
        return CButton::ReceiveKeyboard(message);
    if (!message.Repeat())
        Click(1);
    return true;
}

void CPushButton::SendClick()
{
    if (SendCommand(Id()) || !(ok || cancel))
        return;
    if (CWindow *const window = Window())
        window->EndModal(Id());
}

void CPushButton::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CButton::ReadProperties(placement, properties);
    isDefault = properties.Boolean("default_button");
    cancel = properties.Boolean("cancel_button");
    ok = properties.Boolean("ok_button");
}

} // namespace Sarnik
