#include "framework/pixels/tileShape.h"

#include <stdexcept>

namespace Sarnik
{

CTileShape tileShape(std::uint32_t tileSpec, int depthLog)
{
    if (depthLog < 3 || depthLog > 5)
        throw std::invalid_argument("paged pixels have 8, 16 or 32 bits a sample");

    std::uint32_t sizeClass = tileSpec;
    if (tileSpec & tilePreset)
    {
        const std::uint32_t preset = tileSpec & ~tilePreset;
        if (preset > 4)
            throw std::invalid_argument("no such preset of tiles");
        // 64 x 64 bytes are class 4; each preset has four times the pixels of the one before.
        sizeClass = 4 + 2 * preset + static_cast<std::uint32_t>(depthLog - 3);
    }
    if (sizeClass >= tileClassCount)
        throw std::invalid_argument("no such class of tiles");

    const int pixelsLog = 8 + static_cast<int>(sizeClass) - (depthLog - 3);
    return {static_cast<int>(sizeClass), std::int32_t{1} << ((pixelsLog + 1) / 2), std::int32_t{1} << (pixelsLog / 2)};
}

} // namespace Sarnik
