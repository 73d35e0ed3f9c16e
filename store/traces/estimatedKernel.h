#pragma once

#include "deblur/estimate/kernelEstimator.h"
#include "store/timeLog.h"
#include "store/traces/ctrlThread.h"
#include "store/traces/kernel.h"

#include <memory>

namespace Project
{

/// Larger settings are estimated as this: about what the measure of the blur's size answers at most. What a file asks
/// for beyond that would take hours.
constexpr int kLargestEstimate = 399;

CorvaneDeblur::noiseMode NoiseModeOf(const KernelSettings &settings);

/// Where an estimation runs.
enum class PEstimationRun
{
    Here,      ///< on the calling thread, to its end
    Background ///< on the pool; PollEstimation fetches the result
};

/// A trace whose kernel is estimated from its region. Several of them estimate at the same time; the worker touches
/// only the arrays and the estimator made for it. A kernel that is finished is never written again.
class PEstimatedKernel final : public PKernel
{
public:
    PEstimatedKernel(PKernelCollection &home, const Sarnik::CRect &region, const KernelSettings &settings);
    PEstimatedKernel(PKernelCollection &home, const PTraceRecord &record);
    PEstimatedKernel(const PEstimatedKernel &other);
    ~PEstimatedKernel() override;

    int EstimationState() const override { return estimationState; }
    void SetEstimationState(int state) override { estimationState = state; }
    PKernelKind KernelType() const override { return PKernelKind::Estimated; }
    std::unique_ptr<PKernel> Copy() const override { return std::make_unique<PEstimatedKernel>(*this); }

    /// Reads the region (the whole picture if it is empty) and starts; a run that is under way is cancelled first. The
    /// settings as they are now count. A region outside of the picture starts nothing. Throws what reading throws, and
    /// is idle then.
    void StartEstimation(PEstimationRun run);
    /// An estimation has been started and neither stopped nor fetched.
    bool Busy() const { return estimator != nullptr; }
    /// Asks the run to stop and waits for nothing: before StopEstimation, where several traces are to be stopped.
    void CancelEstimation();
    /// Cancels; returns when the worker has stopped, after one alternation of its level at most. Nothing of the run is
    /// kept, and no record of the change that it was to answer.
    void StopEstimation();
    /// To be called from time to time while estimating. True when an estimation has just finished: the trace has its
    /// kernel then (all zero, so not reliable, when the region is smaller than three times the kernel or has no
    /// structure). Throws when the worker ran out of memory; the trace is idle then and has its old kernel.
    bool PollEstimation();
    /// Waits until the worker has ended; PollEstimation then finishes.
    void Join() const { control.Wait(); }
    /// The same for a limited time; false when the worker is still busy.
    bool JoinFor(std::chrono::milliseconds time) const { return control.WaitFor(time); }
    /// Share of the estimation that is done, 0..1; 1 when none is under way.
    double Progress() const;
    /// Stops, and goes back to the region and the settings of the last finished estimation, if there was one.
    void RevertEstimation();

    /// Makes the region at least three times `size` a side, around the drawn region and within the picture.
    void GrowRegion(int size);
    /// False, with nothing changed, when the region's smaller side is below `size`; an empty region (the whole
    /// picture) takes any.
    bool SetKernelSize(int size, std::uint32_t sourceId);

private:
    void Launch(PEstimationRun run);
    void EndRun();

    int estimationState = 0;
    CorvaneDeblur::floatArray workKernel, regionGrey;
    CorvaneDeblur::byteArray regionMask;
    std::unique_ptr<CorvaneDeblur::kernelEstimatorThread> estimator;
    std::unique_ptr<PTimeLogger> timeLog;
    PCtrlThread control; ///< last: its end waits for the worker
};

} // namespace Project
