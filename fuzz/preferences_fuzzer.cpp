#include "framework/base/exceptions.h"
#include "fuzz/fuzzing.h"
#include "store/preferences.h"
#include "store/preferencesFormat.h"

using namespace Fuzzing;

namespace
{

std::string written(const Project::PPreferences &preferences)
{
    Sarnik::CMemoryContainer out;
    WritePreferences(out, preferences);
    return contentOf(out);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t *data, std::size_t size)
{
    Sarnik::CMemoryContainer in = containerOf(data, size);
    Project::PPreferences preferences;
    try
    {
        ReadPreferences(in, preferences);
    }
    catch (const Sarnik::CException &)
    {
        return 0;
    }
    const std::string first = written(preferences);
    Sarnik::CMemoryContainer again = containerOf(reinterpret_cast<const std::uint8_t *>(first.data()), first.size());
    Project::PPreferences second;
    require(ReadPreferences(again, second) && again.Remaining() == 0 && written(second) == first);
    return 0;
}
