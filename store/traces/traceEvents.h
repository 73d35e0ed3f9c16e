#pragma once

#include <cstdint>
#include <memory>
#include <utility>

namespace Project
{

class PKernel;

/// A change of a trace's settings that is under way: made before the change, while the trace still has its old state,
/// and committed when the change is complete. An undo record, for those who keep one.
class PPendingSettings
{
public:
    virtual ~PPendingSettings() = default;
    /// The control that made the latest change.
    virtual void SetSource(std::uint32_t sourceId) = 0;
    /// Takes the record over: it goes on the undo stack as the trace `index` of the list.
    static void Commit(std::unique_ptr<PPendingSettings> pending, int index)
    {
        PPendingSettings *record = pending.get();
        record->Push(std::move(pending), index);
    }

protected:
    virtual void Push(std::unique_ptr<PPendingSettings> self, int index) = 0;
};

/// Whatever the dialog hangs on a trace (its copy of the source's pixels, a preview of the trace alone); goes with it.
class PTraceAttachment
{
public:
    virtual ~PTraceAttachment() = default;
    /// The trace has a new kernel from a new estimation: what was kept of the old region is out of date.
    virtual void EstimationFinished() {}
};

/// Why results are out of date.
enum class PInvalidation
{
    Normal = 0,
    KeepRough = 1 ///< the rough preview still holds
};

/// The stages that hold a result.
struct PDirtyStages
{
    bool rough = false, scaled = false, final = false;
};

/// What traces and their collection tell the world, and the little that they ask of it. As it stands, nobody listens:
/// a run without a dialog overrides what it needs. Outlives the collection. Main thread only.
class PTraceEvents
{
public:
    virtual ~PTraceEvents() = default;

    /// These stages lose what they hold.
    virtual void MarkDirty(const PDirtyStages &) {}
    /// The traces that render, or how they do, have changed: for the preview's schedule and the detail pane.
    virtual void TracesChanged() {}
    /// Bring the preview up to date; keepRough: with what the rough preview has.
    virtual void RefreshPreview(bool) {}

    /// An estimation has just ended, well or badly. The trace is in the list, or is the lone automatic one.
    virtual void EstimationFinished(PKernel &) {}
    /// A trace's picture or settings look different now: for thumbnails and controls.
    virtual void TraceLooksDifferent(PKernel &) {}

    /// A record of the trace as it is, before a change; null where nobody records.
    virtual std::unique_ptr<PPendingSettings> BeginSettingsChange(PKernel &, std::uint32_t /*sourceId*/) { return {}; }
    /// A number that differs for any two states of the undo stack, 0 when it is empty.
    virtual std::uintptr_t UndoPosition() const { return 0; }

    /// A trace from a file is about to enter the list: whoever records inserts a copy of it as an undoable step. False
    /// where nobody does; the loader inserts it itself then.
    virtual bool AddLoadedTrace(const PKernel &, int /*at*/) { return false; }
    /// A workspace has replaced all traces, wholly read or not: nothing can be undone any more.
    virtual void WorkspaceLoaded() {}

    /// Several previews are shown side by side; nothing counts as selected meanwhile.
    virtual bool MultiPreview() const { return false; }
    /// Waits for what renders the traces' previews on another thread, before the list changes.
    virtual void JoinDetail() {}
};

} // namespace Project
