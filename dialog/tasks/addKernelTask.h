#pragma once

#include "dialog/tasks/kernelTask.h"

namespace Project
{

/// A new trace: a copy of one that is given, which is active at once, or else an estimated one of the whole picture
/// with the default settings. Taken back, the trace is kept as it was, its kernel included.
class PAddKernelTask : public PKernelTask
{
public:
    /// source: stays the caller's, and need not live longer than the push; null for none. at: -1 appends.
    PAddKernelTask(PTaskHost &home, const PKernel *source, int at);
    ~PAddKernelTask() override;

    bool GetName(std::string &text) const override;

protected:
    void PerformUndo() override;
    void PerformRedo() override;

private:
    std::unique_ptr<PKernel> heldKernel; ///< while undone
    const PKernel *sourceKernel;         ///< until the first execution
    bool wasApplied = false;
    bool first = true;
};

/// The same under another name.
class PDuplicateKernelTask final : public PAddKernelTask
{
public:
    using PAddKernelTask::PAddKernelTask;
    bool GetName(std::string &text) const override;
};

} // namespace Project
