#include "framework/pixels/pixState.h"

#include <stdexcept>

namespace Sarnik
{

void CPixState::Clear()
{
    CPixGrid::Setup({}, {});
    states.clear();
    rects.clear();
}

void CPixState::Setup(const CRect &bounds, const CRect &tile)
{
    Clear();
    CPixGrid grid;
    grid.Setup(bounds, tile);
    if (!grid.Empty())
    {
        if (grid.columns > INT64_MAX / grid.rows)
            throw std::length_error("more tiles than can be counted");
        const auto count = static_cast<std::size_t>(grid.columns * grid.rows);
        std::vector<CRect> newRects;
        if (keepRects)
        {
            newRects.reserve(count);
            for (std::int64_t row = 0; row < grid.rows; ++row)
                for (std::int64_t column = 0; column < grid.columns; ++column)
                    newRects.push_back(grid.TileRect(column, row));
        }
        states.assign(count, 0);
        rects = std::move(newRects);
    }
    static_cast<CPixGrid &>(*this) = grid;
}

template <class Limit> void CPixState::LimitStates(const CRect &rect, Limit limit)
{
    const Range range = Touched(rect);
    for (std::int64_t row = range.row; row < range.row + range.rows; ++row)
        for (std::int64_t column = range.column; column < range.column + range.columns; ++column)
            State(column, row) = limit(State(column, row));
}

void CPixState::LowerState(const CRect &rect, std::uint32_t value)
{
    LimitStates(rect, [value](std::uint32_t state) { return std::min(state, value); });
}

void CPixState::RaiseState(const CRect &rect, std::uint32_t value)
{
    LimitStates(rect, [value](std::uint32_t state) { return std::max(state, value); });
}

} // namespace Sarnik
