#include "framework/tasks/task.h"

#include "framework/base/localisedString.h"

namespace Sarnik
{
namespace
{

bool NameInto(const CTask &task, const char *pattern, std::string &text)
{
    std::string name;
    if (!task.GetName(name))
        return false;
    text = Localize(pattern, {Localize(name)});
    return true;
}

} // namespace

bool CTask::GetName(std::string &) const
{
    return false;
}

bool CTask::GetUndoText(std::string &text) const
{
    return NameInto(*this, "$$$/Sarnik/Tasks/UndoOp=Undo ^0", text);
}

bool CTask::GetRedoText(std::string &text) const
{
    return NameInto(*this, "$$$/Sarnik/Tasks/RedoOp=Redo ^0", text);
}

void CTask::Undo()
{
    if (!IsDone())
        return;
    PerformUndo();
    flags &= ~doneFlag;
}

void CTask::Redo()
{
    if (IsDone())
        return;
    PerformRedo();
    flags |= doneFlag;
}

void CTask::Toggle()
{
    if (IsDone())
        Undo();
    else
        Redo();
}

} // namespace Sarnik
