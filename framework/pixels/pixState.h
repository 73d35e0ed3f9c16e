#pragma once

#include "framework/pixels/pixGrid.h"

#include <cstdint>
#include <vector>

namespace Sarnik
{

/// A grid that remembers how far each of its tiles has come: one number a tile, upwards from 0. Not safe to change from
/// two threads at a time.
class CPixState : public CPixGrid
{
public:
    /// keepRects: the tiles' rectangles are worked out once and kept in `rects`.
    explicit CPixState(bool keepTheRects = false) : keepRects(keepTheRects) {}

    std::vector<std::uint32_t> states; ///< row by row
    std::vector<CRect> rects;          ///< as many, or none
    const bool keepRects;

    /// Cuts anew; every tile is at 0. Throws std::bad_alloc or std::length_error where so many tiles have no room, and
    /// the grid is empty then.
    void Setup(const CRect &bounds, const CRect &tile);
    /// An empty grid.
    void Clear();

    std::uint32_t &State(std::int64_t column, std::int64_t row)
    {
        return states[static_cast<std::size_t>(row * columns + column)];
    }
    std::uint32_t State(std::int64_t column, std::int64_t row) const
    {
        return states[static_cast<std::size_t>(row * columns + column)];
    }

    /// Tiles that a rectangle of pixels touches and that are above `value` (below it, for RaiseState) are set to it.
    void LowerState(const CRect &rect, std::uint32_t value);
    void RaiseState(const CRect &rect, std::uint32_t value);

private:
    template <class Limit> void LimitStates(const CRect &rect, Limit limit);
};

} // namespace Sarnik
