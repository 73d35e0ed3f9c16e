#pragma once

#include "dialog/tasks/taskHost.h"
#include "framework/tasks/taskStack.h"

namespace Project
{

/// A change of the traces, or of how they are shown, that can be taken back.
class PTask : public Sarnik::CTask
{
protected:
    PTask(PTaskHost &home, bool done) : CTask(done), host(home) {}

    /// Shows a change that was made. Where that fails, `back` takes the change back and the failure goes on.
    template <class Show, class Back> static void ShowOr(Show show, Back back)
    {
        try
        {
            show();
        }
        catch (...)
        {
            back();
            throw;
        }
    }

    PTaskHost &host;
};

/// The undo stack of a run.
class PTaskStack final : public Sarnik::CTaskStack
{
public:
    bool GetLimit(int &most) const override
    {
        most = 100;
        return true;
    }
};

} // namespace Project
