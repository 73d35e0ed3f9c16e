#include "deblur/estimate/autoTraces.h"

#include "deblur/estimate/blurSize.h"
#include "deblur/estimate/noiseMeasure.h"
#include "deblur/estimate/reducedGrey.h"
#include "deblur/estimate/suggestRegion.h"
#include "deblur/estimate/traceSize.h"

#include <algorithm>

namespace CorvaneDeblur
{
namespace
{

constexpr int analysisSide = 1000; ///< of the image that regions are looked for in
constexpr int windowReach = 750;   ///< of the windows that the blur size is measured in, to each side
constexpr int lastResortSize = 10; ///< trace size to try where the one in force finds no region

} // namespace

analysedImage::analysedImage(greySource &source, const std::atomic<bool> *stopFlag) : image(source), stop(stopFlag)
{
    reduced = reducedGrey(image, analysisSide, stop);
    if (reduced.empty() || stopped())
        return;
    patch = flattestPatch(reduced, image.cols(), image.rows());
    noiseLevel = noiseOfPatch(readFinite(image, patch));
}

bool analysedImage::stopped() const
{
    return stop != nullptr && stop->load(std::memory_order_relaxed);
}

int analysedImage::blurSizeAround(int centreX, int centreY) const
{
    regionRect window;
    window.x = std::max(0, centreX - windowReach);
    window.y = std::max(0, centreY - windowReach);
    window.width = std::min(image.cols(), centreX + windowReach) - window.x;
    window.height = std::min(image.rows(), centreY + windowReach) - window.y;
    return blurSizeOfWindow(readFinite(image, window), image.cols(), image.rows());
}

int analysedImage::findDefaultSize(noiseMode mode) const
{
    constexpr int mostWindows = 3;
    const int firstSize = sizeForPreset(sizePreset::small, image.cols(), image.rows());
    std::vector<regionRect> regions;
    while (static_cast<int>(regions.size()) < mostWindows)
    {
        const auto region = addSuggestedRegion(firstSize, mode, regions);
        if (!region)
            break;
        regions.push_back(*region);
    }
    if (regions.empty())
        regions.push_back({0, 0, image.cols(), image.rows()});

    int sum = 0;
    for (const regionRect &region : regions)
    {
        if (stopped() || reduced.empty())
            return 0;
        sum += blurSizeAround(region.centreX(), region.centreY());
    }
    return sum / static_cast<int>(regions.size());
}

std::optional<regionRect> analysedImage::addSuggestedRegion(int size, noiseMode mode,
                                                            const std::vector<regionRect> &existing) const
{
    regionRect found;
    if (stopped() || !suggestRegion(reduced, image.cols(), image.rows(), size, size, mode, noiseLevel, existing,
                                    existing.empty() ? regionMode::first : regionMode::more, {}, found))
        return std::nullopt;
    return limitRegion(found);
}

std::optional<regionRect> analysedImage::suggestRegionAt(imagePoint point, int size, noiseMode mode) const
{
    regionRect found;
    if (stopped() || !suggestRegion(reduced, image.cols(), image.rows(), size, size, mode, noiseLevel, {},
                                    regionMode::near, point, found))
        return std::nullopt;
    return limitRegion(found);
}

autoRegionList analysedImage::autoRegions(int count, int size, noiseMode mode,
                                          const std::vector<regionRect> &existing) const
{
    autoRegionList list;
    list.size = size;
    std::vector<regionRect> taken = existing;
    while (static_cast<int>(list.regions.size()) < count && !stopped())
    {
        if (const auto region = addSuggestedRegion(list.size, mode, taken))
        {
            list.regions.push_back(*region);
            taken.push_back(*region);
        }
        else if (taken.empty() && list.size != lastResortSize)
        {
            list.size = lastResortSize;
            list.smallSizeTried = true;
        }
        else
        {
            break;
        }
    }
    return list;
}

} // namespace CorvaneDeblur
