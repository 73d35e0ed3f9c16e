#include "bench/scenes.h"
#include "bench/timing.h"
#include "deblur/deconv/extendPeriodic.h"
#include "deblur/deconv/fastSize.h"
#include "deblur/deconv/gradientSweep.h"
#include "deblur/deconv/planeSamples.h"
#include "deblur/deconv/shrinkageLookup.h"
#include "deblur/estimate/edgeFilters.h"
#include "deblur/estimate/filters.h"
#include "deblur/estimate/gradientPredictor.h"
#include "deblur/estimate/resample.h"
#include "platform/math/realTransform2d.h"
#include "tests/support/synthetic.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <numbers>

/// Hot loops over pictures, one thread. Counter times_memcpy: time over that of copying the picture's floats once,
/// which says what a sweep is worth and shows a loop that stops vectorising.
namespace
{

using namespace Bench;
using namespace CorvaneDeblur;

constexpr unsigned seed = 11;
constexpr int kernelSize = 45;

/// Pictures of one benchmark: input, two arrays for results.
struct pictures
{
    explicit pictures(const benchmark::State &state)
        : side(static_cast<int>(state.range(0))), in(shakenScene(side, side, 1, kernelSize, seed)[0]),
          a(TestSupport::noiseImage(side, side, seed)), b(TestSupport::noiseImage(side, side, seed))
    {
    }

    int side;
    floatArray in, a, b;
    threadLimit one{1};
};

void reportSweep(benchmark::State &state, const pictures &p, double seconds)
{
    const std::size_t count = static_cast<std::size_t>(p.side) * static_cast<std::size_t>(p.side);
    const double copy = medianCpu([&] { std::memcpy(p.a.data, p.in.data, count * sizeof(float)); });
    reportPixels(state, static_cast<double>(count), seconds);
    state.counters["times_memcpy"] = seconds / copy;
}

void sides(benchmark::internal::Benchmark *bench)
{
    bench->ArgName("side")->Arg(600)->Arg(1500)->UseRealTime()->Unit(benchmark::kMicrosecond);
}

void sweepBilateral(benchmark::State &state)
{
    const pictures p(state);
    // As the gradient predictor calls it in the first pass.
    reportSweep(state, p, timeLoop(state, [&] { bilateralFilter(p.in, p.a, 2.0f, 0.5f, 2, workers::one); }));
}
BENCHMARK(sweepBilateral)->Apply(sides);

void sweepShock(benchmark::State &state)
{
    const pictures p(state);
    reportSweep(state, p, timeLoop(state, [&] { shockFilter(p.in, p.a, 1.0f, workers::one); }));
}
BENCHMARK(sweepShock)->Apply(sides);

void sweepBoxSum(benchmark::State &state)
{
    const pictures p(state);
    reportSweep(state, p, timeLoop(state, [&] { boxSum(p.in, p.a, kernelSize / 2); }));
}
BENCHMARK(sweepBoxSum)->Apply(sides);

void sweepOrientationThreshold(benchmark::State &state)
{
    const pictures p(state);
    const floatArray magnitude = floatArray::allocate(p.side, p.side);
    forwardDiffX(p.in, p.a);
    forwardDiffY(p.in, p.b);
    for (int y = 0; y < p.side; ++y)
        for (int x = 0; x < p.side; ++x)
            magnitude.at(y, x) = std::hypot(p.a.at(y, x), p.b.at(y, x));
    reportSweep(state, p, timeLoop(state, [&] {
                    benchmark::DoNotOptimize(
                        orientationThreshold(p.a, p.b, magnitude, 2 * kernelSize, std::numbers::sqrt2_v<float>));
                }));
}
BENCHMARK(sweepOrientationThreshold)->Apply(sides);

/// A whole prediction: bilateral, shock, differences, selection; every call but the first, which has the threshold's
/// histogram on top.
void sweepPredict(benchmark::State &state)
{
    const pictures p(state);
    const floatArray weights = floatArray::allocate(p.side, p.side);
    std::fill_n(weights.data, static_cast<std::ptrdiff_t>(p.side) * p.side, 1.0f);
    gradientPredictor predictor(p.side, p.side, kernelSize, kernelSize, weights, workers::one);
    predictor.predict(p.in, p.a, p.b);
    reportSweep(state, p, timeLoop(state, [&] { predictor.predict(p.in, p.a, p.b); }));
}
BENCHMARK(sweepPredict)->Apply(sides);

/// To the next coarser level and back.
void sweepResize(benchmark::State &state)
{
    const pictures p(state);
    const int smaller = static_cast<int>(0.7071f * static_cast<float>(p.side));
    const floatArray coarse = floatArray::allocate(smaller, smaller);
    reportSweep(state, p, timeLoop(state, [&] {
                    resize(p.in, coarse);
                    resize(coarse, p.a);
                }));
}
BENCHMARK(sweepResize)->Apply(sides);

/// Shrinkage of one difference, at the first and the last beta: early tables are zero nearly everywhere.
void sweepShrinkage(benchmark::State &state)
{
    const pictures p(state);
    const shrinkageTable table = buildShrinkageTable(static_cast<float>(state.range(1)), 2.0f / 3.0f);
    const differenceShrinker shrinker(table);
    reportSweep(state, p, timeLoop(state, [&] {
                    for (int y = 0; y < p.side; ++y)
                        shrinker.run(p.in.row(y), p.in.row(y) + 1, p.a.row(y), p.side - 1);
                }));
}
BENCHMARK(sweepShrinkage)
    ->ArgNames({"side", "beta"})
    ->ArgsProduct({{750}, {1, 8, 181}})
    ->UseRealTime()
    ->Unit(benchmark::kMicrosecond);

/// Differences, shrinkage, adjoint and the row transforms of the sum. Counter times_rows: over the row transforms
/// alone.
void sweepShrunkGradients(benchmark::State &state)
{
    const pictures p(state);
    const shrinkageTable table = buildShrinkageTable(static_cast<float>(state.range(1)), 2.0f / 3.0f);
    const realTransform2d grid(p.side, p.side, workers::one);
    const pieceSpectrum spectrum(grid.spectrumCount());
    const double seconds =
        timeLoop(state, [&] { shrunkGradientRows(grid, p.in, table, spectrum.data(), workers::one); });
    reportSweep(state, p, seconds);

    const double rows =
        medianCpu([&] { grid.forwardRows(p.in.data, p.in.stride, p.side, 0, p.side, spectrum.data()); });
    state.counters["times_rows"] = seconds / rows;
}
BENCHMARK(sweepShrunkGradients)
    ->ArgNames({"side", "beta"})
    ->ArgsProduct({{750}, {1, 8, 181}})
    ->UseRealTime()
    ->Unit(benchmark::kMicrosecond);

void sweepExtendPeriodic(benchmark::State &state)
{
    const pictures p(state);
    const int grown = fastSize(p.side + kernelSize - 1);
    const floatArray extended = floatArray::allocate(grown, grown);
    reportSweep(state, p, timeLoop(state, [&] { extendPeriodic(p.in, extended); }));
}
BENCHMARK(sweepExtendPeriodic)->Apply(sides);

void sweepTaperedExtension(benchmark::State &state)
{
    const pictures p(state);
    const int grown = fastSize(p.side + kernelSize - 1);
    const floatArray extended = floatArray::allocate(grown, grown);
    reportSweep(state, p, timeLoop(state, [&] { taperedExtension(p.in, extended, kernelSize, kernelSize); }));
}
BENCHMARK(sweepTaperedExtension)->Apply(sides);

/// Picture samples to intensities and back, at 8, 16 and 32 bits.
void sweepPlaneSamples(benchmark::State &state)
{
    const pictures p(state);
    const int depth = static_cast<int>(state.range(1));
    const std::ptrdiff_t rowBytes = static_cast<std::ptrdiff_t>(p.side) * depth / 8;
    std::vector<std::byte> memory(static_cast<std::size_t>(rowBytes * p.side));
    writePlane(p.in, memory.data(), 0, rowBytes, depth);
    reportSweep(state, p, timeLoop(state, [&] {
                    readPlane(memory.data(), p.a, 0, rowBytes, depth);
                    writePlane(p.a, memory.data(), 0, rowBytes, depth);
                }));
}
BENCHMARK(sweepPlaneSamples)
    ->ArgNames({"side", "depth"})
    ->ArgsProduct({{600}, {8, 16, 32}})
    ->UseRealTime()
    ->Unit(benchmark::kMicrosecond);

} // namespace
