#include "framework/messages/messenger.h"

#include "framework/messages/messages.h"
#include "framework/messages/notifications.h"

namespace Sarnik
{

CMessenger::~CMessenger()
{
    CNotifications::Forget(*this);
}

/// The climb stays in the chain of one class.
template <class Message> bool CMessenger::Climb(Message &message, bool (CMessenger::*handler)(Message &))
{
    for (CMessenger *at = this; at != nullptr; at = at->parent)
        if ((at->*handler)(message))
            return true;
    return false;
}

bool CMessenger::Dispatch(CMessage &message)
{
    if (auto *const menu = dynamic_cast<CMenuMessage *>(&message))
        return Climb(*menu, &CMessenger::ReceiveMenu);
    if (auto *const keyboard = dynamic_cast<CKeyboardMessage *>(&message))
        return Climb(*keyboard, &CMessenger::ReceiveKeyboard);
    if (auto *const command = dynamic_cast<CCommandMessage *>(&message))
        return Climb(*command, command->Purpose() == CCommandMessage::purpose::update ? &CMessenger::UpdateCommand
                                                                                      : &CMessenger::ReceiveCommand);
    if (auto *const value = dynamic_cast<CValueMessage *>(&message))
        return Climb(*value, &CMessenger::ReceiveValue);
    return Climb(message, &CMessenger::ReceiveMessage);
}

} // namespace Sarnik
