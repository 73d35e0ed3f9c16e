#include "store/traces/kernel.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/kernelMeasures.h"
#include "framework/base/container.h"
#include "store/traces/kernelCollection.h"
#include "store/traces/traceRecord.h"

#include <utility>

namespace Project
{
namespace
{

/// Changes that only a render answers, not a new estimation.
constexpr std::uint32_t renderMask = kMaskDeconvFlagA | kMaskDeconvFlagB | kMaskDeconvWeight | kMaskSmoothing |
                                     kMaskSuppression | kMaskDeconvIterations | kMaskForcedApply;
/// Changes that a new estimation answers.
constexpr std::uint32_t estimationMask = kMaskMode | kMaskSize | kMaskEstimatorOptions | kMaskEstimatorTuningA |
                                         kMaskEstimatorTuningB | kMaskThreadWeight | kMaskThreadFlag | kMaskNoiseLevel |
                                         kMaskGeometry | kMaskThreshold | kMaskAnchor;

} // namespace

PKernel::PKernel(PKernelCollection &owner, const Sarnik::CRect &rect, const KernelSettings &given)
    : home(owner), committedRegion(rect), previousSettings(given), region(rect), drawnRegion(rect), settings(given)
{
    settings.anchorX = settings.anchorY = 0;
}

PKernel::PKernel(PKernelCollection &owner, const PTraceRecord &record) : home(owner)
{
    TakeRecord(record);
}

PKernel::PKernel(const PKernel &other)
    : home(other.home), kernelImage(other.kernelImage),
      committedRegion(other.HasKernel() ? other.committedRegion : other.region), previousSettings(other.settings),
      region(other.region), drawnRegion(other.drawnRegion), settings(other.settings)
{
}

PKernel::~PKernel() = default;

void PKernel::Offset(int dx, int dy)
{
    region = region.Moved(dx, dy);
    drawnRegion = drawnRegion.Moved(dx, dy);
}

void PKernel::Read(Sarnik::CContainer &in)
{
    TakeRecord(ReadCommonRecord(in, home.Version()));
}

void PKernel::Write(Sarnik::CContainer &out) const
{
    out.WriteU32(static_cast<std::uint32_t>(KernelType()));
    WriteCommonRecord(out, ToRecord());
}

void PKernel::TakeRecord(const PTraceRecord &record)
{
    region = drawnRegion = committedRegion = record.region;
    settings = previousSettings = record.settings;
    kernelImage = record.kernel;
}

PTraceRecord PKernel::ToRecord() const
{
    PTraceRecord record;
    record.region = region;
    record.settings = settings;
    record.kernel = kernelImage;
    return record;
}

void PKernel::RestoreSettings(std::uint32_t mask, const KernelSettings &from)
{
    CopySettings(settings, from, mask);
    CopySettings(previousSettings, from, mask);
}

void PKernel::SetKernel(const CorvaneDeblur::floatArray &array)
{
    MarkChanged();
    kernelImage = array.empty() ? CorvaneDeblur::floatArray() : cloned(array);
}

bool PKernel::IsReliable() const
{
    return HasKernel() && CorvaneDeblur::isGoodKernel(kernelImage);
}

bool PKernel::IsApplied() const
{
    return HasKernel() && (settings.forcedApply || IsReliable());
}

void PKernel::MarkChanged()
{
    detailChanged = detailChanged || changed;
    changed = true;
}

void PKernel::UpdateSettings(std::uint32_t mask, const KernelSettings &from, std::uint32_t sourceId)
{
    CopySettings(settings, from, mask);
    RecordSettingChange(mask, sourceId);
}

void PKernel::RecordSettingChange(std::uint32_t mask, std::uint32_t sourceId)
{
    if (pendingTask)
    {
        pendingTask->SetSource(sourceId);
        return;
    }
    pendingTask = home.Events().BeginSettingsChange(*this, sourceId);
    if (mask & renderMask)
        MarkChanged();
    const bool estimates = KernelType() == PKernelKind::Estimated || mask != kMaskGeometry;
    if ((mask & estimationMask) == 0 || !estimates)
        CommitPending();
}

void PKernel::CommitPending()
{
    previousSettings = settings;
    if (pendingTask)
        PPendingSettings::Commit(std::move(pendingTask), home.IndexOf(this));
}

} // namespace Project
