#pragma once

#include "bench/floor.h"

#include <benchmark/benchmark.h>
#include <tbb/global_control.h>

#include <algorithm>
#include <chrono>
#include <optional>
#include <vector>

namespace Bench
{

class stopwatch
{
public:
    double seconds() const { return std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count(); }

private:
    std::chrono::steady_clock::time_point start = std::chrono::steady_clock::now();
};

inline double medianOf(std::vector<double> values)
{
    if (values.empty())
        return 0.0;
    std::sort(values.begin(), values.end());
    const std::size_t half = values.size() / 2;
    return values.size() % 2 == 1 ? values[half] : 0.5 * (values[half - 1] + values[half]);
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

/// Runs the iterations of a long job, for benchmarks with UseManualTime; answers the median of one in seconds.
template <typename Body> double timeJob(benchmark::State &state, const Body &body)
{
    std::vector<double> seconds;
    for ([[maybe_unused]] auto _ : state)
    {
        const stopwatch watch;
        body();
        seconds.push_back(watch.seconds());
        state.SetIterationTime(seconds.back());
    }
    return medianOf(std::move(seconds));
}

/// Runs the iterations of something short, for benchmarks with UseRealTime; answers the mean of one in seconds.
template <typename Body> double timeLoop(benchmark::State &state, const Body &body)
{
    const stopwatch watch;
    for ([[maybe_unused]] auto _ : state)
    {
        body();
        benchmark::ClobberMemory();
    }
    return watch.seconds() / static_cast<double>(std::max<benchmark::IterationCount>(state.iterations(), 1));
}

/// The floor of a job, taken before and after it: a machine that grew slower meanwhile shows less in the ratio.
class floorRatio
{
public:
    explicit floorRatio(std::vector<transformCount> transforms)
        : job(std::move(transforms)), before(measureFloor(job))
    {
    }

    /// Counters floor_ratio and own_floor_ratio of a job that took `seconds`.
    void report(benchmark::State &state, double seconds) const
    {
        const floorSeconds after = measureFloor(job);
        state.counters["floor_ratio"] = seconds / (0.5 * (before.fftw + after.fftw));
        state.counters["own_floor_ratio"] = seconds / (0.5 * (before.own + after.own));
    }

private:
    std::vector<transformCount> job;
    floorSeconds before;
};

/// Counter Mpixel/s
inline void reportPixels(benchmark::State &state, double pixels, double seconds)
{
    state.counters["Mpixel/s"] = pixels / seconds * 1e-6;
}

} // namespace Bench
