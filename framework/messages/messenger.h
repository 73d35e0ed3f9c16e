#pragma once

namespace Sarnik
{

class CMessage;
class CMenuMessage;
class CKeyboardMessage;
class CCommandMessage;
class CValueMessage;

/// The root of all that takes part in messages. A message that a messenger does not take goes on to its parent, up to
/// the root: from a control over its panes and its window to the program. Interface thread.
class CMessenger
{
public:
    CMessenger() = default;
    CMessenger(const CMessenger &) = delete;
    CMessenger &operator=(const CMessenger &) = delete;
    /// Notifications that still wait for it are dropped. Children must have gone, or have another parent by now.
    virtual ~CMessenger();

    CMessenger *Parent() const noexcept { return parent; }
    void SetParent(CMessenger *to) noexcept { parent = to; }
    /// The child towards whoever has the focus; null where that is this one.
    CMessenger *Target() const noexcept { return target; }
    void SetTarget(CMessenger *to) noexcept { target = to; }

    /// Where a message enters. Whether somebody took it.
    bool Dispatch(CMessage &message);

    /// A handler of this messenger alone; true where it took the message. It may delete this messenger if it then
    /// answers true.
    virtual bool ReceiveMenu(CMenuMessage &) { return false; }
    virtual bool ReceiveKeyboard(CKeyboardMessage &) { return false; }
    virtual bool ReceiveCommand(CCommandMessage &) { return false; }
    /// Whether a command can be carried out, and its text: true where this one knows the command.
    virtual bool UpdateCommand(CCommandMessage &) { return false; }
    virtual bool ReceiveValue(CValueMessage &) { return false; }
    /// Of no other class.
    virtual bool ReceiveMessage(CMessage &) { return false; }

private:
    template <class Message> bool Climb(Message &message, bool (CMessenger::*handler)(Message &));

    CMessenger *parent = nullptr;
    CMessenger *target = nullptr;
};

} // namespace Sarnik
