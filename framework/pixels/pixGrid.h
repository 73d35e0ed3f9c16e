#pragma once

#include "framework/pixels/rect.h"

namespace Sarnik
{

/// Cuts a rectangle into tiles whose inner edges lie on a grid: on every multiple of the tile's size from the grid's
/// origin. Only the first and the last tile of a row or column may be smaller.
class CPixGrid
{
public:
    std::int32_t left = 0, top = 0;
    std::int64_t width = 0, height = 0; ///< of the whole rectangle
    std::int64_t columns = 0, rows = 0; ///< 0 when the rectangle is empty in that direction
    std::int64_t tileWidth = 1, tileHeight = 1;
    std::int64_t firstWidth = 0, firstHeight = 0;
    std::int64_t lastWidth = 0, lastHeight = 0; ///< 0 where there is a single column or row

    /// `tile` gives the grid's origin (left, top) and the tile's size, which counts as at least 1.
    void Setup(const CRect &bounds, const CRect &tile);

    bool Empty() const { return columns == 0 || rows == 0; }
    CRect Bounds() const;
    /// A tile inside the grid.
    CRect TileRect(std::int64_t column, std::int64_t row) const;

    /// Half-open ranges of tiles.
    struct Range
    {
        std::int64_t column = 0, row = 0, columns = 0, rows = 0;
    };
    Range All() const { return {0, 0, columns, rows}; }
    /// The tiles that a rectangle of pixels touches.
    Range Touched(const CRect &rect) const;
};

} // namespace Sarnik
