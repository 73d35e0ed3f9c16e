#include "shell/pageFile.h"

#include <algorithm>

namespace Sarnik
{

namespace
{

/// The disk is asked for room in steps of this size, so that single pages cost no system calls.
constexpr std::uint64_t growthStep = std::uint64_t{16} << 20;
/// Pages of this size and above begin at a multiple of it, which suits the system's own pages.
constexpr std::uint64_t pageAlignment = 4096;

constexpr std::uint64_t roundUp(std::uint64_t value, std::uint64_t step)
{
    return (value + step - 1) / step * step;
}

} // namespace

CPageFile::CPageFile(const ScratchVolume &volume)
    : file(0, volume.folder), room(std::min(volume.room, locationUnits * locationUnitBytes))
{
}

std::uint64_t CPageFile::Cut(int diskClass, std::uint64_t count, std::uint32_t &firstUnit)
{
    const std::uint64_t size = tileBytes(diskClass);
    const std::uint64_t first = roundUp(used, std::min(size, pageAlignment));
    if (first >= room)
        return 0;
    count = std::min(count, (room - first) / size);
    // With too little room on the disk, as many pages as there is room for: found by halving.
    while (count > 0 && !GrowTo(first + count * size))
        count /= 2;
    if (count > 0)
        used = first + count * size;
    firstUnit = static_cast<std::uint32_t>(first / locationUnitBytes);
    return count;
}

bool CPageFile::GrowTo(std::uint64_t bytes)
{
    if (bytes <= file.size())
        return true;
    const std::uint64_t generous = std::min(room, roundUp(bytes, growthStep));
    for (const std::uint64_t size : {generous, bytes})
    {
        try
        {
            file.grow(size);
            return true;
        }
        catch (const Platform::fileError &)
        {
            // The next size, or the answer that there is no room.
        }
    }
    return false;
}

void CPageFile::Read(std::uint32_t unit, void *bytes, std::size_t size) const
{
    file.read(unit * locationUnitBytes, bytes, size);
}

void CPageFile::Write(std::uint32_t unit, const void *bytes, std::size_t size)
{
    file.write(unit * locationUnitBytes, bytes, size);
}

} // namespace Sarnik
