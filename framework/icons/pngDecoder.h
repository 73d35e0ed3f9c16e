#pragma once

#include "platform/canvas/raster.h"

#include <cstddef>
#include <cstdint>
#include <span>

namespace Sarnik
{

/// Pixels of a PNG in memory, of any colour type and depth.
class CPNGDecoder
{
public:
    /// A picture that is wider or higher than `largest` pixels is refused before anything is allocated.
    explicit CPNGDecoder(std::uint32_t largest) : largestSide(largest) {}

    /// Empty where the bytes are no PNG that can be read to its end. Throws std::bad_alloc.
    Platform::raster Decode(std::span<const std::byte> png) const;

private:
    std::uint32_t largestSide;
};

} // namespace Sarnik
