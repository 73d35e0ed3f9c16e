#pragma once

#include "platform/files.h"
#include "shell/virtualTile.h"

#include <cstddef>
#include <cstdint>
#include <string>

namespace Sarnik
{

/// A folder for page files, and how much may be used of it.
struct ScratchVolume
{
    std::string folder;
    std::uint64_t room = locationUnits * locationUnitBytes; ///< bytes; 64 GiB of a volume at most are used
};

/// A scratch file that is cut into pages from its start and grows with them. It has no name, so nothing of it is left
/// when the process ends in whatever way. Failures throw Platform::fileError.
class CPageFile
{
public:
    explicit CPageFile(const ScratchVolume &volume);

    /// Sets aside room for up to count pages in a row of the given class. Answers how many there was room for, which
    /// may be none, and the first one's distance from the start of the file in units of 256 bytes.
    std::uint64_t Cut(int diskClass, std::uint64_t count, std::uint32_t &firstUnit);

    void Read(std::uint32_t unit, void *bytes, std::size_t size) const;
    void Write(std::uint32_t unit, const void *bytes, std::size_t size);

private:
    bool GrowTo(std::uint64_t bytes);

    Platform::scratchFile file;
    std::uint64_t room;     ///< the file never grows beyond
    std::uint64_t used = 0; ///< bytes cut so far
};

} // namespace Sarnik
