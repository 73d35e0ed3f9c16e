#include "store/files/fileBytes.h"

#include "framework/base/exceptions.h"
#include "framework/base/localisedString.h"
#include "platform/files.h"
#include "store/traces/kernelCollection.h"

#include <exception>

namespace Project
{

Sarnik::CMemoryContainer ReadFileBytes(const std::string &path)
{
    const std::vector<std::uint8_t> bytes = Platform::readWholeFile(path, kLongestTraceFile);
    return Sarnik::CMemoryContainer(std::as_bytes(std::span(bytes)));
}

bool LoadFile(PKernelCollection &collection, const std::string &path,
              const std::function<bool(Sarnik::CContainer &in)> &read)
{
    bool done = false;
    collection.SetLastError({});
    try
    {
        Sarnik::CMemoryContainer in = ReadFileBytes(path);
        done = read(in) && collection.GetLastError().empty();
    }
    catch (const Sarnik::CException &)
    {
    }
    catch (const std::exception &) // no such file, no memory
    {
    }
    if (!done && collection.GetLastError().empty())
        collection.SetLastError(Sarnik::Localize(kUnrecognizedFormat));
    return done;
}

bool SaveFile(const std::string &directory, const std::string &name,
              const std::function<bool(Sarnik::CContainer &out)> &write)
try
{
    Sarnik::CMemoryContainer out;
    if (!write(out) || out.Size() == 0)
        return false;
    Platform::atomicFile file(directory.empty() ? name : directory + "/" + name);
    file.write(out.Content().data(), out.Size());
    file.commit(true);
    return true;
}
catch (const Sarnik::CException &)
{
    return false;
}
catch (const std::exception &)
{
    return false;
}

} // namespace Project
