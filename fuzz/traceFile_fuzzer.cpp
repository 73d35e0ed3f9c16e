#include "framework/base/exceptions.h"
#include "fuzz/fuzzing.h"
#include "store/files/fileHeader.h"

using namespace Fuzzing;

namespace
{

std::unique_ptr<Project::PKernel> readFile(Project::PKernelCollection &traces, Sarnik::CContainer &in)
try
{
    traces.SetLastError({});
    ReadHeader(traces, in);
    return traces.GetLastError().empty() ? ReadTrace(traces, in) : nullptr;
}
catch (const Sarnik::CException &)
{
    return nullptr;
}

std::string written(const Project::PKernelCollection &traces, const Project::PKernel &trace)
{
    Sarnik::CMemoryContainer out;
    WriteHeader(traces, out);
    trace.Write(out);
    return contentOf(out);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t *data, std::size_t size)
{
    static collectionForSamples samples;
    Sarnik::CMemoryContainer in = containerOf(data, size);
    if (const auto trace = readFile(samples.traces, in))
    {
        trace->IsApplied();
        const std::string first = written(samples.traces, *trace);
        Sarnik::CMemoryContainer again =
            containerOf(reinterpret_cast<const std::uint8_t *>(first.data()), first.size());
        const auto second = readFile(samples.traces, again);
        require(second && again.Remaining() == 0 && written(samples.traces, *second) == first);
    }
    return 0;
}
