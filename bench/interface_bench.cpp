#include "bench/timing.h"
#include "framework/controls/buttons/iconButton.h"
#include "framework/controls/dialog.h"
#include "framework/controls/panes/disclosurePane.h"
#include "framework/controls/scrolling/cellSheet.h"
#include "framework/controls/sliders/editSlider.h"
#include "framework/views/application.h"
#include "framework/views/view.h"
#include "platform/window/memoryDisplay.h"

#include <benchmark/benchmark.h>

#include <cstdint>
#include <memory>

using namespace Sarnik;

namespace
{

/// The main dialog's own classes do not exist yet: their bases stand for them, with as many views and nothing in the
/// panes that show pictures.
void enterStandIns()
{
    static const CPaneBuilder<CLayoutPane> preview("PPreviewPane"), detail("PDetailedPreviewPane");
    static const CPaneBuilder<CScroller> scroller("PPreviewScroller");
    static const CPaneBuilder<CCellSheet> thumbnails("PKernelThumbnail");
    static const CPaneBuilder<CDisclosurePane> advanced("PDisclosableFramePane");
    static const CPaneBuilder<CFlatIconButton> empty("PPushEmptyButton");
}

/// The main dialog in memory, as after its opening.
struct openDialog
{
    explicit openDialog(double scale) : display(scale)
    {
        dialog.LoadLayout("PDialog.wyra");
        dialog.Open();
        application.ProcessAll();
        shown = display.find(dialog.Screen()->id());
    }

    Platform::memoryDisplay display;
    CApplication application{display};
    CDialog dialog;
    Platform::memoryWindow *shown = nullptr;
};

double pixelsOf(const openDialog &open)
{
    return static_cast<double>(open.shown->screen().width()) * open.shown->screen().height();
}

/// Parse, measure, build, first paint. `first_ms`: the first one of the process, which also loads fonts and icons; it
/// counts where no other benchmark of windows ran before.
void interfaceOpen(benchmark::State &state)
{
    enterStandIns();
    const double scale = static_cast<double>(state.range(0));
    static const double first = [scale] {
        const Bench::stopwatch watch;
        const openDialog open(scale);
        return watch.read().wall;
    }();
    for ([[maybe_unused]] auto _ : state)
    {
        const openDialog open(scale);
        benchmark::DoNotOptimize(open.shown);
    }
    state.counters["first_ms"] = 1e3 * first;
}
BENCHMARK(interfaceOpen)->ArgName("scale")->Arg(1)->Arg(2)->Unit(benchmark::kMillisecond);

/// All of the dialog again.
void interfacePaint(benchmark::State &state)
{
    enterStandIns();
    openDialog open(static_cast<double>(state.range(0)));
    for ([[maybe_unused]] auto _ : state)
    {
        open.dialog.Invalidate();
        open.dialog.Paint();
    }
}
BENCHMARK(interfacePaint)->ArgName("scale")->Arg(1)->Arg(2)->Unit(benchmark::kMillisecond);

/// One slider gets another value: what is drawn and shown for it.
void interfaceSlider(benchmark::State &state)
{
    enterStandIns();
    openDialog open(static_cast<double>(state.range(0)));
    auto &slider = *open.dialog.Find<CEditSlider>("Project/Dialog/ResultDenoiseSlider");
    const std::int64_t before = open.shown->presentedPixels();
    double value = 0;
    for ([[maybe_unused]] auto _ : state)
    {
        value = value < 99 ? value + 1 : 0;
        slider.SetValue(value);
        open.dialog.Paint();
    }
    const double pixels =
        static_cast<double>(open.shown->presentedPixels() - before) / static_cast<double>(state.iterations());
    const CRect frame = slider.Frame();
    const double scale = static_cast<double>(state.range(0));
    state.counters["pixels"] = pixels;
    state.counters["of_slider"] =
        pixels / (static_cast<double>(frame.Width()) * static_cast<double>(frame.Height()) * scale * scale);
    state.counters["of_window"] = pixels / pixelsOf(open);
}
BENCHMARK(interfaceSlider)->ArgName("scale")->Arg(1)->Arg(2)->Unit(benchmark::kMicrosecond);

} // namespace
