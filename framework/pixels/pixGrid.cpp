#include "framework/pixels/pixGrid.h"

#include <cassert>

namespace Sarnik
{
namespace
{

struct axis
{
    std::int64_t count = 0, first = 0, last = 0;
};

/// `toEdge`: from the rectangle's start to the grid's origin, of either sign.
axis cut(std::int64_t length, std::int64_t toEdge, std::int64_t tile)
{
    if (length == 0)
        return {};
    std::int64_t first = toEdge % tile;
    if (first < 1)
        first += tile;
    if (length <= first)
        return {1, length, 0};
    const std::int64_t rest = length - first;
    if (rest % tile == 0)
        return {rest / tile + 1, first, tile};
    return {rest / tile + 2, first, rest % tile};
}

std::int64_t startOf(std::int64_t index, std::int64_t first, std::int64_t tile)
{
    return index == 0 ? 0 : first + (index - 1) * tile;
}

/// The tile that holds a pixel at a distance from the start.
std::int64_t indexOf(std::int64_t offset, std::int64_t first, std::int64_t tile)
{
    return offset < first ? 0 : 1 + (offset - first) / tile;
}

} // namespace

void CPixGrid::Setup(const CRect &bounds, const CRect &tile)
{
    left = bounds.left;
    top = bounds.top;
    width = bounds.Width();
    height = bounds.Height();
    tileWidth = std::max<std::int64_t>(1, tile.Width());
    tileHeight = std::max<std::int64_t>(1, tile.Height());

    const axis x = cut(width, std::int64_t{tile.left} - bounds.left, tileWidth);
    columns = x.count;
    firstWidth = x.first;
    lastWidth = x.last;
    const axis y = cut(height, std::int64_t{tile.top} - bounds.top, tileHeight);
    rows = y.count;
    firstHeight = y.first;
    lastHeight = y.last;
}

CRect CPixGrid::Bounds() const
{
    return {left, top, CRect::Clamped(left + width), CRect::Clamped(top + height)};
}

CRect CPixGrid::TileRect(std::int64_t column, std::int64_t row) const
{
    assert(column >= 0 && column < columns && row >= 0 && row < rows);
    const std::int64_t right = std::min(width, startOf(column + 1, firstWidth, tileWidth));
    const std::int64_t bottom = std::min(height, startOf(row + 1, firstHeight, tileHeight));
    return {CRect::Clamped(left + startOf(column, firstWidth, tileWidth)),
            CRect::Clamped(top + startOf(row, firstHeight, tileHeight)), CRect::Clamped(left + right),
            CRect::Clamped(top + bottom)};
}

CPixGrid::Range CPixGrid::Touched(const CRect &rect) const
{
    const CRect inside = rect.Intersected(Bounds());
    if (inside.Empty() || Empty())
        return {};
    const std::int64_t column = indexOf(std::int64_t{inside.left} - left, firstWidth, tileWidth);
    const std::int64_t row = indexOf(std::int64_t{inside.top} - top, firstHeight, tileHeight);
    return {column, row, indexOf(std::int64_t{inside.right} - 1 - left, firstWidth, tileWidth) - column + 1,
            indexOf(std::int64_t{inside.bottom} - 1 - top, firstHeight, tileHeight) - row + 1};
}

} // namespace Sarnik
