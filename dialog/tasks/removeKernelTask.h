#pragma once

#include "dialog/tasks/kernelTask.h"

namespace Project
{

/// A trace leaves the list; it goes for good with the task.
class PRemoveKernelTask final : public PKernelTask
{
public:
    PRemoveKernelTask(PTaskHost &home, int at);
    ~PRemoveKernelTask() override;

    bool GetName(std::string &text) const override;

protected:
    void PerformUndo() override { PutIn(heldKernel, wasApplied); }
    void PerformRedo() override { TakeOut(heldKernel, wasApplied); }

private:
    std::unique_ptr<PKernel> heldKernel; ///< while done
    bool wasApplied = false;
};

} // namespace Project
