#include "cli/photoAnalysis.h"

#include "cli/stopSignal.h"
#include "deblur/estimate/imageStructure.h"
#include "deblur/estimate/traceSize.h"

#include <algorithm>

namespace Stillmark
{

using namespace CorvaneDeblur;

photoAnalysis::photoAnalysis(const photo &analysed, const rectangle &part, runContext &run)
    : area(part), context(run), source(analysed, part)
{
}

rectangle photoAnalysis::fromArea(const regionRect &region) const
{
    return {region.x + area.x, region.y + area.y, region.width, region.height};
}

analysedImage &photoAnalysis::measured()
{
    if (!analysis)
    {
        context.bar.stage("Measuring");
        analysis = std::make_unique<analysedImage>(source, &stopSignal::requested());
        stopSignal::check();
    }
    return *analysis;
}

float photoAnalysis::noise()
{
    return measured().noise();
}

rectangle photoAnalysis::noisePatch()
{
    return fromArea(measured().noisePatch());
}

int photoAnalysis::blurSize(noiseMode noise)
{
    const int found = measured().findDefaultSize(noise);
    stopSignal::check();
    return std::min(found | 1, maxKernelSize(area.width, area.height));
}

photoAnalysis::regionList photoAnalysis::regions(int count, int size, noiseMode noise)
{
    const autoRegionList found = measured().autoRegions(count, size, noise);
    stopSignal::check();
    regionList list{{}, found.size | 1};
    for (const regionRect &region : found.regions)
        list.regions.push_back(fromArea(region));
    return list;
}

std::vector<rectangle> photoAnalysis::regionNear(std::pair<int, int> point, int size, noiseMode noise)
{
    const auto found = measured().suggestRegionAt({point.first - area.x, point.second - area.y}, size, noise);
    stopSignal::check();
    return found ? std::vector<rectangle>{fromArea(*found)} : std::vector<rectangle>{};
}

bool photoAnalysis::hasStructure(int size)
{
    const floatArray &grey = measured().analysis();
    return CorvaneDeblur::hasStructure(grey, size, static_cast<double>(area.width) / grey.cols);
}

} // namespace Stillmark
