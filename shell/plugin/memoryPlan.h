#pragma once

#include <cstdint>

namespace Sarnik
{

/// How the bytes that a host grants are divided: `buffers` for the host's buffer side, `rest` for the plug-in's own.
struct memoryShares
{
    std::int64_t buffers = 0, rest = 0;
};

/// Keeps each of the wanted shares at a least of 512 KiB, or half of a total that is below twice that, and both within
/// the total.
memoryShares limitShares(std::int64_t total, memoryShares wanted);

/// Four fifths, to the nearest byte, and what is left.
constexpr memoryShares fourFifths(std::int64_t total)
{
    const std::int64_t first = total / 5 * 4 + (total % 5 * 4 + 2) / 5;
    return {first, total - first};
}

/// Bytes that the virtual heap may hold: half of the machine's memory or what the plan left for buffers, whichever is
/// less, each counted as at least 32 MiB and at most 3 GiB.
std::uint64_t heapLimit(std::uint64_t physicalMemory, std::int64_t bufferSpace);

} // namespace Sarnik
