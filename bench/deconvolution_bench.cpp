#include "bench/scenes.h"
#include "bench/timing.h"
#include "bench/transformTally.h"
#include "deblur/deconv/cellRenderer.h"
#include "deblur/deconv/shrinkageTableStore.h"

#include <atomic>
#include <map>

/// Whole deconvolutions: one cell of a picture, and a photograph.
namespace
{

using namespace Bench;
using namespace CorvaneDeblur;

constexpr unsigned seed = 37;
constexpr int kernelSize = 45;
constexpr int cellSide = 512 + 2 * 2 * kernelSize; // with the margin that the renderer reads around it
constexpr int photoCols = 6000, photoRows = 4000;

latentKernel trace()
{
    latentKernel t;
    t.kernel = shake(kernelSize, seed);
    t.regionRight = photoCols;
    t.regionBottom = photoRows;
    return t;
}

shrinkageTableStore &tables()
{
    static shrinkageTableStore store(""); // kept in memory: no files
    return store;
}

void cell(benchmark::State &state, deconvolutionMethod method)
{
    const threadLimit one(1);
    memoryPhoto photo(shakenScene(cellSide, cellSide, 3, kernelSize, seed));
    memoryPhoto result(cellSide, cellSide, 3);
    const floorRatio floor(transformsOfDeconvolution(method, photo, {{0, 0, cellSide, cellSide}}, trace(), tables()));

    const auto estimator = createLatentEstimator(method, tables());
    estimator->setKernels({trace()}, 1.0f);
    const auto deconvolve = [&] {
        estimator->deconvolve(photo.data(), result.data(), 0, 0, cellSide, cellSide, 3, cellSide, cellSide, 8);
    };
    deconvolve();
    const elapsed time = timeJob(state, deconvolve);
    // The pixels that the cell is read for; those of its margin are not counted.
    reportPixels(state, 512.0 * 512.0, time.wall);
    floor.report(state, time);
}

void cells(benchmark::internal::Benchmark *bench)
{
    bench->UseManualTime()->Iterations(7)->Unit(benchmark::kMillisecond);
}
BENCHMARK_CAPTURE(cell, wiener, deconvolutionMethod::wiener)->Apply(cells);
BENCHMARK_CAPTURE(cell, classic, deconvolutionMethod::classic)->Apply(cells);
BENCHMARK_CAPTURE(cell, fast, deconvolutionMethod::fast)->Apply(cells);

/// 24 megapixels of three planes, blurred; made when first asked for.
memoryPhoto &largePhoto()
{
    static memoryPhoto photo(shakenScene(photoRows, photoCols, 3, kernelSize, seed));
    return photo;
}

void render(deconvolutionMethod method, memoryPhoto &photo, memoryPhoto &result, int threads)
{
    const threadLimit limit(threads);
    cellRenderSettings settings;
    settings.imageCols = photo.cols;
    settings.imageRows = photo.rows;
    settings.planes = photo.planes;
    settings.method = method;
    settings.kernels = {trace()};
    const std::atomic<bool> stop{false};
    renderCells(settings, tables(), photo, result, {}, stop);
}

/// What is known of a method's render once it has run.
struct renderRecord
{
    double oneThread = 0.0; ///< seconds
    std::vector<transformCount> transforms;
};

void photo(benchmark::State &state, deconvolutionMethod method)
{
    static std::map<deconvolutionMethod, renderRecord> records;
    renderRecord &record = records[method];
    const int threads = static_cast<int>(state.range(0));
    memoryPhoto &source = largePhoto();
    static memoryPhoto result(photoCols, photoRows, 3);
    if (record.oneThread == 0.0 && threads > 1)
    {
        const stopwatch watch;
        render(method, source, result, 1);
        record.oneThread = watch.read().wall;
    }

    source.takeReads();
    const elapsed time = timeJob(state, [&] {
        source.takeReads();
        render(method, source, result, threads);
    });
    const std::vector<pixelRect> areas = source.takeReads();
    if (record.transforms.empty())
        record.transforms = transformsOfDeconvolution(method, source, areas, trace(), tables());

    reportPixels(state, source.pixels(), time.wall);
    const threadLimit one(1);
    floorRatio(record.transforms).report(state, time);
    if (threads == 1)
        record.oneThread = time.wall;
    else
        state.counters["times_one_thread"] = record.oneThread / time.wall;
}

void threads(benchmark::internal::Benchmark *bench)
{
    bench->ArgName("threads")->Arg(1)->Arg(2)->UseManualTime()->Unit(benchmark::kMillisecond);
}
BENCHMARK_CAPTURE(photo, wiener, deconvolutionMethod::wiener)->Apply(threads)->Iterations(3);
BENCHMARK_CAPTURE(photo, classic, deconvolutionMethod::classic)->Apply(threads)->Iterations(1);
BENCHMARK_CAPTURE(photo, fast, deconvolutionMethod::fast)->Apply(threads)->Iterations(1);

} // namespace
