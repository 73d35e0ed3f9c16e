#include "framework/base/exceptions.h"
#include "fuzz/fuzzing.h"
#include "store/files/collectionStream.h"
#include "store/files/fileHeader.h"

using namespace Fuzzing;

namespace
{

/// Whatever is read is a sound collection, which survives being written and read again.
void readAndCheck(Project::PKernelCollection &traces, Sarnik::CContainer &in)
{
    traces.SetLastError({});
    try
    {
        ReadHeader(traces, in);
        if (!traces.GetLastError().empty())
            return;
        ReadCollection(traces, in);
    }
    catch (const Sarnik::CException &)
    {
    }
    require(traces.SelectedIndex() >= -1 && traces.SelectedIndex() < traces.Count());
    require(traces.ActiveCount() <= traces.Count());
    for (int i = 0; i < traces.Count(); ++i)
        require(RegionFits(traces, *traces.At(i)));
}

std::string written(const Project::PKernelCollection &traces)
{
    Sarnik::CMemoryContainer out;
    WriteHeader(traces, out);
    WriteCollection(traces, out);
    return contentOf(out);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t *data, std::size_t size)
{
    static collectionForSamples samples;
    Sarnik::CMemoryContainer in = containerOf(data, size);
    readAndCheck(samples.traces, in);

    const std::string first = written(samples.traces);
    Sarnik::CMemoryContainer again = containerOf(reinterpret_cast<const std::uint8_t *>(first.data()), first.size());
    readAndCheck(samples.traces, again);
    require(samples.traces.GetLastError().empty() && again.Remaining() == 0);
    require(written(samples.traces) == first);
    samples.traces.Clear();
    return 0;
}
