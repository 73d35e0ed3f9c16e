#include "bench/timing.h"
#include "framework/pixels/fills.h"
#include "framework/pixels/maskBlend.h"
#include "framework/pixels/sixteenBit.h"
#include "framework/pixels/toGrey.h"

#include <cstring>
#include <random>

/// Conversions and fills of the host's pixels, one thread: a tile that lies in the cache and a picture that does not.
/// Counter times_memcpy: time over that of a memcpy that moves as many bytes (half of those read and written).
namespace
{

using namespace Bench;
using namespace Sarnik;

/// Random samples, of the host's range where they are 16 bits, floats in 0..1.
void drawNoise(CMemoryPixmap &pixmap)
{
    std::mt19937 random(1);
    const CRect r = pixmap.Bounds();
    for (int p = 0; p < pixmap.GetPlaneCount(); ++p)
        for (std::int32_t y = r.top; y < r.bottom; ++y)
            for (int x = 0; x < r.Width(); ++x)
                if (pixmap.GetDepth() == 8)
                    pixmap.Plane(p).Row<std::uint8_t>(y)[x] = static_cast<std::uint8_t>(random());
                else if (pixmap.GetDepth() == 16)
                    pixmap.Plane(p).Row<std::uint16_t>(y)[x] = static_cast<std::uint16_t>(random() % 32769);
                else
                    pixmap.Plane(p).Row<float>(y)[x] = static_cast<float>(random() % 4096) / 4095.0f;
}

/// bytesPerPixel: read and written.
void report(benchmark::State &state, double seconds, double bytesPerPixel)
{
    const double pixels = static_cast<double>(state.range(0)) * static_cast<double>(state.range(0));
    const auto bytes = static_cast<std::size_t>(pixels * bytesPerPixel / 2);
    std::vector<char> from(bytes, 1), to(bytes, 2);
    const double copy = medianCpu([&] { std::memcpy(to.data(), from.data(), bytes); }, 25);
    state.counters["times_memcpy"] = seconds / copy;
    reportPixels(state, pixels, seconds);
}

void sides(benchmark::internal::Benchmark *bench)
{
    bench->ArgNames({"side", "depth"})
        ->ArgsProduct({{512, 3000}, {8, 16, 32}})
        ->UseRealTime()
        ->Unit(benchmark::kMicrosecond);
}

void wholeSides(benchmark::internal::Benchmark *bench)
{
    bench->ArgNames({"side", "depth"})
        ->ArgsProduct({{512, 3000}, {8, 16}})
        ->UseRealTime()
        ->Unit(benchmark::kMicrosecond);
}

void greyBench(benchmark::State &state, CPixelKind kind, int colours, bool masked)
{
    const auto side = static_cast<std::int32_t>(state.range(0));
    const auto depth = static_cast<int>(state.range(1));
    CMemoryPixmap source(side, side, depth, colours + 1), grey(side, side, 64, 1), mask(side, side, 8, 1);
    drawNoise(source);
    const CGreySource about{kind, false, nullptr, CMaskLimits::of(250)};
    const double seconds =
        timeLoop(state, [&] { ToGrey(source, source.Bounds(), about, grey, masked ? &mask : nullptr); });
    report(state, seconds, colours * depth / 8.0 + sizeof(double) + masked);
}

void pixelsGreyOfRgb(benchmark::State &state)
{
    greyBench(state, CPixelKind::rgb, 3, false);
}
BENCHMARK(pixelsGreyOfRgb)->Apply(sides);
void pixelsGreyOfRgbWithMask(benchmark::State &state)
{
    greyBench(state, CPixelKind::rgb, 3, true);
}
BENCHMARK(pixelsGreyOfRgbWithMask)->Apply(sides);
void pixelsGreyOfGrey(benchmark::State &state)
{
    greyBench(state, CPixelKind::grey, 1, false);
}
BENCHMARK(pixelsGreyOfGrey)->Apply(sides);
/// Interleaving included, the host's colour conversion not.
void pixelsGreyOfCmyk(benchmark::State &state)
{
    greyBench(state, CPixelKind::cmyk, 4, false);
}
BENCHMARK(pixelsGreyOfCmyk)->Apply(wholeSides);

/// To 0..65535 and back, in place.
void pixelsExpandAndCompress(benchmark::State &state)
{
    const auto side = static_cast<std::int32_t>(state.range(0));
    CMemoryPixmap pixmap(side, side, 16, 3);
    drawNoise(pixmap);
    const double seconds = timeLoop(state, [&] {
        expandSixteenBit(pixmap, 3);
        compressSixteenBit(pixmap, 3);
    });
    report(state, seconds, 2 * 3 * 4.0);
}
BENCHMARK(pixelsExpandAndCompress)->ArgName("side")->Arg(512)->Arg(3000)->UseRealTime()->Unit(benchmark::kMicrosecond);

void pixelsBlendByMask(benchmark::State &state)
{
    const auto side = static_cast<std::int32_t>(state.range(0));
    const auto depth = static_cast<int>(state.range(1));
    CMemoryPixmap source(side, side, depth, 4), result(side, side, depth, 3);
    drawNoise(source);
    drawNoise(result);
    const double seconds = timeLoop(state, [&] { blendByMask(result, source, 3, 3); });
    report(state, seconds, (4 + 3 + 3) * depth / 8.0);
}
BENCHMARK(pixelsBlendByMask)->Apply(sides);

/// A plane filled and then replicated from a quarter of it in the middle. Nearly nothing is read: the memcpy beside it
/// moves as much as is written.
void pixelsFill(benchmark::State &state)
{
    const auto side = static_cast<std::int32_t>(state.range(0));
    const auto depth = static_cast<int>(state.range(1));
    CMemoryPixmap pixmap(side, side, depth, 1);
    const CRect inner{side / 4, side / 4, 3 * side / 4, 3 * side / 4};
    const double seconds = timeLoop(state, [&] {
        fillArea(pixmap, 0, pixmap.Bounds(), 77);
        replicateBorder(pixmap, 0, inner);
    });
    report(state, seconds, 1.75 * 2 * depth / 8.0);
}
BENCHMARK(pixelsFill)->Apply(sides);

} // namespace
