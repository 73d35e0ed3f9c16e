#include "store/traces/estimatedKernel.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/finiteSamples.h"
#include "deblur/estimate/kernelEstimator.h"
#include "deblur/estimate/kernelEstimatorText.h"
#include "store/traces/kernelCollection.h"

#include <algorithm>
#include <exception>
#include <string>

namespace Project
{
namespace
{

using namespace CorvaneDeblur;

constexpr std::uint32_t textEstimator = 2; ///< a bit of estimatorOptions

/// An odd size that can be estimated, whatever a file says.
int EstimableSize(std::int32_t size)
{
    return std::clamp(size, 3, kLargestEstimate) | 1;
}

std::unique_ptr<kernelEstimator> NewEstimator(const PParams &parameters, const KernelSettings &settings,
                                              PKernelCollection &home)
{
    auto made = std::make_unique<kernelEstimator>();
    made->noise = noiseMode::low;
    made->noiseLevel = 0.0f;
    if (parameters.pyramidSmooth == 1)
    {
        made->noise = NoiseModeOf(settings);
        if (made->noise == noiseMode::automatic)
            home.BuildAnalysisImage();
        made->noiseLevel = home.AnalysisNoise();
    }
    made->randomKernelLevel = parameters.randomKernelLevel;
    made->pyramidLevel = std::clamp(parameters.pyramidLevel, 0, 10);
    made->derivativesOrder = parameters.derivativesType == 1 ? 1 : 0;
    made->imageToKernelRatio = 3;
    return made;
}

/// One axis of a region, grown by `by` to both sides: what passes one edge of from..to goes to the other side.
void GrowAxis(std::int64_t &first, std::int64_t &last, std::int64_t by, std::int64_t from, std::int64_t to)
{
    first -= by;
    last += by;
    if (last > to)
    {
        first -= last - to;
        last = to;
    }
    if (first < from)
    {
        last += from - first;
        first = from;
    }
    first = std::clamp(first, from, to);
    last = std::clamp(last, from, to);
}

} // namespace

noiseMode NoiseModeOf(const KernelSettings &settings)
{
    return settings.noiseLevel <= 2 ? static_cast<noiseMode>(settings.noiseLevel) : noiseMode::automatic;
}

PEstimatedKernel::PEstimatedKernel(PKernelCollection &owner, const Sarnik::CRect &rect, const KernelSettings &given)
    : PKernel(owner, rect, given), control(owner.Pool())
{
}

PEstimatedKernel::PEstimatedKernel(PKernelCollection &owner, const PTraceRecord &record)
    : PKernel(owner, record), control(owner.Pool())
{
}

PEstimatedKernel::PEstimatedKernel(const PEstimatedKernel &other) : PKernel(other), control(other.home.Pool())
{
}

PEstimatedKernel::~PEstimatedKernel()
{
    StopEstimation();
}

void PEstimatedKernel::StartEstimation(PEstimationRun run)
{
    // The record of the change that this estimation answers belongs to the new run, not to the one that is given up.
    auto pending = std::move(pendingTask);
    StopEstimation();
    pendingTask = std::move(pending);
    if (home.Parameters().outputLog)
    {
        timeLog = std::make_unique<PTimeLogger>("KernelEstimater " + std::to_string(home.IndexOf(this)));
        timeLog->Start();
    }

    const Sarnik::CRect bounds = home.Picture().Bounds();
    const Sarnik::CRect rect = region.Empty() ? bounds : region.Intersected(bounds);
    if (rect.Empty())
    {
        DropPendingChange();
        return;
    }
    estimationState = 1;
    try
    {
        const int rows = static_cast<int>(rect.Height()), cols = static_cast<int>(rect.Width());
        const auto threshold = static_cast<std::uint8_t>(settings.maskThreshold);
        regionGrey = floatArray::allocate(rows, cols);
        if (threshold < 255)
            regionMask = byteArray::allocate(rows, cols);
        home.Picture().ReadGrey(rect, threshold, regionGrey, regionMask);
        zeroNonFinite(regionGrey);
        Launch(run);
    }
    catch (...)
    {
        EndRun();
        DropPendingChange();
        throw;
    }
}

void PEstimatedKernel::Launch(PEstimationRun run)
{
    const int size = EstimableSize(settings.size);
    workKernel = floatArray::allocate(size, size);
    fill(workKernel, 0.0f); // what an estimation without a result leaves: no weight, so never reliable

    // The worker gets views of its own: nothing that happens to this object's reaches it.
    std::function<void()> estimation;
    if (settings.estimatorOptions & textEstimator)
    {
        auto made = std::make_unique<kernelEstimatorText>();
        estimation = [worker = made.get(), kernel = workKernel, mask = regionMask, grey = regionGrey,
                      weight = settings.threadWeight,
                      flag = settings.threadFlag] { worker->estimate(kernel, mask, grey, 30, weight, 0.1f, flag); };
        estimator = std::move(made);
    }
    else
    {
        auto made = NewEstimator(home.Parameters(), settings, home);
        estimation = [worker = made.get(), kernel = workKernel, mask = regionMask, grey = regionGrey] {
            worker->estimate(grey, mask, kernel);
        };
        estimator = std::move(made);
    }

    if (run == PEstimationRun::Background)
    {
        control.Queue(std::move(estimation));
        return;
    }
    estimation();
    PollEstimation();
}

void PEstimatedKernel::StopEstimation()
{
    if (!estimator)
        return;
    CancelEstimation();
    control.Wait();
    EndRun();
    DropPendingChange();
}

void PEstimatedKernel::CancelEstimation()
{
    if (!estimator)
        return;
    estimator->cancel();
    control.Withdraw();
}

/// Idle again, with nothing kept of the run; the worker has ended.
void PEstimatedKernel::EndRun()
{
    control.TakeError();
    estimator = nullptr;
    estimationState = 0;
    workKernel = regionGrey = {};
    regionMask = {};
}

bool PEstimatedKernel::PollEstimation()
{
    if (!estimator || control.Running() != 0)
        return false;
    const floatArray found = workKernel;
    const std::exception_ptr failure = control.TakeError();
    EndRun();
    if (timeLog)
        timeLog->Stop();
    timeLog = nullptr;
    if (failure)
    {
        DropPendingChange();
        std::rethrow_exception(failure);
    }

    if (attachment)
        attachment->EstimationFinished();
    kernelImage = found;
    MarkChanged();
    settings.forcedApply = false;
    committedRegion = region;
    if (home.IndexOf(this) >= 0 && IsApplied())
        home.Invalidate(PInvalidation::Normal);
    CommitPending();
    home.Events().EstimationFinished(*this);
    return true;
}

double PEstimatedKernel::Progress() const
{
    return estimator ? estimator->progress() : 1.0;
}

void PEstimatedKernel::RevertEstimation()
{
    StopEstimation();
    if (!HasKernel())
        return;
    region = drawnRegion = committedRegion;
    settings = previousSettings;
}

void PEstimatedKernel::GrowRegion(int size)
{
    const std::int64_t odd = std::int64_t{size} | 1;
    const std::int64_t needed = 3 * odd - std::min(drawnRegion.Width(), drawnRegion.Height());
    region = drawnRegion;
    if (needed <= 0)
        return;
    const Sarnik::CRect bounds = home.Picture().Bounds();
    const std::int64_t by = (needed + 1) / 2;
    std::int64_t left = region.left, top = region.top, right = region.right, bottom = region.bottom;
    GrowAxis(left, right, by, bounds.left, bounds.right);
    GrowAxis(top, bottom, by, bounds.top, bounds.bottom);
    region = {static_cast<int>(left), static_cast<int>(top), static_cast<int>(right), static_cast<int>(bottom)};
}

bool PEstimatedKernel::SetKernelSize(int size, std::uint32_t sourceId)
{
    if (region != Sarnik::CRect{} && size > std::min(region.Width(), region.Height()))
        return false;
    settings.size = size;
    settings.mode = 3;
    drawnRegion = region;
    home.Events().TraceLooksDifferent(*this);
    RecordSettingChange(kMaskMode | kMaskSize, sourceId);
    return true;
}

} // namespace Project
