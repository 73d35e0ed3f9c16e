#include "cli/commands.h"
#include "cli/filterRun.h"
#include "cli/jsonWriter.h"
#include "cli/kernelArrays.h"
#include "cli/photoAnalysis.h"
#include "cli/photoRender.h"
#include "cli/runRecord.h"
#include "cli/stopwatch.h"
#include "cli/traceEstimation.h"
#include "cli/traceFiles.h"
#include "cli/tracePlan.h"
#include "cli/traceRegion.h"
#include "platform/files.h"

#include <algorithm>
#include <optional>

namespace Stillmark
{
namespace
{

using CorvaneDeblur::estimateStatus;

void checkTargets(const removeOptions &options)
{
    photoWriter::check(options.output);
    for (const std::string &path : {options.kernelPicture, options.record, options.saveWorkspace})
        if (!path.empty())
            Platform::checkWritable(path);
}

/// What the plug-in is asked to do.
recordedAction actionFor(const removeOptions &options, const photo &picture, const rectangle &area, runContext &context)
{
    if (!options.replay.empty())
        return recordedAction::read(options.replay);
    if (!options.workspace.empty())
        return workspaceAction(options.workspace, area.width, area.height, options.artifactSuppression, context.notes);
    if (isAutomatic(options, area))
        return automaticAction(options.artifactSuppression);
    const tracePlan plan = planTraces(options, picture, area, context);
    std::vector<recordedTrace> traces;
    for (const rectangle &region : plan.regions)
        traces.push_back({region, plan.size, options.noise, options.strength, options.force, {}});
    return actionWith(traces, area.width, area.height, options.artifactSuppression);
}

/// What the plug-in found, judged.
std::vector<foundTrace> judged(const std::vector<recordedTrace> &recorded, const removeOptions &options)
{
    const bool allWanted = options.replay.empty() && options.workspace.empty();
    std::vector<foundTrace> traces;
    for (const recordedTrace &trace : recorded)
    {
        foundTrace found = judgeTrace(trace.region, trace.size | 1, trace.kernel);
        if (allWanted && !trace.active && found.status == estimateStatus::finished && !found.point)
            found.status = estimateStatus::noStructure; // why else the plug-in should have left it out
        found.active = trace.active;
        found.forced = trace.forced;
        traces.push_back(std::move(found));
    }
    return traces;
}

bool isApplied(const foundTrace &trace, const removeOptions &options)
{
    const bool forced = options.force || trace.forced;
    return trace.active && trace.status == estimateStatus::finished && (isUsable(trace) || forced);
}

/// Why the plug-in found nothing by itself.
void noteNothingFound(const photo &picture, const rectangle &area, runContext &context)
{
    const bool structure = photoAnalysis(picture, area, context).hasStructure(0);
    context.notes.push_back(picture.path() +
                            (structure ? ": no region found in which the blur could be seen well enough; --region "
                                         "chooses one"
                                       : ": no structure found: there are no edges to see a blur by"));
}

/// Tells which traces are left out, and how to have them all the same.
void noteTraces(const std::vector<foundTrace> &traces, const removeOptions &options, runContext &context)
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

commandResult answer(const removeOptions &options, const std::vector<foundTrace> &traces, const filterAnswer &run,
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
        result.text += options.output + ": the blur was removed (" + secondsText(run.findSeconds) + " to find it, " +
                       secondsText(run.renderSeconds) + " to remove it)";
    result.json = jsonObject({{"traces", jsonArray(traceTexts)},
                              {"seconds", jsonObject({{"estimate", jsonNumber(run.findSeconds)},
                                                      {"render", jsonNumber(run.renderSeconds)}})},
                              {"output", jsonString(options.output)},
                              {"notes", jsonArray(noteTexts)}});
    return result;
}

} // namespace

commandResult removeBlur(const removeOptions &options, runContext &context)
{
    checkTargets(options);
    const photo picture = openPhoto(options.photo, context);
    std::optional<selectionMask> selection;
    if (!options.selection.empty())
        selection = selectionMask::open(options.selection, picture.width(), picture.height(), context.progress());
    const rectangle area = selection ? selection->bounds() : wholeOf(picture);

    resultRaster result(picture, options.output);
    const recordedAction action = actionFor(options, picture, area, context);
    const filterAnswer run =
        runFilter(picture, result, {action, selection ? &*selection : nullptr, options.yes}, context);
    const std::vector<foundTrace> traces = judged(tracesOf(run.recorded), options);
    if (traces.empty() && options.replay.empty() && options.workspace.empty() && isAutomatic(options, area))
        noteNothingFound(picture, area, context);
    noteTraces(traces, options, context);

    if (std::any_of(traces.begin(), traces.end(), [&](const foundTrace &t) { return isApplied(t, options); }))
        saveResult(result, context);
    else
    {
        savePhotoUnchanged(picture, options.output, context);
        context.notes.push_back(options.output + ": nothing was removed; the picture is as it was");
    }
    if (!options.kernelPicture.empty())
        writePictureOfKernels(options, traces, context);
    if (!options.record.empty())
        run.recorded.write(options.record);
    if (!options.saveWorkspace.empty())
        saveWorkspace(options.saveWorkspace, run.recorded, area.width, area.height);
    return answer(options, traces, run, context);
}

} // namespace Stillmark
