#include "dialog/tasks/undoCommands.h"

#include "dialog/tasks/task.h"
#include "framework/messages/messages.h"
#include "store/traces/kernelCollection.h"

namespace Project
{
namespace
{

using Sarnik::CCommandMessage;

/// A command and what it needs of the stack.
struct undoCommand
{
    Sarnik::CObjID id;
    bool (*possible)(const PTaskStack &);
    void (PTaskStack::*move)();
    /// Null leaves the menu's own text.
    void (*text)(const PTaskStack &, std::string &);
};

const undoCommand *FindCommand(Sarnik::CObjID id)
{
    constexpr auto canUndo = [](const PTaskStack &stack) { return stack.CanUndo(); };
    constexpr auto canRedo = [](const PTaskStack &stack) { return stack.CanRedo(); };
    constexpr auto canBoth = [](const PTaskStack &stack) { return stack.CanUndo() || stack.CanRedo(); };
    constexpr auto undoText = [](const PTaskStack &stack, std::string &text) { stack.GetUndoText(text); };
    constexpr auto redoText = [](const PTaskStack &stack, std::string &text) { stack.GetRedoText(text); };
    constexpr auto nextText = [](const PTaskStack &stack, std::string &text) {
        stack.WillUndo() ? stack.GetUndoText(text) : stack.GetRedoText(text);
    };
    static const undoCommand commands[] = {
        {"sarnik/command/undo", canUndo, &PTaskStack::Undo, undoText},
        {"sarnik/command/redo", canRedo, &PTaskStack::Redo, redoText},
        {"sarnik/command/undoRedo", canBoth, &PTaskStack::UndoRedo, nextText},
        {"sarnik/command/stepBackward", canUndo, &PTaskStack::Undo, nullptr},
        {"sarnik/command/stepForward", canRedo, &PTaskStack::Redo, nullptr},
    };
    for (const undoCommand &command : commands)
        if (command.id == id)
            return &command;
    return nullptr;
}

bool StopsEstimations(const undoCommand &command)
{
    return command.move == &PTaskStack::UndoRedo;
}

} // namespace

bool ReceiveUndoCommand(PTaskHost &host, const CCommandMessage &message)
{
    const undoCommand *command = FindCommand(message.Id());
    if (!command)
        return false;
    if (!host.Traces().AllIdle())
    {
        if (StopsEstimations(*command))
        {
            host.Traces().StopAll();
            host.View().EstimationsStopped();
        }
    }
    else if (command->possible(host.Tasks()))
    {
        (host.Tasks().*command->move)();
        host.View().InvalidatePreview();
        host.View().SyncControls();
    }
    return true;
}

bool UpdateUndoCommand(PTaskHost &host, CCommandMessage &message)
{
    const undoCommand *command = FindCommand(message.Id());
    if (!command)
        return false;
    const bool idle = host.Traces().AllIdle();
    message.enabled = idle ? command->possible(host.Tasks()) : StopsEstimations(*command);
    if (!idle && StopsEstimations(*command))
        message.text = "$$$/Deblur/EditMenu/StopAllEstimation=Stop All Estimation";
    else if (command->text)
        command->text(host.Tasks(), message.text);
    return true;
}

} // namespace Project
