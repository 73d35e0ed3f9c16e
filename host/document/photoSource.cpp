#include "host/document/photoSource.h"

#include <algorithm>
#include <cassert>

namespace Stillmark
{
namespace
{

bool contains(const rectangle &outer, const rectangle &inner)
{
    return inner.x >= outer.x && inner.y >= outer.y && inner.x + inner.width <= outer.x + outer.width &&
           inner.y + inner.height <= outer.y + outer.height;
}

} // namespace

photoSource::photoSource(photo shownPhoto)
    : picture(std::move(shownPhoto)), keptPlanes(picture.colourPlanes() + (picture.hasTransparency() ? 1 : 0))
{
}

planeSamples photoSource::plane(int number, const rectangle &area)
{
    assert(number >= 0 && number < planes() && area.width > 0 && area.height > 0);
    const std::size_t rowBytes = static_cast<std::size_t>(area.width) * picture.sampleBytes();
    const std::size_t planeBytes = rowBytes * static_cast<std::size_t>(area.height);
    if (number >= keptPlanes)
    {
        mask.resize(planeBytes);
        picture.readPlanes(area, number, 1, mask.data(), rowBytes);
        return {mask.data(), rowBytes};
    }

    ++clock;
    for (keptArea &each : kept)
        if (each.area.width > 0 && contains(each.area, area))
        {
            each.used = clock;
            return within(each, number, area);
        }

    keptArea &oldest =
        *std::min_element(kept.begin(), kept.end(), [](const auto &a, const auto &b) { return a.used < b.used; });
    oldest.area.width = 0; // in case that reading fails
    oldest.planes.resize(planeBytes * static_cast<std::size_t>(keptPlanes));
    picture.readPlanes(area, 0, keptPlanes, oldest.planes.data(), rowBytes);
    oldest.area = area;
    oldest.used = clock;
    return within(oldest, number, area);
}

planeSamples photoSource::within(const keptArea &from, int number, const rectangle &area) const
{
    const auto bytes = static_cast<std::size_t>(picture.sampleBytes());
    const std::size_t rowBytes = static_cast<std::size_t>(from.area.width) * bytes;
    const std::size_t row = static_cast<std::size_t>(number) * static_cast<std::size_t>(from.area.height) +
                            static_cast<std::size_t>(area.y - from.area.y);
    return {from.planes.data() + row * rowBytes + static_cast<std::size_t>(area.x - from.area.x) * bytes, rowBytes};
}

} // namespace Stillmark
