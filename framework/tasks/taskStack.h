#pragma once

#include "framework/tasks/task.h"

#include <cstdint>
#include <memory>
#include <string>

namespace Sarnik
{

/// What has been done and what was taken back, each the most recent first. Owns its tasks. Interface thread.
class CTaskStack
{
public:
    CTaskStack() = default;
    CTaskStack(const CTaskStack &) = delete;
    CTaskStack &operator=(const CTaskStack &) = delete;
    virtual ~CTaskStack();

    virtual bool CanUndo() const { return !undoList.Empty(); }
    virtual bool CanRedo() const { return !redoList.Empty(); }
    /// For a menu, localised: what would be undone, or that nothing can be. Answers CanUndo, CanRedo.
    virtual bool GetUndoText(std::string &text) const;
    virtual bool GetRedoText(std::string &text) const;
    /// Whether UndoRedo would go back.
    virtual bool WillUndo() const { return redoList.Empty() || !lastWasUndo; }

    /// Executes a task that is not done, puts it on top and forgets what could be redone. What the execution throws
    /// goes on to the caller; the task is gone then and the stack as it was. Null only trims.
    virtual void Push(std::unique_ptr<CTask> task);
    /// One step; nothing where there is none. When the task throws, it stays where it is.
    virtual void Undo();
    virtual void Redo();
    /// One key for both: back, and forward again.
    virtual void UndoRedo();

    virtual void ClearAll();
    virtual void ClearUndo();
    virtual void ClearRedo();
    /// Destroys the oldest tasks beyond the limit, those to redo first.
    virtual void Trim();
    /// How many tasks are kept, done and undone together; 0 counts as 1. False for as many as there are.
    virtual bool GetLimit(int &most) const;

    /// The task that Undo would take; null for none.
    const CTask *LastDone() const { return undoList.Head(); }
    /// A number that tells two states of what is done apart, whatever was pushed and destroyed between them; 0 where
    /// nothing can be undone.
    std::uintptr_t Position() const { return CanUndo() ? LastDone()->number : 0; }

private:
    void Drop(CLinkList<CTask> &list);

    CLinkList<CTask> undoList, redoList;
    int total = 0; ///< of both lists
    std::uintptr_t pushes = 0;
    bool lastWasUndo = false;
};

} // namespace Sarnik
