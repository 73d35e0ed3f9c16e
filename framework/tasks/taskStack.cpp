#include "framework/tasks/taskStack.h"

#include "framework/base/localisedString.h"

#include <algorithm>

namespace Sarnik
{

CTaskStack::~CTaskStack()
{
    CTaskStack::ClearRedo();
    CTaskStack::ClearUndo();
}

bool CTaskStack::GetUndoText(std::string &text) const
{
    if (!CanUndo())
        text = "$$$/Sarnik/Tasks/CannotUndo=Cannot Undo";
    else if (!undoList.Head()->GetUndoText(text))
        text = "$$$/Sarnik/Tasks/Undo=Undo";
    text = Localize(text);
    return CanUndo();
}

bool CTaskStack::GetRedoText(std::string &text) const
{
    if (!CanRedo())
        text = "$$$/Sarnik/Tasks/CannotRedo=Cannot Redo";
    else if (!redoList.Head()->GetRedoText(text))
        text = "$$$/Sarnik/Tasks/Redo=Redo";
    text = Localize(text);
    return CanRedo();
}

void CTaskStack::Push(std::unique_ptr<CTask> task)
{
    if (task)
    {
        if (task->NeedsDo())
            task->Toggle();
        ClearRedo();
        CTask &pushed = *task.release();
        undoList.PushHead(pushed);
        ++total;
        pushed.number = ++pushes;
        lastWasUndo = false;
        pushed.Pushed();
    }
    Trim();
}

void CTaskStack::Undo()
{
    if (!CanUndo())
        return;
    CTask &task = *undoList.Head();
    task.Undo();
    undoList.Unlink(task);
    redoList.PushHead(task);
    lastWasUndo = true;
    task.Undone();
}

void CTaskStack::Redo()
{
    if (!CanRedo())
        return;
    CTask &task = *redoList.Head();
    task.Redo();
    redoList.Unlink(task);
    undoList.PushHead(task);
    lastWasUndo = false;
    task.Redone();
}

void CTaskStack::UndoRedo()
{
    if (!CanRedo())
        lastWasUndo = false;
    if (lastWasUndo)
        Redo();
    else
        Undo();
}

void CTaskStack::ClearAll()
{
    ClearRedo();
    ClearUndo();
}

void CTaskStack::ClearUndo()
{
    while (!undoList.Empty())
        Drop(undoList);
}

void CTaskStack::ClearRedo()
{
    while (!redoList.Empty())
        Drop(redoList);
}

void CTaskStack::Trim()
{
    int limit = 0;
    if (!GetLimit(limit))
        return;
    while (total > std::max(limit, 1))
        Drop(redoList.Empty() ? undoList : redoList);
}

bool CTaskStack::GetLimit(int &most) const
{
    most = 1;
    return true;
}

/// The oldest one of a list.
void CTaskStack::Drop(CLinkList<CTask> &list)
{
    CTask *task = list.Tail();
    list.Unlink(*task);
    --total;
    delete task;
}

} // namespace Sarnik
