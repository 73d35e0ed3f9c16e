#include "host/document/pictureSource.h"

#include "host/photoContent.h"

#include <algorithm>

namespace Stillmark
{

int pictureSource::colourPlanes() const
{
    return colourPlanesOf(mode());
}

int pictureSource::bandRows(int areaWidth) const
{
    constexpr std::size_t bandBytes = std::size_t{8} << 20; // a tile of 1024 x 1024 pixels of four 16-bit samples
    const std::size_t rowBytes = static_cast<std::size_t>(std::max(areaWidth, 1)) *
                                 static_cast<std::size_t>(colourPlanes() + 1) * static_cast<std::size_t>(sampleBytes());
    return static_cast<int>(std::clamp<std::size_t>(bandBytes / rowBytes, 1, 1 << 16));
}

} // namespace Stillmark
