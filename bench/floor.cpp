#include "bench/floor.h"

#include "bench/timing.h"
#include "platform/math/alignedBuffer.h"
#include "platform/math/realTransform2d.h"

#include <fftw3.h>

#include <cstddef>
#include <new>

using namespace CorvaneDeblur;

namespace Bench
{
namespace
{

constexpr int leastRuns = 7;
constexpr double leastSeconds = 0.03;

/// Median processor time of one call of `timed`, each after an untimed `prepare`, once everything is warm: on an idle
/// machine that is the time on the wall.
template <typename Prepare, typename Timed> double medianTime(const Prepare &prepare, const Timed &timed)
{
    prepare();
    timed();
    std::vector<double> seconds;
    double total = 0.0;
    while (static_cast<int>(seconds.size()) < leastRuns || total < leastSeconds)
    {
        prepare();
        const stopwatch watch(cpuClock::thread);
        timed();
        seconds.push_back(watch.read().cpu);
        total += seconds.back();
    }
    return medianOf(std::move(seconds));
}

alignedBuffer<float> noise(int rows, int cols)
{
    alignedBuffer<float> samples(static_cast<std::size_t>(rows) * static_cast<std::size_t>(cols));
    unsigned state = 1;
    for (std::size_t i = 0; i < samples.count(); ++i)
    {
        state = state * 1664525u + 1013904223u;
        samples[i] = static_cast<float>(state >> 8) / 16777216.0f;
    }
    return samples;
}

class fftwTransforms
{
public:
    fftwTransforms(int rows, int cols)
        : samples(noise(rows, cols)), result(samples.count()),
          spectrum(static_cast<std::size_t>(rows) * static_cast<std::size_t>(cols / 2 + 1)),
          there(fftwf_plan_dft_r2c_2d(rows, cols, samples.data(), asFftw(), FFTW_ESTIMATE)),
          back(fftwf_plan_dft_c2r_2d(rows, cols, asFftw(), result.data(), FFTW_ESTIMATE))
    {
        if (!there || !back)
            throw std::bad_alloc();
    }
    fftwTransforms(const fftwTransforms &) = delete;
    fftwTransforms &operator=(const fftwTransforms &) = delete;
    ~fftwTransforms()
    {
        fftwf_destroy_plan(there);
        fftwf_destroy_plan(back);
    }

    void forward() const { fftwf_execute(there); }
    /// Destroys the spectrum.
    void inverse() const { fftwf_execute(back); }

private:
    fftwf_complex *asFftw() const { return reinterpret_cast<fftwf_complex *>(spectrum.data()); }

    alignedBuffer<float> samples, result;
    alignedBuffer<complexSample> spectrum;
    fftwf_plan there, back;
};

class ownTransforms
{
public:
    ownTransforms(int rows, int cols)
        : grid(rows, cols, workers::one), samples(noise(rows, cols)), result(samples.count()),
          halfWay(grid.spectrumCount()), spectrum(grid.spectrumCount())
    {
    }

    void forward() const
    {
        grid.forwardRows(samples.data(), grid.cols(), grid.cols(), 0, grid.rows(), halfWay.data());
        grid.forPieces([&](int piece, const realTransform2d::pieceScratch &) {
            grid.forwardColumns(halfWay.data() + piece * grid.pieceStride(),
                                spectrum.data() + piece * grid.pieceStride());
        });
    }
    void inverse() const
    {
        grid.forPieces([&](int piece, const realTransform2d::pieceScratch &) {
            grid.inverseColumns(spectrum.data() + piece * grid.pieceStride(),
                                halfWay.data() + piece * grid.pieceStride());
        });
        grid.inverseRows(halfWay.data(), 0, grid.rows(), result.data(), grid.cols(), grid.cols(), 1.0f);
    }

private:
    realTransform2d grid;
    alignedBuffer<float> samples, result;
    pieceSpectrum halfWay, spectrum;
};

template <typename Transforms> double secondsOf(const transformCount &job)
{
    const Transforms transforms(job.rows, job.cols);
    const auto forward = [&] { transforms.forward(); };
    double seconds = static_cast<double>(job.forward) * medianTime([] {}, forward);
    if (job.inverse > 0)
        seconds += static_cast<double>(job.inverse) * medianTime(forward, [&] { transforms.inverse(); });
    return seconds;
}

} // namespace

floorSeconds measureFloor(const std::vector<transformCount> &job)
{
    floorSeconds sum;
    for (const transformCount &grid : job)
    {
        sum.fftw += secondsOf<fftwTransforms>(grid);
        sum.own += secondsOf<ownTransforms>(grid);
    }
    return sum;
}

const char *floorLibrary()
{
    return fftwf_version;
}

} // namespace Bench
