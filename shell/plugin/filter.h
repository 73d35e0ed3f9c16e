#pragma once

#include "dialog/tasks/task.h"
#include "dialog/tasks/undoEvents.h"
#include "shell/heapPageStore.h"
#include "shell/plugin/hostPicture.h"
#include "shell/plugin/tintorelFilter.h"
#include "stages/imageHub.h"
#include "store/params.h"
#include "store/preferences.h"
#include "store/timeLog.h"
#include "store/traces/kernelCollection.h"

#include <tbb/global_control.h>

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace Project
{

/// The deblur filter: the one object of a run, which owns all that lives as long as it. What it owns is built when it
/// is first asked for, so that a run pays for nothing that it does not touch. Main thread; Current(), the parameters
/// once they exist, and the time log are for any thread while the run lasts.
class PFilter final : public Sarnik::CTintorelFilter, private PTimeLogOwner, private PUndoEvents, private PTaskHost
{
public:
    PFilter();
    ~PFilter() override;

    static PFilter *Current() noexcept;

    PImageHub *GetImageHub();
    PKernelCollection *GetKernels();
    PParams *GetParams();
    /// From its first use on, what is changed about the traces is recorded. A run without a dialog has none.
    PTaskStack *GetTaskStack();
    /// Those stored, or fresh ones where they cannot be read.
    PPreferences *GetPreferences();
    /// Where pixmaps keep their pages.
    Sarnik::CPageStore &Pages();

    std::string ProcessName() const override { return "$$$/Deblur/Process/Name=Stillmark"; }

protected:
    bool SplitMemory(std::int64_t total, std::int64_t &first, std::int64_t &second) override;
    bool DoParameters() override;
    bool DoPrepare() override { return DoParameters(); }
    bool DoRun() override;

private:
    // The end of the chain of commands: undoing.
    bool ReceiveCommand(Sarnik::CCommandMessage &command) override;
    bool UpdateCommand(Sarnik::CCommandMessage &command) override;
    PKernelCollection &Traces() override { return *GetKernels(); }
    PTaskStack &Tasks() override { return *GetTaskStack(); }
    PTaskView &View() override { return unseen; }

    // filterRun.cpp: the driver.
    bool CheckHostVersion();
    bool CheckImageSize();
    bool ReadRecording(PParams &record);
    bool Replay(PParams &record);
    bool RunDialog();

    // filterTraces.cpp: the traces of a run without a dialog.
    bool FindTraces();
    bool EstimateMissing();
    bool WaitForTraces(double from, double to);
    void LeaveOutUseless(const std::vector<PKernel *> &estimated);
    bool IsUseless(PKernel &trace);

    // runRecord.cpp: the recorded action.
    bool ReadDescriptor(PParams &record);
    void WriteDescriptor(const PParams &record);

    // What the traces tell: results that are out of date.
    void MarkDirty(const PDirtyStages &stages) override;
    void RefreshPreview(bool keepRough) override;

    bool OutputLog() const override;
    PTimeLogFile *GetTimeLogFile() override;
    PHostPicture &Picture();
    const std::string &PreferencesFolder();

    std::unique_ptr<Sarnik::CHeapPageStore> pages;
    std::unique_ptr<PHostPicture> picture;
    std::unique_ptr<PImageHub> imageHub;
    std::unique_ptr<PParams> params;
    std::unique_ptr<PPreferences> preferences;
    std::unique_ptr<PTaskStack> taskStack;
    PTaskView unseen; ///< while there is no window
    std::unique_ptr<PTimeLogFile> timeLogFile;
    bool applied = false; ///< the result is with the host
    std::unique_ptr<PKernelCollection> kernels;
    std::unique_ptr<tbb::global_control> threadLimit;
    Sarnik::CSuiteHold colourSpace; ///< held while DoRun lasts
    bool autoMode = true;           ///< traces are found automatically and need not be recorded
    std::optional<std::string> preferencesFolder;
};

} // namespace Project
