#include "bench/scenes.h"
#include "bench/timing.h"
#include "bench/transformTally.h"
#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/kernelEstimator.h"
#include "tests/reference/literalEstimator.h"

/// Whole kernel estimations at the low noise figure, with which every pass of every level runs.
namespace
{

using namespace Bench;
using namespace CorvaneDeblur;

constexpr unsigned seed = 41;
constexpr int passes = 7; // of a level

/// Whether it ran through.
bool estimateOnce(const floatArray &image, const floatArray &kernel)
{
    kernelEstimator estimator;
    estimator.noise = noiseMode::low;
    estimator.iterations = passes;
    estimator.estimate(image, byteArray(), kernel);
    return estimator.status() == estimateStatus::finished;
}

elapsed timeEstimation(benchmark::State &state, const floatArray &image, int size)
{
    const floatArray kernel = floatArray::allocate(size, size);
    bool finished = true;
    const elapsed time = timeJob(state, [&] { finished = estimateOnce(image, kernel) && finished; });
    if (!finished)
        state.SkipWithError("the estimation failed");
    reportPixels(state, static_cast<double>(image.rows) * image.cols, time.wall);
    return time;
}

/// threads 0 is all there are.
void estimation(benchmark::State &state)
{
    const int side = static_cast<int>(state.range(0)), size = static_cast<int>(state.range(1));
    const floatArray image = shakenScene(side, side, 1, size, seed)[0];
    const floorRatio floor(transformsOfEstimation(side, side, size, passes));
    const threadLimit limit(static_cast<int>(state.range(2)));
    floor.report(state, timeEstimation(state, image, size));
}
BENCHMARK(estimation)
    ->ArgNames({"side", "size", "threads"})
    ->ArgsProduct({{600, 1500}, {31, 45, 99}, {1, 0}})
    ->UseManualTime()
    ->Iterations(3)
    ->Unit(benchmark::kMillisecond);

/// The same beside the literal form, one thread. Counter times_literal: the literal form's time over ours.
void estimationBesideLiteral(benchmark::State &state)
{
    const int side = static_cast<int>(state.range(0)), size = static_cast<int>(state.range(1));
    const threadLimit one(1);
    const floatArray image = shakenScene(side, side, 1, size, seed)[0];
    const elapsed time = timeEstimation(state, image, size);

    Reference::estimatorSettings settings;
    settings.sigma = 1.0f / 255.0f;
    settings.trackFinestLevels = false;
    settings.iterations = passes;
    const floatArray weights = floatArray::allocate(side, side), kernel = floatArray::allocate(size, size);
    fill(weights, 1.0f);
    const stopwatch watch;
    Reference::literalEstimate(settings, image, weights, kernel);
    state.counters["times_literal"] = watch.read().cpu / time.cpu;
}
BENCHMARK(estimationBesideLiteral)
    ->ArgNames({"side", "size"})
    ->Args({600, 31})
    ->Args({600, 45})
    ->Args({1500, 45})
    ->UseManualTime()
    ->Iterations(3)
    ->Unit(benchmark::kMillisecond);

} // namespace
