#include "cli/photoAnalysis.h"

#include "cli/stopSignal.h"
#include "deblur/estimate/imageStructure.h"
#include "deblur/estimate/traceSize.h"

#include <algorithm>
#include <iterator>

namespace Stillmark
{

using namespace CorvaneDeblur;

photoAnalysis::photoAnalysis(const photo &analysed, runContext &run) : picture(analysed), context(run), source(analysed)
{
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
    return fromEngine(measured().noisePatch());
}

int photoAnalysis::blurSize(noiseMode noise)
{
    const int found = measured().findDefaultSize(noise);
    stopSignal::check();
    return std::min(found | 1, maxKernelSize(picture.width(), picture.height()));
}

photoAnalysis::regionList photoAnalysis::regions(int count, int size, noiseMode noise)
{
    const autoRegionList found = measured().autoRegions(count, size, noise);
    stopSignal::check();
    regionList list{{}, found.size | 1};
    std::transform(found.regions.begin(), found.regions.end(), std::back_inserter(list.regions), fromEngine);
    return list;
}

std::vector<rectangle> photoAnalysis::regionNear(std::pair<int, int> point, int size, noiseMode noise)
{
    const auto found = measured().suggestRegionAt({point.first, point.second}, size, noise);
    stopSignal::check();
    return found ? std::vector<rectangle>{fromEngine(*found)} : std::vector<rectangle>{};
}

bool photoAnalysis::hasStructure(int size)
{
    const floatArray &grey = measured().analysis();
    return CorvaneDeblur::hasStructure(grey, size, static_cast<double>(picture.width()) / grey.cols);
}

} // namespace Stillmark
