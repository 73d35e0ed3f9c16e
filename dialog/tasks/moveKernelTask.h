#pragma once

#include "dialog/tasks/kernelTask.h"

namespace Project
{

/// A trace moves within the list, and is selected there.
class PMoveKernelTask final : public PKernelTask
{
public:
    /// to: its index afterwards.
    PMoveKernelTask(PTaskHost &home, int from, int to) : PKernelTask(home, from, false), toIndex(to) {}

    bool GetName(std::string &text) const override;

protected:
    void PerformUndo() override { Swap(); }
    void PerformRedo() override { Swap(); }

private:
    /// There and back is the same: the places change their roles.
    void Swap();

    int toIndex;
};

} // namespace Project
