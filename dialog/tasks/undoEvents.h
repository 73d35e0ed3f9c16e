#pragma once

#include "dialog/tasks/taskHost.h"
#include "store/traces/traceEvents.h"

namespace Project
{

/// The trace events that concern an undo stack, for whoever has one.
class PUndoEvents : public PTraceEvents
{
public:
    std::unique_ptr<PPendingSettings> BeginSettingsChange(PKernel &trace, std::uint32_t sourceId) override;
    std::uintptr_t UndoPosition() const override;
    bool AddLoadedTrace(const PKernel &trace, int at) override;
    void WorkspaceLoaded() override;

protected:
    /// Where changes are recorded; null, as at first, for nowhere.
    void SetRecorder(PTaskHost *host) { recorder = host; }

private:
    PTaskHost *recorder = nullptr;
};

} // namespace Project
