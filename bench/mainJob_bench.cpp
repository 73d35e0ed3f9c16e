#include "bench/photoFile.h"
#include "bench/timing.h"
#include "cli/greyOfPhoto.h"
#include "cli/runRecord.h"
#include "cli/traceRegion.h"
#include "deblur/deconv/cellRenderer.h"
#include "deblur/deconv/shrinkageTableStore.h"
#include "deblur/estimate/autoTraces.h"
#include "deblur/estimate/traceSize.h"
#include "host/document/hostDocument.h"
#include "host/document/photoSource.h"
#include "host/document/resultRaster.h"
#include "host/plugin/pluginHost.h"
#include "host/plugin/pluginLibrary.h"

#include <algorithm>
#include <cstdlib>
#include <filesystem>

/// What the host and the plug-in's interface cost: the main job through the plug-in beside the engine called directly
/// on the same decoded photo, both into a result that is ready to be saved.
namespace
{

using namespace Bench;
using namespace CorvaneDeblur;
using namespace Stillmark;

class folderForRun
{
public:
    folderForRun()
    {
        std::string name = (std::filesystem::temp_directory_path() / "mainJob.XXXXXX").string();
        path = ::mkdtemp(name.data());
        ::setenv("XDG_CONFIG_HOME", path.c_str(), 1); // preferences and tables of the runs
    }
    ~folderForRun() { std::filesystem::remove_all(path); }
    std::filesystem::path path;
};

class photoReader final : public planeReader
{
public:
    explicit photoReader(const photo &from) : picture(from) {}
    void read(const pixelRect &area, std::byte *planes, std::ptrdiff_t rowBytes) override
    {
        picture.read({area.x, area.y, area.width, area.height}, planes, static_cast<std::size_t>(rowBytes));
    }

private:
    const photo &picture;
};

class photoSink final : public planeWriter
{
public:
    explicit photoSink(photoWriter &to) : result(to) {}
    void write(const pixelRect &area, const std::byte *planes, std::ptrdiff_t rowBytes) override
    {
        result.write({area.x, area.y, area.width, area.height}, planes, static_cast<std::size_t>(rowBytes));
    }

private:
    photoWriter &result;
};

/// The same steps as the plug-in's: find the size, a region and the kernel, render.
void engineJob(const photo &picture, const std::string &out, shrinkageTableStore &tables)
{
    greyOfPhoto source(picture);
    const analysedImage analysis(source);
    const int size =
        std::min(analysis.findDefaultSize(noiseMode::automatic) | 1, maxKernelSize(picture.width(), picture.height()));
    const autoRegionList found = analysis.autoRegions(1, size, noiseMode::automatic);
    cellRenderSettings settings;
    settings.imageCols = picture.width();
    settings.imageRows = picture.height();
    settings.planes = picture.colourPlanes();
    settings.depth = picture.depth();
    for (const regionRect &region : found.regions)
    {
        const auto grey = floatArray::allocate(region.height, region.width);
        source.readGrey(region, grey);
        kernelEstimator estimator;
        estimator.noise = noiseMode::automatic;
        estimator.noiseLevel = analysis.noise();
        estimator.imageToKernelRatio = imageToKernelRatio;
        latentKernel trace;
        trace.kernel = floatArray::allocate(found.size | 1, found.size | 1);
        estimator.estimate(grey, {}, trace.kernel);
        settings.kernels.push_back(trace);
    }
    photoWriter writer(picture, out);
    photoReader reader(picture);
    photoSink sink(writer);
    const std::atomic<bool> stop{false};
    renderCells(settings, tables, reader, sink, {}, stop);
}

void pluginJob(const photo &picture, const std::string &out, const pluginLibrary &plugin, const recordedAction &action)
{
    photoSource source(picture);
    resultRaster result(picture, out);
    hostDocument document(source, &result);
    hostOptions options;
    options.action = &action;
    options.alert = [](const hostAlert &) {};
    const hostOutcome outcome = runPlugin(plugin.entry(), document, options);
    if (!outcome.done() || tracesOf(outcome.recorded.value()).empty())
        throw std::runtime_error("the plug-in found nothing");
}

void mainJob(benchmark::State &state)
{
    const int width = static_cast<int>(state.range(0)), height = width * 2 / 3;
    const folderForRun folder;
    const std::string file = (folder.path / "photo.png").string(), out = (folder.path / "out.png").string();
    makePhoto(width, height, file);
    const photo picture = photo::open(file);
    const pluginLibrary plugin(STILLMARK_PLUGIN);
    const recordedAction action = automaticAction(true);
    shrinkageTableStore tables(folder.path.string());

    pluginJob(picture, out, plugin, action); // warms plans and tables
    engineJob(picture, out, tables);
    std::vector<double> wall, cpu, seconds;
    for ([[maybe_unused]] auto _ : state) // in turn: the machine may grow slower meanwhile
    {
        const stopwatch first;
        pluginJob(picture, out, plugin, action);
        const elapsed through = first.read();
        const stopwatch second;
        engineJob(picture, out, tables);
        const elapsed direct = second.read();
        state.SetIterationTime(through.wall);
        seconds.push_back(through.wall);
        wall.push_back(through.wall / direct.wall);
        cpu.push_back(through.cpu / direct.cpu);
    }
    state.counters["times_engine"] = medianOf(wall);
    state.counters["times_engine_cpu"] = medianOf(cpu);
    reportPixels(state, static_cast<double>(width) * height, medianOf(seconds));
}

BENCHMARK(mainJob)->Arg(3000)->Arg(6000)->Iterations(5)->UseManualTime()->Unit(benchmark::kMillisecond);

} // namespace
