#pragma once

#include "bench/floor.h"

#include <benchmark/benchmark.h>
#include <tbb/global_control.h>

#include <algorithm>
#include <chrono>
#include <ctime>
#include <optional>
#include <vector>

namespace Bench
{

/// Seconds on the wall, and seconds of processor time. What runs on one thread on an idle machine takes as much of the
/// one as of the other; a busy machine stretches the first.
struct elapsed
{
    double wall = 0.0;
    double cpu = 0.0;
};

/// Whose processor time a stopwatch takes.
enum class cpuClock
{
    process = CLOCK_PROCESS_CPUTIME_ID, ///< all threads together
    thread = CLOCK_THREAD_CPUTIME_ID    ///< the calling thread
};

class stopwatch
{
public:
    explicit stopwatch(cpuClock which = cpuClock::process) : clock(which), cpuStart(cpuSeconds()) {}

    elapsed read() const
    {
        return {std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count(),
                cpuSeconds() - cpuStart};
    }

private:
    double cpuSeconds() const
    {
        timespec time{};
        clock_gettime(static_cast<clockid_t>(clock), &time);
        return static_cast<double>(time.tv_sec) + 1e-9 * static_cast<double>(time.tv_nsec);
    }

    cpuClock clock;
    double cpuStart;
    std::chrono::steady_clock::time_point start = std::chrono::steady_clock::now();
};

double medianOf(std::vector<double> values);

/// Median processor time of a few calls on this thread.
template <typename Body> double medianCpu(const Body &body, int calls = 9)
{
    std::vector<double> seconds;
    for (int i = 0; i < calls; ++i)
    {
        const stopwatch watch(cpuClock::thread);
        body();
        benchmark::ClobberMemory();
        seconds.push_back(watch.read().cpu);
    }
    return medianOf(std::move(seconds));
}

/// Holds the program to a number of threads while it lives; 0 is all there are.
class threadLimit
{
public:
    explicit threadLimit(int threads)
    {
        if (threads > 0)
            control.emplace(tbb::global_control::max_allowed_parallelism, static_cast<std::size_t>(threads));
    }

private:
    std::optional<tbb::global_control> control;
};

/// Runs the iterations of a long job, for benchmarks with UseManualTime; answers the medians of one.
template <typename Body> elapsed timeJob(benchmark::State &state, const Body &body)
{
    std::vector<double> wall, cpu;
    for ([[maybe_unused]] auto _ : state)
    {
        const stopwatch watch;
        body();
        const elapsed one = watch.read();
        state.SetIterationTime(one.wall);
        wall.push_back(one.wall);
        cpu.push_back(one.cpu);
    }
    return {medianOf(std::move(wall)), medianOf(std::move(cpu))};
}

/// Runs the iterations of something short on one thread, for benchmarks with UseRealTime; answers the mean processor
/// time of one.
template <typename Body> double timeLoop(benchmark::State &state, const Body &body)
{
    const stopwatch watch(cpuClock::thread);
    for ([[maybe_unused]] auto _ : state)
    {
        body();
        benchmark::ClobberMemory();
    }
    return watch.read().cpu / static_cast<double>(std::max<benchmark::IterationCount>(state.iterations(), 1));
}

/// The floor of a job, taken before and after it: a machine that grew slower meanwhile shows less in the ratio.
class floorRatio
{
public:
    explicit floorRatio(std::vector<transformCount> transforms);

    /// Counters floor_ratio (wall time over FFTW's floor), own_floor_ratio (over that of the engine's transforms) and
    /// cpu_floor_ratio (processor time over FFTW's floor). On one thread the last one is to be near the first, or the
    /// machine was busy.
    void report(benchmark::State &state, const elapsed &time) const;
    /// Only the first two, for something short on one thread, from its processor time.
    void report(benchmark::State &state, double cpuSeconds) const;

private:
    floorSeconds meanFloor() const;

    std::vector<transformCount> job;
    floorSeconds before;
};

/// Counter Mpixel/s
void reportPixels(benchmark::State &state, double pixels, double seconds);

} // namespace Bench
