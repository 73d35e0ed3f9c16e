#include "bench/floor.h"
#include "bench/timing.h"
#include "platform/math/alignedBuffer.h"
#include "platform/math/realTransform2d.h"
#include "platform/math/sineTransform.h"

/// The engine's transforms beside FFTW's own, on grids of the sizes that jobs use: even and odd, with small and with
/// large prime factors.
namespace
{

using namespace Bench;
using namespace CorvaneDeblur;

enum class way
{
    there,
    back
};

/// Counter fftw_ratio: below 1 where ours is the faster.
void transform(benchmark::State &state, way which)
{
    const threadLimit one(1);
    const int rows = static_cast<int>(state.range(0)), cols = static_cast<int>(state.range(1));
    const floorSeconds fftw = measureFloor({{rows, cols, which == way::there ? 1 : 0, which == way::there ? 0 : 1}});

    const realTransform2d grid(rows, cols, workers::one);
    const alignedBuffer<float> samples(static_cast<std::size_t>(rows) * static_cast<std::size_t>(cols));
    const pieceSpectrum start(grid.spectrumCount()), spectrum(grid.spectrumCount());
    std::fill_n(samples.data(), samples.count(), 0.25f);
    grid.forward(samples.data(), cols, start.data());
    const double seconds = which == way::there
                               ? timeLoop(state, [&] { grid.forward(samples.data(), cols, spectrum.data()); })
                               : timeLoop(state, [&] {
                                     std::copy_n(start.data(), start.count(), spectrum.data()); // it is overwritten
                                     grid.inverse(spectrum.data(), samples.data(), cols, 1.0f);
                                 });
    reportPixels(state, static_cast<double>(rows) * cols, seconds);
    state.counters["fftw_ratio"] = seconds / fftw.fftw;
}

void gridSizes(benchmark::internal::Benchmark *bench)
{
    bench->ArgNames({"rows", "cols"});
    for (const int side : {90, 198, 360, 630, 735, 750, 1024})
        bench->Args({side, side});
    bench->Args({1617, 1600});
    bench->Args({1600, 1617});
    bench->UseRealTime()->Unit(benchmark::kMicrosecond);
}

BENCHMARK_CAPTURE(transform, forward, way::there)->Apply(gridSizes);
BENCHMARK_CAPTURE(transform, inverse, way::back)->Apply(gridSizes);

/// The strips of a periodic extension: long and a few dozen samples wide.
void sineTransformOfStrip(benchmark::State &state)
{
    const threadLimit one(1);
    const int length = static_cast<int>(state.range(0)), count = static_cast<int>(state.range(1));
    const sineTransform transformer(length);
    const alignedBuffer<float> samples(static_cast<std::size_t>(length) * static_cast<std::size_t>(count));
    std::fill_n(samples.data(), samples.count(), 0.25f);
    // There and back: the values stay what they are.
    const float scale = 2.0f / static_cast<float>(length + 1);
    const double seconds = timeLoop(state, [&] {
        transformer.run(samples.data(), count, count, 1.0f);
        transformer.run(samples.data(), count, count, scale);
    });
    reportPixels(state, 2.0 * length * count, seconds);
}
BENCHMARK(sineTransformOfStrip)
    ->ArgNames({"length", "count"})
    ->Args({56, 748})
    ->Args({748, 56})
    ->Args({43, 1598})
    ->UseRealTime()
    ->Unit(benchmark::kMicrosecond);

} // namespace
