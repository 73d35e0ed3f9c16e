#include "cli/commands.h"
#include "cli/jsonWriter.h"
#include "cli/kernelArrays.h"
#include "cli/photoAnalysis.h"
#include "cli/photoRender.h"
#include "cli/stopwatch.h"
#include "cli/traceEstimation.h"
#include "deblur/estimate/traceSize.h"
#include "platform/files.h"

#include <algorithm>

namespace Stillmark
{
namespace
{

using CorvaneDeblur::deconvolutionMethod;
using CorvaneDeblur::estimateStatus;
using CorvaneDeblur::noiseMode;

/// A picture below this is too small for the measures, which do not look for blurs below 31 pixels.
constexpr int smallestMeasuredSide = 3 * 31;

/// Where the blur is looked for, and how large it may be.
struct searchPlan
{
    std::vector<rectangle> regions; ///< as estimated: with room for the size
    int size = 0;
};

void checkTargets(const removeOptions &options)
{
    photoWriter::check(options.output);
    if (!options.kernelPicture.empty())
        Platform::checkWritable(options.kernelPicture);
}

std::vector<rectangle> foundRegions(const removeOptions &options, const photo &picture, int &size,
                                    photoAnalysis &analysis, runContext &context)
{
    if (!analysis.hasStructure(size))
    {
        context.notes.push_back(picture.path() + ": no structure found: there are no edges to see a blur by");
        return {};
    }
    if (std::min(picture.width(), picture.height()) < smallestSearchedSide)
        return {fromEngine(CorvaneDeblur::limitRegion(toEngine(wholeOf(picture))))};
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

searchPlan planSearch(const removeOptions &options, const photo &picture, photoAnalysis &analysis, runContext &context)
{
    for (const rectangle &region : options.regions)
        requireInside(picture, region);
    const int side = std::min(picture.width(), picture.height());
    if (side < smallestMeasuredSide && (options.regions.empty() || !options.size))
        throw Platform::fileError(picture.path() + ": too small to find a blur in: " + std::to_string(picture.width()) +
                                  " x " + std::to_string(picture.height()) + " pixels");

    searchPlan plan;
    plan.size = options.size ? *options.size : analysis.blurSize(options.noise);
    regionFor(picture, wholeOf(picture), plan.size); // or tells that the picture is too small for it
    plan.regions =
        options.regions.empty() ? foundRegions(options, picture, plan.size, analysis, context) : options.regions;
    for (rectangle &region : plan.regions)
        region = regionFor(picture, region, plan.size);
    return plan;
}

std::vector<foundTrace> findBlur(const removeOptions &options, const photo &picture, const searchPlan &plan,
                                 photoAnalysis &analysis, runContext &context)
{
    if (plan.regions.empty())
        return {};
    estimationSettings settings;
    settings.noise = options.noise;
    settings.noiseLevel = options.noise == noiseMode::automatic ? analysis.noise() : 0.0f;
    return estimateTraces(picture, plan.regions, plan.size, settings, context);
}

bool isApplied(const foundTrace &trace, const removeOptions &options)
{
    return isUsable(trace) || (options.force && trace.status == estimateStatus::finished);
}

/// Tells which traces are left out, and how to have them all the same.
void noteComplaints(const std::vector<foundTrace> &traces, const removeOptions &options, runContext &context)
{
    for (const foundTrace &trace : traces)
    {
        if (trace.cut && isApplied(trace, options))
            context.notes.push_back(options.photo + ": region " + regionText(trace.region) +
                                    ": the blur runs into the " + "border of its " + std::to_string(trace.size) +
                                    " pixels; a larger --size may find more of it");
        const std::string complaint = complaintAbout(trace);
        if (complaint.empty())
            continue;
        std::string note = options.photo + ": region " + regionText(trace.region) + ": " + complaint;
        if (trace.status == estimateStatus::finished)
            note += options.force ? " and is removed as you asked" : " and is not removed (--force removes it)";
        context.notes.push_back(note);
    }
}

void writePictureOfKernels(const removeOptions &options, const std::vector<foundTrace> &traces, runContext &context)
{
    std::vector<kernelSamples> kernels;
    for (const foundTrace &trace : traces)
        if (!trace.kernel.empty())
            kernels.push_back(toSamples(trace.kernel));
    if (kernels.empty())
        context.notes.push_back(options.kernelPicture + ": not written, as no blur was found");
    else
        writeKernelPicture(options.kernelPicture, kernels);
}

std::string traceJson(const foundTrace &trace, bool applied)
{
    return jsonObject({{"region", jsonRectangle(trace.region)},
                       {"size", jsonNumber(trace.size)},
                       {"good", jsonBool(trace.good)},
                       {"applied", jsonBool(applied)},
                       {"status", jsonNumber(static_cast<int>(trace.status))},
                       {"sparsity", jsonNumber(trace.sparsity)}});
}

struct timings
{
    double measure = 0, estimate = 0, render = 0;
};

commandResult answer(const removeOptions &options, const std::vector<foundTrace> &traces, const timings &seconds,
                     const runContext &context)
{
    commandResult result;
    std::vector<std::string> traceTexts, noteTexts;
    for (const foundTrace &trace : traces)
    {
        const bool applied = isApplied(trace, options);
        traceTexts.push_back(traceJson(trace, applied));
        if (applied)
            result.text += "Blur of at most " + std::to_string(trace.size) + " pixels, found in the region " +
                           regionText(trace.region) + "\n";
    }
    for (const std::string &note : context.notes)
        noteTexts.push_back(jsonString(note));

    if (result.text.empty())
        result.text = options.output + ": the photo as it was";
    else
        result.text += options.output + ": the blur was removed (" + secondsText(seconds.estimate) + " to find it, " +
                       secondsText(seconds.render) + " to remove it)";
    result.json = jsonObject({{"traces", jsonArray(traceTexts)},
                              {"seconds", jsonObject({{"measure", jsonNumber(seconds.measure)},
                                                      {"estimate", jsonNumber(seconds.estimate)},
                                                      {"render", jsonNumber(seconds.render)}})},
                              {"output", jsonString(options.output)},
                              {"notes", jsonArray(noteTexts)}});
    return result;
}

} // namespace

commandResult removeBlur(const removeOptions &options, runContext &context)
{
    checkTargets(options);
    const photo picture = openPhoto(options.photo, context);
    photoAnalysis analysis(picture, context);
    timings seconds;

    const stopwatch measuring;
    const searchPlan plan = planSearch(options, picture, analysis, context);
    seconds.measure = measuring.seconds();

    const stopwatch estimating;
    const std::vector<foundTrace> traces = findBlur(options, picture, plan, analysis, context);
    seconds.estimate = estimating.seconds();
    noteComplaints(traces, options, context);

    renderSettings settings;
    settings.method = options.artifactSuppression ? deconvolutionMethod::fast : deconvolutionMethod::wiener;
    for (const foundTrace &trace : traces)
        if (isApplied(trace, options))
            settings.kernels.push_back(latentTrace(trace.kernel, trace.region, options.strength));

    const stopwatch rendering;
    if (settings.kernels.empty())
    {
        savePhotoUnchanged(picture, options.output, context);
        context.notes.push_back(options.output + ": nothing was removed; the picture is as it was");
    }
    else
    {
        photoWriter result(picture, options.output);
        renderPhoto(picture, result, settings, context);
    }
    seconds.render = rendering.seconds();

    if (!options.kernelPicture.empty())
        writePictureOfKernels(options, traces, context);
    return answer(options, traces, seconds, context);
}

} // namespace Stillmark
