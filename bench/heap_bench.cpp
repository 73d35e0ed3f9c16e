#include "bench/timing.h"
#include "shell/virtualHeap.h"

#include <benchmark/benchmark.h>

#include <cstdint>
#include <numeric>
#include <span>
#include <vector>

/// Pages through the virtual heap beside the same bytes through plain calls of the system: every page is written once
/// and read once, in order, so that each one has to go out and come back.
namespace
{

using namespace Bench;
using namespace Sarnik;

constexpr std::uint64_t mebibyte = std::uint64_t{1} << 20;

/// Pages of a class: a seeded content for each, and a sum that shows that it is the right one.
void write(std::span<std::uint64_t> words, std::uint64_t page)
{
    std::iota(words.begin(), words.end(), page << 32);
}

bool isPage(std::span<const std::uint64_t> words, std::uint64_t page)
{
    const std::uint64_t count = words.size();
    return std::accumulate(words.begin(), words.end(), std::uint64_t{0}) ==
           (page << 32) * count + count * (count - 1) / 2;
}

struct heapJob
{
    explicit heapJob(const benchmark::State &state)
        : sizeClass(static_cast<int>(state.range(0))),
          pages(static_cast<std::uint64_t>(state.range(1)) * mebibyte / tileBytes(sizeClass)),
          limit(static_cast<std::uint64_t>(state.range(2)) * mebibyte)
    {
    }

    double bytes() const { return 2.0 * static_cast<double>(pages * tileBytes(sizeClass)); }

    int sizeClass;
    std::uint64_t pages;
    std::uint64_t limit;
};

bool runHeap(const heapJob &job)
{
    CVirtualHeap heap;
    heap.SetLimit(job.limit);
    std::vector<VirtualTile *> tiles;
    for (std::uint64_t i = 0; i < job.pages; ++i)
    {
        tiles.push_back(heap.AcquireTile(job.sizeClass, job.sizeClass, job.pages));
        write(heap.Pin(tiles.back(), CPageAccess::overwrite).writableSamples<std::uint64_t>(), i);
    }
    bool good = true;
    for (std::uint64_t i = 0; i < job.pages; ++i)
        good &= isPage(heap.Pin(tiles[i], CPageAccess::read).samples<std::uint64_t>(), i);
    return good && heap.TotalBytes() <= job.limit;
}

bool runPlain(const heapJob &job)
{
    const std::uint64_t size = tileBytes(job.sizeClass);
    Platform::scratchFile file(job.pages * size);
    std::vector<std::uint64_t> buffer(size / sizeof(std::uint64_t));
    for (std::uint64_t i = 0; i < job.pages; ++i)
    {
        write(buffer, i);
        file.write(i * size, buffer.data(), size);
    }
    bool good = true;
    for (std::uint64_t i = 0; i < job.pages; ++i)
    {
        file.read(i * size, buffer.data(), size);
        good &= isPage(buffer, i);
    }
    return good;
}

/// Both in turn, and first in turn, so that a disk that is slower meanwhile, or still busy, slows both.
void heap(benchmark::State &state)
{
    const heapJob job(state);
    std::vector<double> ours, plain;
    const auto timed = [&](bool (*run)(const heapJob &), std::vector<double> &seconds) {
        const stopwatch watch;
        if (!run(job))
            state.SkipWithError("a page came back wrong, or the limit was not kept");
        seconds.push_back(watch.read().wall);
    };
    for ([[maybe_unused]] auto _ : state)
    {
        const bool plainFirst = ours.size() % 2 == 0;
        if (plainFirst)
            timed(runPlain, plain);
        timed(runHeap, ours);
        if (!plainFirst)
            timed(runPlain, plain);
        state.SetIterationTime(ours.back());
    }
    state.counters["MB/s"] = job.bytes() / medianOf(ours) / 1e6;
    state.counters["times_plain"] = medianOf(ours) / medianOf(plain);
}
BENCHMARK(heap)
    ->ArgNames({"class", "MiB", "limit"})
    ->Args({4, 256, 64})
    ->Args({8, 512, 64})
    ->Args({11, 512, 64})
    ->Args({15, 512, 64})
    ->Iterations(9)
    ->UseManualTime()
    ->Unit(benchmark::kMillisecond);

/// The samples of a picture of 600 megapixels, 16 bits, three planes.
BENCHMARK(heap)
    ->Name("heapLarge")
    ->ArgNames({"class", "MiB", "limit"})
    ->Args({11, 3434, 512})
    ->Iterations(3)
    ->UseManualTime()
    ->Unit(benchmark::kMillisecond);

} // namespace
