#pragma once

#include "deblur/estimate/floatArray.h"
#include "framework/pixels/rect.h"
#include "store/kernelSettings.h"
#include "store/traces/traceEvents.h"

#include <cstdint>
#include <memory>

namespace Sarnik
{
class CContainer;
}

namespace Project
{

class PKernelCollection;
struct PTraceRecord;

/// The number of a trace's kind in files.
enum class PKernelKind : std::uint32_t
{
    Estimated = 1,
    Manual = 2,
    ReadOnly = 3
};

/// An end of a straight trace, in picture coordinates.
struct PLinePoint
{
    float x = 0.0f, y = 0.0f;
    friend bool operator==(const PLinePoint &, const PLinePoint &) = default;
};

/// A change of geometry alone: selects no field of the settings (see KernelSettingsMask).
constexpr std::uint32_t kMaskGeometry = 0x4000;

/// A Blur Trace: a blur kernel, the region of the picture that it belongs to, and its settings. Rectangles are in
/// picture coordinates. Traces belong to a run's collection, which outlives them, whether or not they are in its list.
/// Main thread only.
class PKernel
{
public:
    PKernel(PKernelCollection &home, const Sarnik::CRect &region, const KernelSettings &settings);
    /// The loaded trace counts as estimated with exactly the settings and the region that it holds.
    PKernel(PKernelCollection &home, const PTraceRecord &record);
    PKernel &operator=(const PKernel &) = delete;
    virtual ~PKernel();

    virtual void Offset(int dx, int dy);
    /// 0 idle, 1 estimating.
    virtual int EstimationState() const { return 0; }
    virtual void SetEstimationState(int) {}
    /// The record of this class from a stream that stands behind the kind, by the rules of the collection's version.
    /// Throws CError; the trace is unchanged then.
    virtual void Read(Sarnik::CContainer &in);
    /// The record in the newest version, kind first.
    virtual void Write(Sarnik::CContainer &out) const;
    virtual PKernelKind KernelType() const = 0;
    /// A trace of the same class with the same kernel, region and settings. Copy an idle trace: an estimation under
    /// way is not copied.
    virtual std::unique_ptr<PKernel> Copy() const = 0;

    const Sarnik::CRect &Region() const { return region; }
    /// As the user drew it, before it grew to fit the kernel.
    const Sarnik::CRect &DrawnRegion() const { return drawnRegion; }
    /// Of the last finished estimation; without one, as the trace was made.
    const Sarnik::CRect &CommittedRegion() const { return committedRegion; }
    /// Sets the region and the drawn one.
    void SetRegion(const Sarnik::CRect &rect) { region = drawnRegion = rect; }
    /// Sets all three: for undoing.
    void RestoreRegion(const Sarnik::CRect &rect) { region = drawnRegion = committedRegion = rect; }

    KernelSettings &Settings() { return settings; }
    const KernelSettings &Settings() const { return settings; }
    /// Of the last finished estimation.
    const KernelSettings &PreviousSettings() const { return previousSettings; }
    /// Takes the fields of `mask` over into the settings and the previous settings: for undoing.
    void RestoreSettings(std::uint32_t mask, const KernelSettings &from);

    bool HasKernel() const { return kernelImage.cols > 0; }
    /// Shares the samples; nobody writes them.
    const CorvaneDeblur::floatArray &KernelImage() const { return kernelImage; }
    /// Copies the samples, and marks the trace as changed.
    void SetKernel(const CorvaneDeblur::floatArray &array);
    /// There is a kernel and it can be trusted.
    bool IsReliable() const;
    /// There is a kernel, and it can be trusted or the user wants it all the same: the trace is ready to render.
    bool IsApplied() const;

    /// Changed since the last render; the second mark, once more.
    bool Changed() const { return changed; }
    bool DetailChanged() const { return detailChanged; }
    void MarkChanged();
    void ClearChanged() { changed = false; }
    void ClearDetailChanged() { detailChanged = false; }

    /// Takes the fields of `mask` over from `from`, and records the change. sourceId: the control that made it.
    void UpdateSettings(std::uint32_t mask, const KernelSettings &from, std::uint32_t sourceId = 0);
    /// Records a change of the settings' fields in `mask`, or of the geometry, that is about to be made or has just
    /// been made: the state before is the previous settings, the committed region and the kernel. A change that a new
    /// estimation answers is committed when that ends well, any other at once. While a record is open it serves for
    /// all further changes.
    void RecordSettingChange(std::uint32_t mask, std::uint32_t sourceId);
    void DropPendingChange() { pendingTask.reset(); }
    bool HasPendingChange() const { return pendingTask != nullptr; }

    /// What the dialog keeps with the trace; null at first.
    std::unique_ptr<PTraceAttachment> attachment;

protected:
    /// Kernel, regions and settings; nothing of what is under way.
    PKernel(const PKernel &other);

    void TakeRecord(const PTraceRecord &record);
    PTraceRecord ToRecord() const;
    void CommitPending();

    PKernelCollection &home;
    CorvaneDeblur::floatArray kernelImage;
    bool changed = false;
    bool detailChanged = false;
    Sarnik::CRect committedRegion;
    KernelSettings previousSettings;
    std::unique_ptr<PPendingSettings> pendingTask;
    Sarnik::CRect region, drawnRegion;
    KernelSettings settings;
};

} // namespace Project
