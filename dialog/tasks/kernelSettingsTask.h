#pragma once

#include "deblur/estimate/floatArray.h"
#include "dialog/tasks/kernelTask.h"
#include "framework/pixels/rect.h"
#include "store/kernelSettings.h"
#include "store/traces/kernel.h"

#include <cstdint>
#include <memory>

namespace Project
{

/// A trace has other settings, another region, another line; and the kernel that goes with them. Holds the other side
/// of the change: the state before while it is done, the state after while it is undone.
class PKernelSettingsTask final : public PKernelTask
{
public:
    /// The change has been made, or is about to be, and the trace still knows the state before. source: the control
    /// that made it.
    PKernelSettingsTask(PTaskHost &home, const PKernel &trace, int at, Sarnik::CObjID source);

    bool GetName(std::string &text) const override;

    void SetSource(Sarnik::CObjID source) { sourceId = source; }
    void SetIndex(int at) { index = at; }
    /// Whether it is a nudge of the trace of that index.
    bool IsNudgeOf(int at) const;

    /// The record of a change of a trace that begins; null where the trace is not in the list. When committed it goes
    /// on the host's stack.
    static std::unique_ptr<PPendingSettings> Begin(PTaskHost &home, const PKernel &trace, Sarnik::CObjID source);

protected:
    void PerformUndo() override { Swap(); }
    void PerformRedo() override { Swap(); }

private:
    void Swap();
    void Exchange(PKernel &trace);
    void Show();

    std::uint32_t mask = ~0u; ///< of the settings that it carries: all
    Sarnik::CObjID sourceId;
    KernelSettings settings;
    CorvaneDeblur::floatArray kernelImage;
    Sarnik::CRect region;
    PLinePoint endpoints[2]; ///< of a trace drawn by hand
};

/// To be called before a key nudges the trace: records the change, unless the last thing done was a nudge of the same
/// trace, so that a run of nudges is one step.
void RecordNudge(PTaskHost &host, PKernel &trace);

} // namespace Project
