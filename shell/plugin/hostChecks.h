#pragma once

#include <cstdint>
#include <optional>

namespace Project
{

/// The smallest picture or selection, in pixels a side, that a run takes.
constexpr int smallestSide = 50;

/// Whether a host of this version (major << 16 | minor << 8 | fix; none: it does not tell) is recent enough:
/// after 13.0.
constexpr bool supportsHostVersion(std::optional<std::intptr_t> version)
{
    if (!version)
        return false;
    const std::intptr_t major = *version >> 16;
    const std::intptr_t minor = *version >> 8 & 0xFF;
    return major > 13 || (major == 13 && minor != 0);
}

} // namespace Project
