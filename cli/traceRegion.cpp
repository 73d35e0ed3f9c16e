#include "cli/traceRegion.h"

#include <algorithm>

namespace Stillmark
{
namespace
{

/// One axis of a region, end exclusive.
struct span
{
    int begin, end;
};

span grownSpan(span drawn, int growth, span limit)
{
    span s{drawn.begin - growth, drawn.end + growth};
    if (s.end > limit.end)
    {
        const int excess = s.end - limit.end;
        s.begin -= excess;
        s.end -= excess;
    }
    if (s.begin < limit.begin)
    {
        s.end += limit.begin - s.begin;
        s.begin = limit.begin;
    }
    s.end = std::min(s.end, limit.end);
    return s;
}

std::string placeText(const photo &picture, const rectangle &area)
{
    const bool whole = area.width == picture.width() && area.height == picture.height();
    return whole ? "the picture" : "what is selected";
}

} // namespace

CorvaneDeblur::regionRect toEngine(const rectangle &area)
{
    return {area.x, area.y, area.width, area.height};
}

rectangle fromEngine(const CorvaneDeblur::regionRect &region)
{
    return {region.x, region.y, region.width, region.height};
}

rectangle wholeOf(const photo &picture)
{
    return {0, 0, picture.width(), picture.height()};
}

std::string regionText(const rectangle &area)
{
    return std::to_string(area.x) + "," + std::to_string(area.y) + "," + std::to_string(area.width) + "," +
           std::to_string(area.height);
}

void requireInside(const photo &picture, const rectangle &area, const rectangle &region)
{
    // Not by sums: the numbers may be as large as an int.
    const int x = region.x - area.x, y = region.y - area.y;
    if (x < 0 || y < 0 || x > area.width - region.width || y > area.height - region.height)
        throw Platform::fileError(picture.path() + ": the region " + regionText(region) + " does not lie within " +
                                  placeText(picture, area) + ", which has " + std::to_string(area.width) + " x " +
                                  std::to_string(area.height) + " pixels");
}

rectangle grownRegion(const rectangle &drawn, int size, const rectangle &area)
{
    const int needed = imageToKernelRatio * (size | 1) - std::min(drawn.width, drawn.height);
    if (needed <= 0)
        return drawn;
    const int growth = (needed + 1) / 2;
    const span x = grownSpan({drawn.x, drawn.x + drawn.width}, growth, {area.x, area.x + area.width});
    const span y = grownSpan({drawn.y, drawn.y + drawn.height}, growth, {area.y, area.y + area.height});
    return {x.begin, y.begin, x.end - x.begin, y.end - y.begin};
}

rectangle regionFor(const photo &picture, const rectangle &area, const rectangle &drawn, int size)
{
    const rectangle grown = grownRegion(drawn, size, area);
    const int needed = imageToKernelRatio * (size | 1);
    if (std::min(grown.width, grown.height) < needed)
        throw Platform::fileError(picture.path() + ": too small: to find a blur of " + std::to_string(size | 1) +
                                  " pixels takes " + std::to_string(needed) + " pixels in width and height, and " +
                                  placeText(picture, area) + " has " + std::to_string(area.width) + " x " +
                                  std::to_string(area.height));
    return grown;
}

} // namespace Stillmark
