#include "platform/json.h"
#include "store/files/inspectFile.h"

#include <algorithm>
#include <cmath>
#include <cstdarg>
#include <cstdio>

namespace Project
{

namespace
{

using Platform::jsonArray;
using Platform::jsonBool;
using Platform::jsonNumber;
using Platform::jsonObject;
using Platform::jsonString;

struct kindNames
{
    const char *className, *words;
};

const kindNames &NamesOf(PKernelKind kind)
{
    static constexpr kindNames names[] = {
        {"PEstimatedKernel", "estimated"}, {"PManualKernel", "a straight line"}, {"PReadOnlyKernel", "read-only"}};
    return names[static_cast<std::uint32_t>(kind) - 1];
}

float Sum(const CorvaneDeblur::floatArray &kernel)
{
    double sum = 0.0;
    for (int y = 0; y < kernel.rows; ++y)
        for (int x = 0; x < kernel.cols; ++x)
            sum += kernel.row(y)[x];
    return static_cast<float>(sum);
}

std::string JsonRect(const Sarnik::CRect &r)
{
    return jsonArray({jsonNumber(r.left), jsonNumber(r.top), jsonNumber(r.right), jsonNumber(r.bottom)});
}

std::string JsonKernel(const CorvaneDeblur::floatArray &kernel)
{
    if (kernel.empty())
        return "null";
    std::vector<std::string> samples;
    for (int y = 0; y < kernel.rows; ++y)
        for (int x = 0; x < kernel.cols; ++x)
            samples.push_back(jsonNumber(kernel.row(y)[x]));
    return jsonObject(
        {{"size", jsonNumber(kernel.cols)}, {"sum", jsonNumber(Sum(kernel))}, {"samples", jsonArray(samples)}});
}

std::string JsonSettings(const KernelSettings &s)
{
    return jsonObject({{"mode", jsonNumber(s.mode)},
                       {"size", jsonNumber(s.size)},
                       {"estimatorOptions", jsonNumber(s.estimatorOptions)},
                       {"estimatorTuningA", jsonNumber(s.estimatorTuningA)},
                       {"estimatorTuningB", jsonNumber(s.estimatorTuningB)},
                       {"threadWeight", jsonNumber(s.threadWeight)},
                       {"threadFlag", jsonBool(s.threadFlag)},
                       {"deconvFlagA", jsonBool(s.deconvFlagA)},
                       {"deconvFlagB", jsonBool(s.deconvFlagB)},
                       {"deconvWeight", jsonNumber(s.deconvWeight)},
                       {"smoothing", jsonNumber(s.smoothing)},
                       {"deconvIterations", jsonNumber(s.deconvIterations)},
                       {"noiseLevel", jsonNumber(s.noiseLevel)},
                       {"forcedApply", jsonBool(s.forcedApply)},
                       {"maskThreshold", jsonNumber(s.maskThreshold & 0xFF)},
                       {"anchorX", jsonNumber(s.anchorX)},
                       {"anchorY", jsonNumber(s.anchorY)},
                       {"suppression", jsonNumber(s.suppression)}});
}

std::string JsonTrace(const PInspectedTrace &trace)
{
    std::string line = "null";
    if (trace.line)
        line = jsonArray({jsonNumber(trace.line->first.x), jsonNumber(trace.line->first.y),
                          jsonNumber(trace.line->second.x), jsonNumber(trace.line->second.y)});
    return jsonObject({{"class", jsonString(NamesOf(trace.kind).className)},
                       {"region", JsonRect(trace.region)},
                       {"settings", JsonSettings(trace.settings)},
                       {"kernel", JsonKernel(trace.kernel)},
                       {"reliable", jsonBool(trace.reliable)},
                       {"line", line}});
}

std::string JsonPreferences(const PPreferences &preferences)
{
    const PWindowPlacement &frame = preferences.frame;
    const PParams &p = preferences.parameters;
    std::vector<std::string> rectangles, flags;
    for (const std::int32_t edge : frame.rectangles)
        rectangles.push_back(jsonNumber(edge));
    for (const std::uint16_t flag : frame.flags)
        flags.push_back(jsonNumber(flag));
    return jsonObject(
        {{"flags", jsonNumber(preferences.flags)},
         {"frame", jsonObject({{"kind", jsonNumber(frame.kind)},
                               {"mode", jsonNumber(frame.mode)},
                               {"rectangles", jsonArray(rectangles)},
                               {"position", jsonArray({jsonNumber(frame.positionX), jsonNumber(frame.positionY)})},
                               {"offset", jsonArray({jsonNumber(frame.offsetX), jsonNumber(frame.offsetY)})},
                               {"flags", jsonArray(flags)}})},
         {"parameters", jsonObject({{"showPreview", jsonBool(p.showPreview)},
                                    {"showRegions", jsonBool(p.showRegions)},
                                    {"lastFolder", jsonString(p.lastFolder)},
                                    {"tileSize", jsonNumber(p.tileSize)},
                                    {"overflowColour", jsonNumber(p.overflowColour)},
                                    {"autoTraceCount", jsonNumber(p.autoTraceCount)},
                                    {"advancedOpen", jsonBool(p.advancedOpen)},
                                    {"fineResult", jsonBool(p.fineResult)},
                                    {"accuratePreview", jsonBool(p.accuratePreview)},
                                    {"previewWindowOpen", jsonBool(p.previewWindowOpen)}})}});
}

/// As printf, for short lines.
[[gnu::format(printf, 1, 2)]] std::string Line(const char *format, ...)
{
    char text[400];
    std::va_list arguments;
    va_start(arguments, format);
    std::vsnprintf(text, sizeof text, format, arguments);
    va_end(arguments);
    return std::string(text) + "\n";
}

const char *NoiseText(std::uint32_t level)
{
    constexpr const char *texts[] = {"low", "medium", "high", "automatic"};
    return texts[std::min<std::uint32_t>(level, 3)];
}

std::string DescribeTrace(std::size_t number, const PInspectedTrace &trace)
{
    std::string out = Line("Trace %zu: %s", number, NamesOf(trace.kind).words);
    const Sarnik::CRect &r = trace.region;
    if (r.Empty())
        out += Line("    region: the whole picture");
    else
        out += Line("    region: %lld x %lld pixels at %d,%d", static_cast<long long>(r.Width()),
                    static_cast<long long>(r.Height()), r.left, r.top);
    if (trace.line)
        out += Line("    line: from %g,%g to %g,%g", trace.line->first.x, trace.line->first.y, trace.line->second.x,
                    trace.line->second.y);
    if (trace.kernel.empty())
        out += Line("    kernel: none yet");
    else
        out += Line("    kernel: %d x %d, sum %g, %s", trace.kernel.cols, trace.kernel.rows, Sum(trace.kernel),
                    trace.reliable ? "trustworthy" : "doubtful");
    const KernelSettings &s = trace.settings;
    out += Line("    settings: size %d, noise %s, smoothing %g %%, suppression %g %%%s%s", s.size,
                NoiseText(s.noiseLevel), std::round(s.smoothing * 1000.0) / 10.0,
                std::round(s.suppression * 1000.0) / 10.0, s.forcedApply ? ", applied in any case" : "",
                (s.maskThreshold & 0xFF) == 255 ? "" : ", bright pixels left out");
    return out;
}

/// Traces count from 1 here.
std::string DescribeTraces(const PInspection &inspection)
{
    std::string out = Line("%zu trace%s", inspection.traces.size(), inspection.traces.size() == 1 ? "" : "s");
    if (inspection.kind == PInspection::Kind::Workspace)
    {
        const bool selects =
            inspection.selected >= 0 && static_cast<std::size_t>(inspection.selected) < inspection.traces.size();
        out += selects ? Line("Selected: %d", inspection.selected + 1) : Line("Selected: none");
        std::string active;
        for (const std::int32_t index : inspection.active)
            active += (active.empty() ? "" : ", ") + (index < 0 ? "one that is not there" : std::to_string(index + 1));
        out += "Active: " + (active.empty() ? "none" : active) + "\n";
        if (inspection.defaultSize > 0)
            out += Line("Blur Trace Bounds found automatically: %u", inspection.defaultSize);
    }
    for (std::size_t i = 0; i < inspection.traces.size(); ++i)
        out += DescribeTrace(i + 1, inspection.traces[i]);
    return out;
}

const char *OnOff(bool value)
{
    return value ? "on" : "off";
}

std::string DescribePreferences(const PParams &p)
{
    return Line("Preview: %s, accurate preview: %s, regions shown: %s", OnOff(p.showPreview), OnOff(p.accuratePreview),
                OnOff(p.showRegions)) +
           Line("Artifact Suppression: %s", OnOff(p.fineResult)) +
           Line("Automatic traces: %u, tile size: %u, overflow colour: #%08x", p.autoTraceCount, p.HubTileSize(),
                p.overflowColour) +
           Line("Advanced pane: %s, preview window: %s", p.advancedOpen ? "open" : "closed",
                p.previewWindowOpen ? "open" : "closed") +
           "Last folder: " + Platform::jsonString(p.lastFolder) + "\n"; // quoted: it may hold anything
}

std::string KindLine(const PInspection &inspection)
{
    switch (inspection.kind)
    {
    case PInspection::Kind::Workspace:
        return "workspace";
    case PInspection::Kind::Trace:
        return "Blur Trace";
    case PInspection::Kind::Picture:
        return "Blur Trace as a picture";
    case PInspection::Kind::Preferences:
        return "preferences";
    case PInspection::Kind::Unknown:
        break;
    }
    return "unknown";
}

} // namespace

std::string DescribeInspection(const PInspection &inspection)
{
    const bool loaded = inspection.result || !inspection.traces.empty(); // the rest of a bad workspace counts, too
    std::string out = inspection.file + ": " + KindLine(inspection);
    if (inspection.version && loaded)
        out += ", version " + std::to_string(*inspection.version);
    if (inspection.bounds && loaded)
        out += ", for a picture of " + std::to_string(inspection.bounds->Width()) + " x " +
               std::to_string(inspection.bounds->Height()) + " pixels";
    out += "\n";
    if (!inspection.error.empty())
        out += inspection.error + "\n";
    if (inspection.preferences)
        out += DescribePreferences(inspection.preferences->parameters);
    else if (loaded)
        out += DescribeTraces(inspection);
    return out;
}

std::string InspectionJson(const PInspection &inspection)
{
    std::vector<std::string> active, traces;
    for (const std::int32_t index : inspection.active)
        active.push_back(index < 0 ? "null" : jsonNumber(index));
    for (const PInspectedTrace &trace : inspection.traces)
        traces.push_back(JsonTrace(trace));
    return jsonObject({{"file", jsonString(inspection.file)},
                       {"bounds", inspection.bounds ? JsonRect(*inspection.bounds) : "null"},
                       {"result", jsonBool(inspection.result)},
                       {"error", jsonString(inspection.error)},
                       {"version", inspection.version ? jsonNumber(*inspection.version) : "null"},
                       {"selected", jsonNumber(inspection.selected)},
                       {"active", jsonArray(active)},
                       {"defaultSize", jsonNumber(inspection.defaultSize)},
                       {"traces", jsonArray(traces)},
                       {"preferences", inspection.preferences ? JsonPreferences(*inspection.preferences) : "null"}});
}

} // namespace Project
