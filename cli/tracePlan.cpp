#include "cli/tracePlan.h"

#include "cli/photoAnalysis.h"
#include "cli/traceRegion.h"

#include <algorithm>

namespace Stillmark
{
namespace
{

using CorvaneDeblur::noiseMode;

/// A picture below this is too small for the measures, which do not look for blurs below 31 pixels.
constexpr int smallestMeasuredSide = 3 * 31;

std::vector<rectangle> foundRegions(const removeOptions &options, const photo &picture, const rectangle &area,
                                    int &size, photoAnalysis &analysis, runContext &context)
{
    if (!analysis.hasStructure(size))
    {
        context.notes.push_back(picture.path() + ": no structure found: there are no edges to see a blur by");
        return {};
    }
    if (std::min(area.width, area.height) < smallestSearchedSide)
        return {area};
    auto found = analysis.regions(options.traces, size, options.noise);
    if (found.regions.empty())
        context.notes.push_back(picture.path() + ": no region found in which the blur could be seen well enough; " +
                                "--region chooses one");
    else if (static_cast<int>(found.regions.size()) < options.traces)
        context.notes.push_back(picture.path() + ": only " + std::to_string(found.regions.size()) + " of " +
                                std::to_string(options.traces) + " regions found");
    size = found.size;
    return found.regions;
}

} // namespace

bool isAutomatic(const removeOptions &options, const rectangle &area)
{
    const traceStrength usual;
    return !options.size && options.regions.empty() && options.traces == 1 && options.noise == noiseMode::automatic &&
           options.strength.smoothing == usual.smoothing && options.strength.suppression == usual.suppression &&
           !options.force && std::min(area.width, area.height) >= smallestSearchedSide;
}

tracePlan planTraces(const removeOptions &options, const photo &picture, const rectangle &area, runContext &context)
{
    for (const rectangle &region : options.regions)
        requireInside(picture, area, region);
    if (std::min(area.width, area.height) < smallestMeasuredSide && (options.regions.empty() || !options.size))
        throw Platform::fileError(picture.path() + ": too small to find a blur in: " + std::to_string(area.width) +
                                  " x " + std::to_string(area.height) + " pixels");

    photoAnalysis analysis(picture, area, context);
    tracePlan plan;
    plan.size = options.size ? *options.size : analysis.blurSize(options.noise);
    regionFor(picture, area, area, plan.size); // or tells that there is too little room for it
    plan.regions =
        options.regions.empty() ? foundRegions(options, picture, area, plan.size, analysis, context) : options.regions;
    for (rectangle &region : plan.regions)
        region = regionFor(picture, area, region, plan.size);
    return plan;
}

} // namespace Stillmark
