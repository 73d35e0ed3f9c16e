#include "bench/timing.h"
#include "platform/math/alignedBuffer.h"
#include "platform/math/vectorOps.h"

#include <cstring>
#include <string>

/// Element-wise operations beside memcpy. Counter times_memcpy: time for a byte read or written over memcpy's, in the
/// same place (cache or memory). A loop that stops vectorising shows as a jump of it in the cache, by a factor of 4 to
/// 8; in memory the loops of few operations stay near 1.
namespace
{

using namespace Bench;
using namespace CorvaneDeblur;

/// Four arrays, enough for complex samples.
struct operands
{
    explicit operands(std::size_t samples) : n(samples)
    {
        for (auto &array : arrays)
        {
            array = alignedBuffer<float>(2 * n);
            for (std::size_t i = 0; i < 2 * n; ++i)
                array[i] = 0.25f + 0.5f * static_cast<float>(i % 31) / 31.0f;
        }
    }

    float *real(int i) const { return arrays[i].data(); }
    complexSample *complex(int i) const { return reinterpret_cast<complexSample *>(arrays[i].data()); }

    std::size_t n;

private:
    alignedBuffer<float> arrays[3];
};

struct operation
{
    const char *name;
    int floatsMoved; ///< read and written, for each element
    void (*run)(const operands &);
};

const operation operations[] = {
    {"vsAdd", 3, [](const operands &o) { vsAdd(o.n, o.real(0), o.real(1), o.real(2)); }},
    {"vsMul", 3, [](const operands &o) { vsMul(o.n, o.real(0), o.real(1), o.real(2)); }},
    {"vsHypot", 3, [](const operands &o) { vsHypot(o.n, o.real(0), o.real(1), o.real(2)); }},
    {"vsExp", 2, [](const operands &o) { vsExp(o.n, o.real(0), o.real(2)); }},
    {"sscal", 2, [](const operands &o) { sscal(o.n, 0.5f, o.real(0), o.real(2)); }},
    {"saxpy", 3, [](const operands &o) { saxpy(o.n, 1e-7f, o.real(0), o.real(2)); }},
    {"saxpby", 3, [](const operands &o) { saxpby(o.n, 0.5f, o.real(0), 0.5f, o.real(1), o.real(2)); }},
    {"sdot", 2, [](const operands &o) { benchmark::DoNotOptimize(sdot(o.n, o.real(0), o.real(1))); }},
    {"sasum", 1, [](const operands &o) { benchmark::DoNotOptimize(sasum(o.n, o.real(0))); }},
    {"isamax", 1, [](const operands &o) { benchmark::DoNotOptimize(isamax(o.n, o.real(0))); }},
    {"smax", 1, [](const operands &o) { benchmark::DoNotOptimize(smax(o.n, o.real(0), 0.0f)); }},
    {"vcMul", 6,
     [](const operands &o) {
         vcMul(o.n, o.complex(0), o.complex(1), {0.5f, 0.5f}, o.complex(2));
     }},
    {"vcMulByConj", 6, [](const operands &o) { vcMulByConj(o.n, o.complex(0), o.complex(1), o.complex(2)); }},
    {"vcMulByReal", 5, [](const operands &o) { vcMulByReal(o.n, o.complex(0), o.real(1), o.complex(2)); }},
};

/// Seconds of memcpy for a byte read or written, between arrays of n samples.
double memcpySecondsPerByte(const operands &o)
{
    const std::size_t bytes = o.n * sizeof(float);
    const int calls = static_cast<int>(std::max<std::size_t>(1, (std::size_t{1} << 26) / bytes));
    const double seconds = medianCpu([&] {
        for (int call = 0; call < calls; ++call)
        {
            std::memcpy(o.real(2), o.real(0), bytes);
            benchmark::ClobberMemory();
        }
    });
    return seconds / calls / (2.0 * static_cast<double>(bytes));
}

void runOperation(benchmark::State &state, const operation &what)
{
    const operands arrays(static_cast<std::size_t>(state.range(0)));
    const double baseline = memcpySecondsPerByte(arrays);
    const double seconds = timeLoop(state, [&] { what.run(arrays); });
    const double bytes = static_cast<double>(arrays.n) * what.floatsMoved * sizeof(float);
    state.counters["elements/s"] = static_cast<double>(arrays.n) / seconds;
    state.counters["times_memcpy"] = seconds / bytes / baseline;
}

const bool registered = [] {
    for (const operation &what : operations)
        benchmark::RegisterBenchmark((std::string("vector/") + what.name).c_str(), runOperation, what)
            ->ArgName("n")
            ->Arg(1024)
            ->Arg(1 << 22)
            ->UseRealTime();
    return true;
}();

} // namespace
