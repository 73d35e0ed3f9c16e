#include "cli/runRecord.h"

#include "framework/base/container.h"
#include "framework/base/exceptions.h"
#include "shell/tintorel.h"
#include "store/params.h"
#include "store/traces/traceRecord.h"

#include <algorithm>
#include <cstring>
#include <stdexcept>

namespace Stillmark
{
namespace
{

using namespace Project;
using Sarnik::CMemoryContainer;

constexpr std::uint32_t keyVersion = TN_CODE('a', 'c', 't', 'V'), keyAutomatic = TN_CODE('a', 'u', 't', 'K'),
                        keyFullAutomatic = TN_CODE('f', 'u', 'l', 'A'), keyHeight = TN_CODE('i', 'm', 'g', 'H'),
                        keyWidth = TN_CODE('i', 'm', 'g', 'W'), keyParameters = TN_CODE('s', 'e', 't', 'S'),
                        keyFine = TN_CODE('f', 'R', 'e', 't'), keyTraces = TN_CODE('k', 'n', 'l', 'M');

std::vector<std::uint8_t> bytesOf(const CMemoryContainer &container)
{
    std::vector<std::uint8_t> bytes(container.Content().size());
    if (!bytes.empty())
        std::memcpy(bytes.data(), container.Content().data(), bytes.size());
    return bytes;
}

PTraceRecord toRecord(const recordedTrace &trace)
{
    PTraceRecord record;
    const rectangle &r = trace.region;
    record.region = {r.x, r.y, r.x + r.width, r.y + r.height};
    record.settings.size = trace.size;
    record.settings.noiseLevel = static_cast<std::uint32_t>(trace.noise);
    record.settings.smoothing = trace.strength.smoothing;
    record.settings.suppression = trace.strength.suppression;
    record.settings.forcedApply = trace.forced;
    record.kernel = trace.kernel;
    return record;
}

recordedTrace fromRecord(const PTraceRecord &record)
{
    recordedTrace trace;
    const Sarnik::CRect &r = record.region;
    trace.region = {r.left, r.top, static_cast<int>(r.Width()), static_cast<int>(r.Height())};
    trace.size = record.settings.size;
    trace.noise = static_cast<CorvaneDeblur::noiseMode>(std::min<std::uint32_t>(record.settings.noiseLevel, 3));
    trace.strength = {record.settings.smoothing, record.settings.suppression};
    trace.forced = record.settings.forcedApply;
    trace.kernel = record.kernel;
    trace.active = false;
    return trace;
}

CMemoryContainer streamOfTraces(const std::vector<recordedTrace> &traces)
{
    CMemoryContainer stream;
    stream.WriteU32(static_cast<std::uint32_t>(traces.size()));
    stream.WriteI32(-1); // none is selected
    for (const recordedTrace &trace : traces)
        writeTrace(trace, stream);
    stream.WriteU32(static_cast<std::uint32_t>(
        std::count_if(traces.begin(), traces.end(), [](const auto &t) { return t.active; })));
    for (std::uint32_t i = 0; i < traces.size(); ++i)
        if (traces[i].active)
            stream.WriteU32(i);
    stream.WriteU32(0); // no size was found automatically
    return stream;
}

recordedAction begin(bool automatic, int version)
{
    recordedAction action;
    action.put(keyVersion, std::int32_t{version});
    action.put(keyAutomatic, automatic);
    return action;
}

void finish(recordedAction &action, bool artifactSuppression, std::vector<std::uint8_t> stream)
{
    CMemoryContainer parameters;
    PParams record;
    record.fineResult = artifactSuppression;
    WriteParameters(parameters, record);
    action.put(keyParameters, bytesOf(parameters));
    action.put(keyFine, artifactSuppression);
    action.put(keyTraces, std::move(stream));
}

std::vector<recordedTrace> readStream(CMemoryContainer &stream)
{
    std::vector<recordedTrace> traces;
    const std::uint32_t count = stream.ReadU32();
    stream.ReadI32();
    for (std::uint32_t i = 0; i < count; ++i) // each reads something, so the data bounds it
    {
        const std::uint32_t kind = stream.ReadU32();
        PTraceRecord record = ReadCommonRecord(stream, kNewestTraceVersion);
        if (kind == static_cast<std::uint32_t>(PKernelKind::Manual))
            ReadLine(stream, record);
        traces.push_back(fromRecord(record));
    }
    const std::uint32_t active = stream.ReadU32();
    for (std::uint32_t i = 0; i < active; ++i)
        if (const std::uint32_t index = stream.ReadU32(); index < traces.size())
            traces[index].active = true;
    return traces;
}

} // namespace

void writeTrace(const recordedTrace &trace, Sarnik::CContainer &out)
{
    out.WriteU32(static_cast<std::uint32_t>(PKernelKind::Estimated));
    WriteCommonRecord(out, toRecord(trace));
}

recordedAction automaticAction(bool artifactSuppression)
{
    recordedAction action = begin(true, kNewestTraceVersion);
    action.put(keyFullAutomatic, true);
    finish(action, artifactSuppression, bytesOf(streamOfTraces({})));
    return action;
}

recordedAction actionOfStream(std::vector<std::uint8_t> stream, int version, int width, int height,
                              bool artifactSuppression)
{
    recordedAction action = begin(false, version);
    action.put(keyHeight, height);
    action.put(keyWidth, width);
    finish(action, artifactSuppression, std::move(stream));
    return action;
}

recordedAction actionWith(const std::vector<recordedTrace> &traces, int width, int height, bool artifactSuppression)
{
    return actionOfStream(bytesOf(streamOfTraces(traces)), kNewestTraceVersion, width, height, artifactSuppression);
}

std::vector<std::uint8_t> streamOf(const recordedAction &action)
{
    const recordedAction::value *value = action.find(keyTraces);
    const auto *bytes = value != nullptr ? std::get_if<std::vector<std::uint8_t>>(value) : nullptr;
    return bytes != nullptr ? *bytes : std::vector<std::uint8_t>();
}

std::vector<recordedTrace> tracesOf(const recordedAction &action)
{
    const std::vector<std::uint8_t> bytes = streamOf(action);
    if (bytes.empty())
        throw std::runtime_error("the recorded run holds no traces");
    CMemoryContainer stream(std::as_bytes(std::span(bytes)));
    try
    {
        return readStream(stream);
    }
    catch (const Sarnik::CException &e)
    {
        throw std::runtime_error("the recorded run cannot be read: " + e.GetErrorString());
    }
}

} // namespace Stillmark
