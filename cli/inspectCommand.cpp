#include "cli/commands.h"
#include "cli/jsonWriter.h"
#include "cli/kernelArrays.h"
#include "cli/runRecord.h"
#include "cli/traceRegion.h"
#include "deblur/estimate/kernelMeasures.h"
#include "platform/files.h"
#include "store/files/inspectFile.h"

#include <cstdio>
#include <fstream>
#include <variant>

namespace Stillmark
{
namespace
{

/// A kernel of the file, and what is said of it.
struct shownKernel
{
    CorvaneDeblur::floatArray kernel;
    bool reliable = false;
};

void drawKernels(const std::string &path, const std::vector<shownKernel> &shown, runContext &context)
{
    std::vector<kernelSamples> kernels;
    std::vector<std::string> captions;
    for (const shownKernel &one : shown)
    {
        if (one.kernel.empty())
            continue;
        kernels.push_back(toSamples(one.kernel));
        char sparsity[32];
        std::snprintf(sparsity, sizeof sparsity, "%.2f", CorvaneDeblur::kernelSparsity(one.kernel));
        captions.push_back(std::to_string(one.kernel.cols) + " x " + std::to_string(one.kernel.rows) + " pixels\n" +
                           (one.reliable ? "good" : "poor") + " (sparsity " + sparsity + ")");
    }
    if (kernels.empty())
        context.notes.push_back(path + ": not written, as there is no kernel");
    else
        writeKernelPicture(path, kernels, captions);
}

bool isRecordedRun(const std::string &path)
{
    std::ifstream in(path, std::ios::binary);
    char magic[8] = {};
    return in.read(magic, sizeof magic) && std::string_view(magic, sizeof magic) == "TNACTION";
}

struct valueText
{
    std::string operator()(std::int32_t number) const { return std::to_string(number); }
    std::string operator()(bool flag) const { return flag ? "yes" : "no"; }
    std::string operator()(const std::vector<std::uint8_t> &data) const
    {
        return std::to_string(data.size()) + " bytes";
    }
};

struct valueJson
{
    std::string operator()(std::int32_t number) const { return jsonNumber(number); }
    std::string operator()(bool flag) const { return jsonBool(flag); }
    std::string operator()(const std::vector<std::uint8_t> &data) const
    {
        return jsonObject({{"bytes", jsonNumber(static_cast<int>(data.size()))}});
    }
};

commandResult inspectRun(const inspectOptions &options, runContext &context)
{
    const recordedAction action = recordedAction::read(options.file);
    commandResult result;
    result.text = options.file + ": a recorded run\n";
    std::vector<std::string> values, traceTexts;
    for (const recordedAction::entry &entry : action.entries())
    {
        result.text += "  " + keyText(entry.key) + "  " + std::visit(valueText(), entry.content) + "\n";
        values.push_back(
            jsonObject({{"key", jsonString(keyText(entry.key))}, {"value", std::visit(valueJson(), entry.content)}}));
    }
    std::vector<shownKernel> kernels;
    for (const recordedTrace &trace : streamOf(action).empty() ? std::vector<recordedTrace>() : tracesOf(action))
    {
        const bool reliable = !trace.kernel.empty() && CorvaneDeblur::isGoodKernel(trace.kernel);
        kernels.push_back({trace.kernel, reliable});
        result.text += "  trace in " + regionText(trace.region) + ", size " + std::to_string(trace.size) +
                       (trace.kernel.empty() ? ", not estimated"
                        : reliable           ? ", good"
                                             : ", poor") +
                       (trace.active ? "" : ", not used") + "\n";
        traceTexts.push_back(jsonObject({{"region", jsonRectangle(trace.region)},
                                         {"size", jsonNumber(trace.size)},
                                         {"kernel", jsonNumber(trace.kernel.cols)},
                                         {"good", jsonBool(reliable)},
                                         {"active", jsonBool(trace.active)}}));
    }
    result.text.pop_back();
    result.json = jsonObject({{"file", jsonString(options.file)},
                              {"kind", jsonString("recorded run")},
                              {"values", jsonArray(values)},
                              {"traces", jsonArray(traceTexts)}});
    if (!options.picture.empty())
        drawKernels(options.picture, kernels, context);
    return result;
}

} // namespace

commandResult inspectFile(const inspectOptions &options, runContext &context)
{
    if (!options.picture.empty())
        Platform::checkWritable(options.picture);
    if (isRecordedRun(options.file))
        return inspectRun(options, context);

    std::optional<Project::PImageSize> size;
    if (options.imageSize)
        size = Project::PImageSize{options.imageSize->first, options.imageSize->second};
    const Project::PInspection found = Project::InspectFile(options.file, size);
    if (!options.picture.empty())
    {
        std::vector<shownKernel> kernels;
        for (const Project::PInspectedTrace &trace : found.traces)
            kernels.push_back({trace.kernel, trace.reliable});
        drawKernels(options.picture, kernels, context);
    }
    std::string text = DescribeInspection(found);
    if (!text.empty())
        text.pop_back(); // the last line's end
    return {found.result ? 0 : 1, std::move(text), InspectionJson(found)};
}

} // namespace Stillmark
