#include "bench/scenes.h"
#include "bench/timing.h"
#include "shell/heapPageStore.h"
#include "shell/virtualHeap.h"
#include "stages/imageHub.h"
#include "stages/preview.h"
#include "stages/result.h"
#include "stages/source.h"
#include "stages/stageHost.h"
#include "stages/stageView.h"
#include "store/traces/kernelCollection.h"
#include "store/traces/readOnlyKernel.h"

#include <cstring>
#include <stdexcept>
#include <thread>

/// The stage graph on a photograph of 24 megapixels in memory: the final render beside the engine's own cells, and the
/// ladder of previews.
namespace
{

using namespace Bench;
using namespace Project;
using CorvaneDeblur::deconvolutionMethod;
using CorvaneDeblur::floatArray;
using Sarnik::CBasicPixmap;
using Sarnik::CRect;

constexpr unsigned seed = 37;
constexpr int kernelSize = 45;
constexpr int photoCols = 6000, photoRows = 4000;
constexpr CRect photoRect{0, 0, photoCols, photoRows};

/// Blurred, three planes of 8 bits; made when first asked for.
memoryPhoto &photo()
{
    static memoryPhoto made(shakenScene(photoRows, photoCols, 3, kernelSize, seed));
    return made;
}

/// A run around the photo, with one trace. Pixels go straight between the stages and plain memory.
class photoRun final : public PStageHost, private PTracePicture
{
public:
    explicit photoRun(bool fineResult) : result(photoCols, photoRows, 3), traces(*this, params, events, {})
    {
        heap.SetLimit(std::uint64_t{2} << 30);
        PTraceRecord record;
        record.kernel = shake(kernelSize, seed);
        record.region = photoRect;
        record.settings.forcedApply = true;
        traces.Insert(std::make_unique<PReadOnlyKernel>(traces, record), 0);
        traces.Activate(0);
        params.fineResult = fineResult;
    }

    Sarnik::CImageFormat Format() const override { return {Sarnik::CPixelKind::rgb, 8, 3}; }
    CRect ImageBounds() const override { return photoRect; }
    CRect SelectionBounds() const override { return photoRect; }
    bool HasSelection() const override { return false; }
    bool HasTransparency() const override { return false; }
    void ReadSource(CBasicPixmap &pixmap) override
    {
        const CRect r = pixmap.Bounds();
        eachRow(r, [&](int plane, std::int32_t y, std::size_t n) {
            std::memcpy(pixmap.Plane(plane).Row<std::byte>(y), at(photo(), plane, y, r.left), n);
        });
        for (std::int32_t y = r.top; y < r.bottom && pixmap.GetPlaneCount() > 3; ++y)
            std::memset(pixmap.Plane(3).Row<std::byte>(y), 255, static_cast<std::size_t>(r.Width()));
    }
    void ReadSelection(CBasicPixmap &, int) override {}
    void Write(CBasicPixmap &pixmap, const CRect &rect) override
    {
        eachRow(rect, [&](int plane, std::int32_t y, std::size_t n) {
            const Sarnik::CPixelArea area = pixmap.Plane(plane);
            std::memcpy(at(result, plane, y, rect.left), area.Row<std::byte>(y) + (rect.left - area.rect.left), n);
        });
    }
    Sarnik::CPageStore &PageStore() override { return pages; }
    PParams &Params() override { return params; }
    PKernelCollection &Kernels() override { return traces; }
    void Progress(std::uint64_t, std::uint64_t) override {}
    bool Abort() override { return false; }

    memoryPhoto result;

private:
    static std::byte *at(memoryPhoto &of, int plane, std::int32_t y, std::int32_t x)
    {
        return of.data() + (std::ptrdiff_t{plane} * photoRows + y) * photoCols + x;
    }
    template <class Body> static void eachRow(const CRect &rect, Body body)
    {
        for (int plane = 0; plane < 3; ++plane)
            for (std::int32_t y = rect.top; y < rect.bottom; ++y)
                body(plane, y, static_cast<std::size_t>(rect.Width()));
    }

    CRect Bounds() const override { return photoRect; }
    int Planes() const override { return 3; }
    int Depth() const override { return 8; }
    void ReadGrey(const CRect &, std::uint8_t, const floatArray &, const CorvaneDeblur::byteArray &) override
    {
        throw std::logic_error("nothing is estimated here");
    }

    Sarnik::CVirtualHeap heap;
    Sarnik::CHeapPageStore pages{heap};
    PParams params;
    PTraceEvents events;
    PKernelCollection traces;
};

elapsed renderByStages(photoRun &run, int threads)
{
    const threadLimit limit(threads);
    PImageHub hub(run);
    const stopwatch watch;
    hub.RenderWithCallbacks();
    return watch.read();
}

elapsed renderByEngine(photoRun &run, memoryPhoto &result, int threads)
{
    const threadLimit limit(threads);
    CorvaneDeblur::cellRenderSettings settings;
    settings.imageCols = photoCols;
    settings.imageRows = photoRows;
    settings.planes = 3;
    settings.method = run.Params().fineResult ? deconvolutionMethod::fast : deconvolutionMethod::wiener;
    settings.kernels.resize(1);
    settings.kernels[0].kernel = shake(kernelSize, seed);
    settings.kernels[0].regionRight = photoCols;
    settings.kernels[0].regionBottom = photoRows;
    const std::atomic<bool> stop{false};
    const stopwatch watch;
    renderCells(settings, run.Kernels().ShrinkageTables(), photo(), result, {}, stop);
    photo().takeReads();
    return watch.read();
}

/// In turn: the engine, the stages on as many threads, the stages on one.
void stagesFinal(benchmark::State &state, bool fineResult)
{
    const int threads = static_cast<int>(state.range(0));
    photoRun run(fineResult);
    static memoryPhoto byEngine(photoCols, photoRows, 3);
    run.Kernels().ShrinkageTables();
    std::vector<double> ours, engine, one, oursCpu, engineCpu;
    for ([[maybe_unused]] auto _ : state)
    {
        const elapsed engineTime = renderByEngine(run, byEngine, threads), time = renderByStages(run, threads);
        engine.push_back(engineTime.wall);
        engineCpu.push_back(engineTime.cpu);
        ours.push_back(time.wall);
        oursCpu.push_back(time.cpu);
        if (threads > 1)
            one.push_back(renderByStages(run, 1).wall);
        state.SetIterationTime(time.wall);
        if (std::memcmp(byEngine.data(), run.result.data(), std::size_t{3} * photoCols * photoRows) != 0)
            state.SkipWithError("another picture than the engine's");
    }
    state.counters["times_renderCells"] = medianOf(ours) / medianOf(engine);
    state.counters["cpu_times_renderCells"] = medianOf(oursCpu) / medianOf(engineCpu);
    if (threads > 1)
        state.counters["times_one_thread"] = medianOf(one) / medianOf(ours);
    reportPixels(state, photo().pixels(), medianOf(ours));
}

void threadCounts(benchmark::internal::Benchmark *bench)
{
    bench->ArgName("threads")->Arg(1)->Arg(2)->UseManualTime()->Unit(benchmark::kMillisecond);
}
BENCHMARK_CAPTURE(stagesFinal, wiener, false)->Apply(threadCounts)->Iterations(3);
BENCHMARK_CAPTURE(stagesFinal, fast, true)->Apply(threadCounts)->Iterations(1);

class paneOf final : public PStageView
{
public:
    explicit paneOf(const CRect &seen) : visible(seen) {}
    bool Active() const override { return true; }
    CRect Visible() const override { return visible; }
    CRect Focus() const override { return visible; }
    void Redraw(const CRect &) override {}
    void RedrawIndicator() override {}
    void ShowProgress(double) override {}
    void WantIdle(bool) override {}

private:
    CRect visible;
};

constexpr double sliceBudget = 0.02; ///< seconds

/// Idle slices until a preview is finished where it can be seen; the longest of them.
double climb(PImageHub &hub, const PPreview &preview, const CRect &visible, double &longest)
{
    const stopwatch watch;
    while (!preview.Finished(visible))
    {
        const stopwatch slice;
        hub.Idle(sliceBudget);
        longest = std::max(longest, slice.read().wall);
        std::this_thread::yield();
    }
    return watch.read().wall;
}

/// A pane of 1200 x 800: zoom 0 shows the whole picture in it, otherwise its middle at that many percent. From the
/// moment when the source cells that are seen have been read.
void stagesLadder(benchmark::State &state)
{
    const double zoom = state.range(0) == 0 ? 0.2 : static_cast<double>(state.range(0)) / 100.0;
    const CRect view{0, 0, static_cast<int>(photoCols * zoom), static_cast<int>(photoRows * zoom)};
    const int left = std::max(0, (view.right - 1200) / 2), top = std::max(0, (view.bottom - 800) / 2);
    const CRect visible = CRect{left, top, left + 1200, top + 800}.Intersected(view);
    photoRun run(true);
    run.Kernels().ShrinkageTables();
    std::vector<double> rough, fast;
    double longest = 0.0;
    for ([[maybe_unused]] auto _ : state)
    {
        PImageHub hub(run);
        hub.Source().ForceAll();
        paneOf pane(visible);
        hub.SetViewObject(&pane);
        const stopwatch watch;
        hub.SetView(view, hub.ReductionFor(view, visible));
        rough.push_back(climb(hub, hub.PreviewRough(), visible, longest));
        climb(hub, hub.FastEnabled() ? hub.PreviewFast() : hub.PreviewRough(), visible, longest);
        fast.push_back(watch.read().wall);
        // On towards the final quality for a while: its slices count, too.
        for (int i = 0; i < 100; ++i)
        {
            const stopwatch slice;
            hub.Idle(sliceBudget);
            longest = std::max(longest, slice.read().wall);
            std::this_thread::sleep_for(std::chrono::milliseconds(2));
        }
        state.SetIterationTime(rough.back());
    }
    state.counters["coarse_ms"] = 1e3 * medianOf(rough);
    state.counters["fine_ms"] = 1e3 * medianOf(fast);
    state.counters["times_budget"] = longest / sliceBudget;
}
BENCHMARK(stagesLadder)
    ->ArgName("zoom")
    ->Arg(0)
    ->Arg(50)
    ->Arg(100)
    ->Iterations(5)
    ->UseManualTime()
    ->Unit(benchmark::kMillisecond);

} // namespace
