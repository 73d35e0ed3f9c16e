#include "framework/messages/messages.h"

namespace Sarnik
{

const CObjID CKeyboardMessage::KeyDown = "Sarnik/Message/KeyDown";
const CObjID CKeyboardMessage::KeyUp = "Sarnik/Message/KeyUp";
const CObjID CKeyboardMessage::KeyChar = "Sarnik/Message/KeyChar";
const CObjID CKeyboardMessage::KeyDeadChar = "Sarnik/Message/KeyDeadChar";
const CObjID CKeyboardMessage::SysKeyDown = "Sarnik/Message/SysKeyDown";
const CObjID CKeyboardMessage::SysKeyUp = "Sarnik/Message/SysKeyUp";
const CObjID CKeyboardMessage::SysKeyChar = "Sarnik/Message/SysKeyChar";
const CObjID CKeyboardMessage::SysKeyDeadChar = "Sarnik/Message/SysKeyDeadChar";

std::string CShortcut::Text() const
{
    const std::string_view name = Platform::keyName(key);
    if (name.empty())
        return {};
    std::string text;
    if (modifiers & Platform::ctrlModifier)
        text += "Ctrl+";
    if (modifiers & Platform::altModifier)
        text += "Alt+";
    if (modifiers & Platform::shiftModifier)
        text += "Shift+";
    return text += name;
}

bool CKeyboardMessage::IsDown() const
{
    return Id() == KeyDown || Id() == SysKeyDown;
}

bool CKeyboardMessage::IsChar() const
{
    return Id() == KeyChar || Id() == SysKeyChar;
}

} // namespace Sarnik
