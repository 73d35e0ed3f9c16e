#include "cli/traceEstimation.h"

#include "cli/greyOfPhoto.h"
#include "cli/stopSignal.h"
#include "cli/traceRegion.h"
#include "deblur/estimate/imageStructure.h"
#include "deblur/estimate/kernelMeasures.h"
#include "deblur/estimate/kernelPyramid.h"

#include <tbb/parallel_for.h>
#include <tbb/task_arena.h>

#include <algorithm>
#include <condition_variable>
#include <deque>
#include <thread>

namespace Stillmark
{
namespace
{

using namespace CorvaneDeblur;

/// While it lives: shows the mean progress of the estimators, and cancels them after Ctrl-C.
class estimationWatch
{
public:
    estimationWatch(std::deque<kernelEstimator> &estimators, progressBar &bar)
        : watcher([this, &estimators, &bar](std::stop_token ended) { watch(estimators, bar, ended); })
    {
    }

private:
    void watch(std::deque<kernelEstimator> &estimators, progressBar &bar, const std::stop_token &ended)
    {
        std::unique_lock hold(lock);
        while (!ended.stop_requested())
        {
            wake.wait_for(hold, ended, std::chrono::milliseconds(50), [] { return false; });
            double sum = 0;
            for (kernelEstimator &estimator : estimators)
            {
                if (stopSignal::requested())
                    estimator.cancel();
                sum += estimator.progress();
            }
            bar.set(sum / static_cast<double>(estimators.size()));
        }
    }

    std::mutex lock;
    std::condition_variable_any wake;
    std::jthread watcher; ///< last: ends before the others go
};

void apply(const estimationSettings &settings, kernelEstimator &estimator)
{
    estimator.noise = settings.noise;
    estimator.noiseLevel = settings.noiseLevel;
    estimator.randomKernelLevel = settings.seedLevels;
    estimator.pyramidLevel = settings.skipLevels;
    estimator.derivativesOrder = settings.secondOrder ? 1 : 0;
    estimator.imageToKernelRatio = imageToKernelRatio;
}

void judge(const floatArray &kernel, foundTrace &trace)
{
    trace.kernel = kernel;
    trace.sparsity = kernelSparsity(kernel);
    trace.good = isGoodKernel(kernel);
    trace.point = isPointKernel(kernel);
    trace.cut = borderShare(kernel) > 0.05;
}

bool isZero(const floatArray &kernel)
{
    for (int y = 0; y < kernel.rows; ++y)
        if (std::any_of(kernel.row(y), kernel.row(y) + kernel.cols, [](float v) { return v != 0.0f; }))
            return false;
    return true;
}

foundTrace estimateTrace(const photo &picture, const rectangle &region, int size, int maskThreshold,
                         kernelEstimator &estimator)
{
    foundTrace trace;
    trace.region = region;
    trace.size = size;

    greyOfPhoto source(picture);
    const auto grey = floatArray::allocate(region.height, region.width);
    source.readGrey(toEngine(region), grey);
    if (!hasStructure(grey, size))
    {
        trace.status = estimateStatus::noStructure;
        return trace;
    }

    const auto kernel = floatArray::allocate(size, size);
    estimator.estimate(grey, source.readMask(toEngine(region), maskThreshold), kernel);
    trace.status = estimator.status();
    if (trace.status == estimateStatus::finished)
    {
        const auto levels = buildPyramid(size, size, pyramidScale, pyramidMinimum, estimator.pyramidLevel);
        trace.levels = static_cast<int>(levels.size());
        judge(kernel, trace);
    }
    return trace;
}

} // namespace

std::vector<foundTrace> estimateTraces(const photo &picture, const std::vector<rectangle> &regions, int size,
                                       const estimationSettings &settings, runContext &context)
{
    context.bar.stage("Finding the blur");
    std::deque<kernelEstimator> estimators(regions.size());
    for (kernelEstimator &estimator : estimators)
        apply(settings, estimator);

    std::vector<foundTrace> traces(regions.size());
    {
        const estimationWatch watch(estimators, context.bar);
        tbb::parallel_for(std::size_t{0}, regions.size(), [&](std::size_t i) {
            // Isolated: a thread that waits inside one estimation must not begin another on top of it.
            tbb::this_task_arena::isolate([&] {
                if (!stopSignal::requested())
                    traces[i] = estimateTrace(picture, regions[i], size, settings.maskThreshold, estimators[i]);
            });
        });
    }
    stopSignal::check();
    return traces;
}

foundTrace judgeTrace(const rectangle &region, int size, const floatArray &kernel)
{
    foundTrace trace;
    trace.region = region;
    trace.size = size;
    if (!isZero(kernel))
        judge(kernel, trace);
    else if (std::min(region.width, region.height) < imageToKernelRatio * size && region.width != 0)
        trace.status = estimateStatus::imageTooSmall;
    else
        trace.status = estimateStatus::noStructure;
    return trace;
}

std::string complaintAbout(const foundTrace &trace)
{
    switch (trace.status)
    {
    case estimateStatus::finished:
        if (trace.point)
            return "nothing seems to have moved: the blur found there is a point";
        return trace.good ? "" : "the blur found there is judged poor";
    case estimateStatus::imageTooSmall:
        return "it is too small for a blur of " + std::to_string(trace.size) + " pixels";
    case estimateStatus::noStructure:
        return "no structure found: there are no edges to see a blur by";
    case estimateStatus::noSeedFits:
        return "none of the first shapes fits a level; try fewer seed levels";
    case estimateStatus::cancelled:
        break;
    }
    return "the estimation was cancelled";
}

} // namespace Stillmark
