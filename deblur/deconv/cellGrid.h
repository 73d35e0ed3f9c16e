#pragma once

#include <algorithm>

namespace CorvaneDeblur
{

/// A rectangle of pixels: top left corner and size.
struct pixelRect
{
    int x = 0, y = 0, width = 0, height = 0;
    bool operator==(const pixelRect &) const = default;
};

/// The square cells of an image, numbered row by row; those at the right and at the bottom are cut off by its border.
class cellGrid
{
public:
    cellGrid(int imageCols, int imageRows, int cellSize)
        : cols(std::max(imageCols, 0)), rows(std::max(imageRows, 0)),
          size(std::clamp(cellSize, 1, std::max({cols, rows, 1}))), perRow(cellsAlong(cols)), perCol(cellsAlong(rows))
    {
    }

    int count() const { return perRow * perCol; }

    pixelRect cell(int index) const { return clipped(index % perRow * size, index / perRow * size, size, size); }

    /// The area with a margin on every side, where the image has one.
    pixelRect grown(const pixelRect &area, int margin) const
    {
        return clipped(area.x - margin, area.y - margin, area.width + 2 * margin, area.height + 2 * margin);
    }

private:
    int cellsAlong(int pixels) const { return pixels > 0 ? (pixels - 1) / size + 1 : 0; }

    pixelRect clipped(int x, int y, int width, int height) const
    {
        const int left = std::max(x, 0), top = std::max(y, 0);
        return {left, top, std::min(x + width, cols) - left, std::min(y + height, rows) - top};
    }

    int cols, rows, size, perRow, perCol;
};

} // namespace CorvaneDeblur
