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

span grownSpan(span drawn, int growth, int limit)
{
    span s{drawn.begin - growth, drawn.end + growth};
    if (s.end > limit)
    {
        const int excess = s.end - limit;
        s.begin -= excess;
        s.end -= excess;
    }
    if (s.begin < 0)
    {
        s.end -= s.begin;
        s.begin = 0;
    }
    s.end = std::min(s.end, limit);
    return s;
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

void requireInside(const photo &picture, const rectangle &area)
{
    // Not by sums: the numbers may be as large as an int.
    if (area.x > picture.width() - area.width || area.y > picture.height() - area.height)
        throw Platform::fileError(picture.path() + ": the region " + regionText(area) +
                                  " does not lie within the picture, which has " + std::to_string(picture.width()) +
                                  " x " + std::to_string(picture.height()) + " pixels");
}

rectangle grownRegion(const rectangle &drawn, int size, int cols, int rows)
{
    const int needed = imageToKernelRatio * (size | 1) - std::min(drawn.width, drawn.height);
    if (needed <= 0)
        return drawn;
    const int growth = (needed + 1) / 2;
    const span x = grownSpan({drawn.x, drawn.x + drawn.width}, growth, cols);
    const span y = grownSpan({drawn.y, drawn.y + drawn.height}, growth, rows);
    return {x.begin, y.begin, x.end - x.begin, y.end - y.begin};
}

rectangle regionFor(const photo &picture, const rectangle &drawn, int size)
{
    const rectangle grown = grownRegion(drawn, size, picture.width(), picture.height());
    const int needed = imageToKernelRatio * (size | 1);
    if (std::min(grown.width, grown.height) < needed)
        throw Platform::fileError(picture.path() + ": too small: to find a blur of " + std::to_string(size | 1) +
                                  " pixels takes " + std::to_string(needed) +
                                  " pixels in width and height, and the picture has " +
                                  std::to_string(picture.width()) + " x " + std::to_string(picture.height()));
    return grown;
}

} // namespace Stillmark
