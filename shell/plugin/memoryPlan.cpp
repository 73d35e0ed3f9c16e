#include "shell/plugin/memoryPlan.h"

#include <algorithm>

namespace Sarnik
{

memoryShares limitShares(std::int64_t total, memoryShares wanted)
{
    const std::int64_t least = std::min<std::int64_t>(total / 2, 524288);
    memoryShares shares;
    shares.buffers = wanted.buffers < least ? least : std::min(total - least, wanted.buffers);
    shares.rest = wanted.rest < least ? least : std::min(wanted.rest, total - shares.buffers);
    return shares;
}

std::uint64_t heapLimit(std::uint64_t physicalMemory, std::int64_t bufferSpace)
{
    const auto clamped = [](std::uint64_t bytes) {
        return std::clamp<std::uint64_t>(bytes, std::uint64_t{32} << 20, std::uint64_t{3} << 30);
    };
    return std::min(clamped(physicalMemory / 2),
                    clamped(static_cast<std::uint64_t>(std::max<std::int64_t>(bufferSpace, 0))));
}

} // namespace Sarnik
