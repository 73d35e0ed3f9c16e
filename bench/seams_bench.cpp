#include "bench/scenes.h"
#include "bench/timing.h"
#include "deblur/deconv/cellRenderer.h"
#include "deblur/deconv/shrinkageTableStore.h"

#include <algorithm>
#include <atomic>
#include <cstdlib>

/// What the division into cells leaves in a picture: the same render in cells of 512 and in one piece, compared.
namespace
{

using namespace Bench;
using namespace CorvaneDeblur;

constexpr unsigned seed = 41;
constexpr int side = 1536, cellSide = 512, kernelSize = 45;
constexpr int nearBorder = 4; ///< pixels on either side of a border between cells that count as its neighbourhood

void render(memoryPhoto &source, memoryPhoto &result, deconvolutionMethod method, int cell, shrinkageTableStore &tables)
{
    cellRenderSettings settings;
    settings.imageCols = settings.imageRows = side;
    settings.planes = 1;
    settings.method = method;
    settings.cellSize = cell;
    latentKernel trace;
    trace.kernel = shake(kernelSize, seed);
    settings.kernels = {trace};
    const std::atomic<bool> stop{false};
    renderCells(settings, tables, source, result, {}, stop);
}

bool liesNearBorder(int position)
{
    const int offset = position % cellSide;
    return position >= nearBorder && position < side - nearBorder &&
           (offset < nearBorder || offset >= cellSide - nearBorder);
}

/// Levels of 255 between two pictures.
struct difference
{
    double sum = 0.0, count = 0.0, most = 0.0;

    void add(int levels)
    {
        sum += levels;
        count += 1.0;
        most = std::max(most, static_cast<double>(levels));
    }
    double mean() const { return sum / count; }
};

void seams(benchmark::State &state, deconvolutionMethod method)
{
    shrinkageTableStore tables("");
    memoryPhoto source(shakenScene(side, side, 1, kernelSize, seed));
    difference borders, elsewhere;
    for (auto _ : state)
    {
        memoryPhoto cells(side, side, 1), whole(side, side, 1);
        render(source, cells, method, cellSide, tables);
        render(source, whole, method, side, tables);
        for (int y = 0; y < side; ++y)
            for (int x = 0; x < side; ++x)
            {
                const int a = std::to_integer<int>(cells.data()[y * side + x]);
                const int b = std::to_integer<int>(whole.data()[y * side + x]);
                (liesNearBorder(x) || liesNearBorder(y) ? borders : elsewhere).add(std::abs(a - b));
            }
    }
    state.counters["border_mean_levels"] = borders.mean();
    state.counters["border_most_levels"] = borders.most;
    state.counters["elsewhere_mean_levels"] = elsewhere.mean();
    state.counters["elsewhere_most_levels"] = elsewhere.most;
}

BENCHMARK_CAPTURE(seams, wiener, deconvolutionMethod::wiener)->Iterations(1)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(seams, fast, deconvolutionMethod::fast)->Iterations(1)->Unit(benchmark::kMillisecond);

} // namespace
