#include "cli/commandLine.h"
#include "cli/commands.h"
#include "cli/jsonWriter.h"
#include "cli/optionValues.h"
#include "cli/photoAnalysis.h"
#include "cli/stopwatch.h"
#include "cli/traceEstimation.h"
#include "cli/traceFiles.h"
#include "deblur/estimate/kernelPyramid.h"

namespace Stillmark
{
namespace
{

using CorvaneDeblur::estimateStatus;
using CorvaneDeblur::noiseMode;

/// Pixels a side up to which a photo is estimated from as a whole.
constexpr int largestRegionSide = 2000;

rectangle wantedRegion(const estimateOptions &options, const photo &picture, int size, photoAnalysis &analysis,
                       runContext &context)
{
    if (options.region)
    {
        requireInside(picture, wholeOf(picture), *options.region);
        return *options.region;
    }
    if (picture.width() <= largestRegionSide && picture.height() <= largestRegionSide)
        return wholeOf(picture);
    const auto found = analysis.regions(1, size, options.noise);
    if (found.regions.empty())
        throw Platform::fileError(picture.path() + ": no region found in which a blur could be seen well; --region " +
                                  "chooses one");
    context.notes.push_back(picture.path() + ": the blur was looked for in the region " +
                            regionText(found.regions.front()) + ", as the whole is too large");
    return found.regions.front();
}

void checkSkipped(const estimateOptions &options, int size)
{
    using namespace CorvaneDeblur;
    if (buildPyramid(size, size, pyramidScale, pyramidMinimum, options.skipLevels).empty())
        throw usageError("--skip-levels: " + std::to_string(options.skipLevels) + " leaves no level of a kernel of " +
                         std::to_string(size) + " pixels");
}

std::string answerJson(const foundTrace &trace, double seconds)
{
    return jsonObject({{"status", jsonNumber(static_cast<int>(trace.status))},
                       {"size", jsonNumber(trace.size)},
                       {"sparsity", jsonNumber(trace.sparsity)},
                       {"good", jsonBool(trace.good)},
                       {"region", jsonRectangle(trace.region)},
                       {"levels", jsonNumber(trace.levels)},
                       {"seconds", jsonNumber(seconds)}});
}

} // namespace

commandResult estimateKernel(const estimateOptions &options, runContext &context)
{
    checkAnyKernelPath(options.output);
    const photo picture = openPhoto(options.photo, context);
    photoAnalysis analysis(picture, wholeOf(picture), context);
    const int size = options.size ? *options.size : analysis.blurSize(options.noise);
    checkSkipped(options, size);
    const rectangle region =
        regionFor(picture, wholeOf(picture), wantedRegion(options, picture, size, analysis, context), size);

    estimationSettings settings;
    settings.noise = options.noise;
    settings.noiseLevel = options.noise == noiseMode::automatic ? analysis.noise() : 0.0f;
    settings.maskThreshold = options.maskThreshold;
    settings.seedLevels = options.seedLevels;
    settings.skipLevels = options.skipLevels;
    settings.secondOrder = options.secondOrder;

    const stopwatch estimating;
    const foundTrace trace = estimateTraces(picture, {region}, size, settings, context).front();
    const double seconds = estimating.seconds();

    const std::string complaint = complaintAbout(trace);
    if (!complaint.empty())
        context.notes.push_back(picture.path() + ": region " + regionText(region) + ": " + complaint);
    if (trace.status != estimateStatus::finished)
        return {exitFailed, "", answerJson(trace, seconds)};
    writeAnyKernel(options.output, {region, size, options.noise, {}, false, trace.kernel}, picture.width(),
                   picture.height());
    return {exitDone,
            options.output + ": a kernel of " + std::to_string(size) + " x " + std::to_string(size) +
                " pixels, found in the region " + regionText(region) + " (" + secondsText(seconds) + ")",
            answerJson(trace, seconds)};
}

} // namespace Stillmark
