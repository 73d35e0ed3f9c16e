#pragma once

#include "deblur/deconv/shrinkageTableStore.h"
#include "deblur/estimate/autoTraces.h"
#include "deblur/estimate/traceSize.h"
#include "store/params.h"
#include "store/traces/boundsGrey.h"
#include "store/traces/estimatedKernel.h"
#include "store/traces/taskPool.h"
#include "store/traces/traceEvents.h"
#include "store/traces/tracePicture.h"
#include "store/traces/traceRecord.h"

#include <atomic>
#include <cstdint>
#include <functional>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

namespace Project
{

/// Sizes for new traces, as deblur/estimate/traceSize.h has them.
using PSizePreset = CorvaneDeblur::sizePreset;

/// All Blur Traces of a run: their list, which of them are active (wanted in the result), which one is selected; new
/// ones found by looking at the picture; the estimations that are under way. Main thread only.
///
/// A trace renders when it is active and ready (PKernel::IsApplied). Beside the list there can be one lone automatic
/// trace, of a replay that finds the blur by itself: it is active and renders without being in the list.
/// Wherever order matters it is the list's.
class PKernelCollection
{
public:
    /// tableDirectory: where the deconvolution's tables are kept from run to run, the preferences directory; empty:
    /// nowhere. Picture, parameters and events outlive the collection.
    PKernelCollection(PTracePicture &picture, PParams &parameters, PTraceEvents &events, std::string tableDirectory);
    PKernelCollection(const PKernelCollection &) = delete;
    PKernelCollection &operator=(const PKernelCollection &) = delete;
    ~PKernelCollection();

    // The list.

    int Count() const { return static_cast<int>(kernels.size()); }
    /// Null when out of range.
    PKernel *At(int index) const;
    /// -1 when it is not in the list.
    int IndexOf(const PKernel *trace) const;
    /// Null while several previews are shown, or when none is selected.
    PKernel *Selected() const;
    /// -1 for none, whatever is shown.
    int SelectedIndex() const { return selected; }
    /// Out of range selects none.
    void Select(int index);

    /// In front of the trace at that index; an index out of range appends. The selection's index stays. Where this
    /// throws, the trace stays the caller's.
    PKernel &Insert(std::unique_ptr<PKernel> &&trace, int at);
    /// A copy of the same class, as Insert.
    PKernel &InsertCopy(const PKernel &trace, int at);
    /// Takes it out and puts it in again at `to`; only when both are in range. The selection's index stays.
    void Move(int from, int to);
    /// Takes a trace out, stopped, no longer active, without an open change; the caller keeps or drops it. Null when
    /// out of range.
    std::unique_ptr<PKernel> Remove(int index);
    /// Stops and deletes all traces, the lone one too.
    void Clear();

    // The active ones.

    bool IsActive(int index) const;
    void Activate(int index);
    void Deactivate(int index);
    void DeactivateAll();
    int ActiveCount() const { return static_cast<int>(active.size()); }
    /// Shows one trace alone for a while: remembers what is active, which the caller may then change.
    void Solo(int index);
    /// Back to what was remembered; to nothing active, if nothing was.
    void EndSolo();
    void ForgetSolo();
    int SoloIndex() const { return soloIndex; }

    /// Those that render now: active and ready, in list order, or the lone one.
    std::vector<PKernel *> RenderTraces() const;
    /// The first trace whose settings a render's common values come from: the first in the list, or the lone one; null
    /// without any.
    PKernel *FirstTrace() const;
    PKernel *LoneTrace() const { return lone.get(); }
    /// Active traces, or all of the list, the selected one (whatever is shown) first.
    std::vector<PKernel *> ActiveFirst() const;
    std::vector<PKernel *> SelectedFirst() const;
    bool AnyActiveReady() const { return !RenderTraces().empty(); }
    /// Rows of the largest kernel that renders; 0 when none does.
    int LargestActiveKernel() const;

    // Estimations.

    /// No trace is estimating.
    bool AllIdle() const;
    bool AnyActiveEstimating() const;
    /// Waits until the workers of all traces have ended, without fetching what they found.
    void JoinAll();
    /// Fetches what has finished; the number of those. One that ran out of memory throws, when all have been asked.
    int PollAll();
    void StopAll();
    /// Mean progress of the traces that estimate, 0..1; 1 when none does.
    double Progress() const;
    /// For runs without a dialog: fetches all results as they come. `progress`, where given, is told Progress of the
    /// traces that estimated at the beginning, some twenty times a second, and answers whether to go on; when it says
    /// no, everything is stopped and the answer is false.
    bool WaitForEstimations(const std::function<bool(double)> &progress = {});

    // Sizes, in pixels.

    int MaxKernelSize() const;
    int SizeForPreset(PSizePreset preset) const;
    /// What a new trace begins with: what FindDefaultSize found, or else the smallest preset.
    int DefaultKernelSize() const;
    /// As found, 0 when not; it is kept in workspaces.
    std::uint32_t FoundDefaultSize() const { return defaultSize; }
    void SetFoundDefaultSize(std::uint32_t size) { defaultSize = size; }

    // What the picture tells. The first of these to be called looks at the picture as a whole.

    /// When *stop becomes true, looking at the picture ends soon, with nothing found. Null: never. Set it before the
    /// first look; it outlives the collection.
    void SetStopFlag(const std::atomic<bool> *stop) { stopFlag = stop; }
    /// Reads the picture reduced, and measures its noise; once.
    void BuildAnalysisImage();
    /// Standard deviation of the noise; 0 before BuildAnalysisImage.
    float AnalysisNoise() const;
    /// Measures how large the blur is and makes that the size of new traces. The list stays as it is.
    void FindDefaultSize();
    /// A trace at another place worth estimating, with the settings of the selected trace or else the default ones; not
    /// in the list yet. Null when there is no such place.
    std::unique_ptr<PEstimatedKernel> addSuggestedRegion();
    /// A region near a point, in picture coordinates; empty when there is none.
    Sarnik::CRect suggestRegionAt(int x, int y);
    /// Appends parameters.autoTraceCount traces, or as many as there are places for; not started. If there is no place
    /// at all for the default size it becomes 10.
    void AddAutoTraces();
    /// Clears, finds the default size and a place, and starts the lone trace there in the background; whoever renders
    /// waits for it. False when no place qualifies.
    bool AutoEstimate();

    // Telling the world.

    void Invalidate(PInvalidation reason);
    /// Makes up for what was not shown while the preview was off, or brings the preview up to date.
    void RefreshPreview();
    /// A render has come to its end; answers whether a change came while it ran.
    bool EndRender();
    bool ResultStale() const { return resultStale; }

    /// Whether anything was changed since the workspace was saved.
    bool HasChanged() const;
    void SetSavedMark(std::uintptr_t mark) { savedMark = mark; }
    std::uintptr_t SavedMark() const { return savedMark; }

    /// The message of the last file operation.
    const std::string &GetLastError() const { return lastError; }
    void SetLastError(std::string message) { lastError = std::move(message); }
    /// Of the file header read last: the rules by which trace records are read.
    std::uint16_t Version() const { return version; }
    void SetVersion(std::uint16_t read) { version = read; }

    /// Built on first use, which reads or makes the tables; any thread.
    CorvaneDeblur::shrinkageTableStore &ShrinkageTables();

    // For the traces.

    PTracePicture &Picture() const { return picture; }
    PParams &Parameters() const { return parameters; }
    PTraceEvents &Events() const { return events; }
    PTaskPool &Pool() { return pool; }

private:
    void ListChanges();
    /// Those with an estimation under way.
    std::vector<PEstimatedKernel *> BusyTraces() const;
    int MostAutoTraces() const;
    CorvaneDeblur::analysedImage &Analysed();
    const KernelSettings &SettingsForNew() const;
    std::vector<CorvaneDeblur::regionRect> EstimatedRegions() const;

    PTracePicture &picture;
    PParams &parameters;
    PTraceEvents &events;
    PTaskPool pool; ///< before the traces: outlives them

    std::vector<std::unique_ptr<PKernel>> kernels; ///< in the order of the thumbnails
    std::unique_ptr<PEstimatedKernel> lone;        ///< the automatic trace of a replay, active and not in the list
    int selected = -1;
    std::vector<PKernel *> active, savedActive; ///< sets; their own order says nothing
    int soloIndex = -1;

    std::string lastError;
    bool resultStale = false;   ///< a change arrived while the preview was switched off
    bool renderRunning = false; ///< a result is being built since the last Invalidate
    bool needsRestart = false;  ///< Invalidate came meanwhile
    std::uintptr_t savedMark = 0;
    std::uint32_t defaultSize = 0;
    std::uint16_t version = kNewestTraceVersion;

    const std::atomic<bool> *stopFlag = nullptr;
    std::unique_ptr<PBoundsGrey> analysisSource;
    std::unique_ptr<CorvaneDeblur::analysedImage> analysis;

    const std::string tableDirectory;
    std::once_flag tablesOnce;
    std::unique_ptr<CorvaneDeblur::shrinkageTableStore> shrinkageTables;
};

} // namespace Project
