#include "bench/timing.h"

#include <utility>

namespace Bench
{

double medianOf(std::vector<double> values)
{
    if (values.empty())
        return 0.0;
    std::sort(values.begin(), values.end());
    const std::size_t half = values.size() / 2;
    return values.size() % 2 == 1 ? values[half] : 0.5 * (values[half - 1] + values[half]);
}

floorRatio::floorRatio(std::vector<transformCount> transforms) : job(std::move(transforms)), before(measureFloor(job))
{
}

floorSeconds floorRatio::meanFloor() const
{
    const floorSeconds after = measureFloor(job);
    return {0.5 * (before.fftw + after.fftw), 0.5 * (before.own + after.own)};
}

void floorRatio::report(benchmark::State &state, const elapsed &time) const
{
    const floorSeconds floor = meanFloor();
    state.counters["floor_ratio"] = time.wall / floor.fftw;
    state.counters["own_floor_ratio"] = time.wall / floor.own;
    state.counters["cpu_floor_ratio"] = time.cpu / floor.fftw;
}

void floorRatio::report(benchmark::State &state, double cpuSeconds) const
{
    const floorSeconds floor = meanFloor();
    state.counters["floor_ratio"] = cpuSeconds / floor.fftw;
    state.counters["own_floor_ratio"] = cpuSeconds / floor.own;
}

void reportPixels(benchmark::State &state, double pixels, double seconds)
{
    state.counters["Mpixel/s"] = pixels / seconds * 1e-6;
}

} // namespace Bench
