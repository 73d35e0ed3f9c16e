#pragma once

#include "dialog/tasks/task.h"

#include <memory>

namespace Project
{

class PKernel;

/// A change of one trace, known by its place in the list.
class PKernelTask : public PTask
{
protected:
    PKernelTask(PTaskHost &home, int at, bool done) : PTask(home, done), index(at) {}

    /// Null where the list no longer has it, after traces came and went that nobody recorded.
    PKernel *Trace() const;
    /// The trace goes into the list at the index and is selected; nothing for null. When this throws, `trace` has it
    /// still.
    void PutIn(std::unique_ptr<PKernel> &trace, bool active);
    /// The trace leaves the list for `trace`; the selection goes to a neighbour. When this throws, it has not left, but
    /// its estimation is stopped.
    void TakeOut(std::unique_ptr<PKernel> &trace, bool &active);
    /// Selects in the list and in the view.
    void Select(int at);

    /// As ShowOr, with the list of thumbnails and the selection brought back, too. before: what was selected.
    template <class Show, class Back> void ShowListOr(int before, Show show, Back back)
    {
        ShowOr(show, [&] {
            back();
            Reselect(before);
        });
    }

    int index;

private:
    void Reselect(int before);
};

} // namespace Project
