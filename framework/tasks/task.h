#pragma once

#include "framework/base/link.h"

#include <cstdint>
#include <string>

namespace Sarnik
{

/// A change that can be taken back and made again. A heir gives the two directions; the first execution is a redo of a
/// task that is not done yet. Lies on a CTaskStack, which owns it. Interface thread.
class CTask : public CLink<CTask>
{
public:
    /// done: the change has been made already, so that pushing the task executes nothing.
    explicit CTask(bool done) : flags(done ? doneFlag : 0) {}
    virtual ~CTask() = default;

    virtual bool IsDone() const { return (flags & doneFlag) != 0; }
    virtual bool NeedsDo() const { return (flags & doneFlag) == 0; }

    /// What is done, as the user knows it, to be localised: "Move Blur Trace". False, with `text` left alone, for a
    /// task without a name; so the other two.
    virtual bool GetName(std::string &text) const;
    /// "Undo Move Blur Trace", localised.
    virtual bool GetUndoText(std::string &text) const;
    virtual bool GetRedoText(std::string &text) const;

    /// The task is on the stack; an undo, a redo has moved it to the other list.
    virtual void Pushed() {}
    virtual void Undone() {}
    virtual void Redone() {}

    /// Nothing happens where the task is in that state already. Where the performing throws, the state stays.
    virtual void Undo();
    virtual void Redo();
    virtual void Toggle();

protected:
    /// What they do is all or nothing: a task that throws has changed nothing, so that it can be tried again.
    virtual void PerformUndo() = 0;
    virtual void PerformRedo() = 0;

private:
    friend class CTaskStack;
    static constexpr std::uint32_t doneFlag = 1;

    std::uint32_t flags;
    std::uintptr_t number = 0; ///< of its push
};

} // namespace Sarnik
