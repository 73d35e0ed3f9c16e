#include "framework/pixels/pixProcess.h"

namespace Sarnik
{
namespace
{

/// Calls visit(column, row) over a block until it returns false; whether it never did.
template <class Visit> bool overTiles(const CPixGrid::Range &range, Visit visit)
{
    for (std::int64_t row = range.row; row < range.row + range.rows; ++row)
        for (std::int64_t column = range.column; column < range.column + range.columns; ++column)
            if (!visit(column, row))
                return false;
    return true;
}

template <class Count> std::uint64_t sumOverTiles(const CPixGrid::Range &range, Count count)
{
    std::uint64_t sum = 0;
    overTiles(range, [&](std::int64_t column, std::int64_t row) {
        sum += count(column, row);
        return true;
    });
    return sum;
}

} // namespace

bool CPixProcess::AdvanceCell(std::int64_t column, std::int64_t row, std::uint64_t &count, const Callback &callback)
{
    if (CellRemaining(column, row) == 0)
        return true;
    ++State(column, row);
    ++count;
    return Progress(count, callback);
}

bool CPixProcess::RunCell(std::int64_t column, std::int64_t row, std::uint64_t &count, const Callback &callback)
{
    while (CellRemaining(column, row) != 0)
        if (!AdvanceCell(column, row, count, callback))
            return false;
    return true;
}

std::uint64_t CPixProcess::ProcessCell(std::int64_t column, std::int64_t row, bool)
{
    if (CellRemaining(column, row) == 0)
        return 0;
    ++State(column, row);
    return 1;
}

std::uint64_t CPixProcess::RunCellFully(std::int64_t column, std::int64_t row)
{
    std::uint64_t sum = 0;
    while (CellRemaining(column, row) != 0)
    {
        const std::uint64_t done = ProcessCell(column, row, true);
        if (done == 0)
            break;
        sum += done;
    }
    return sum;
}

std::uint32_t CPixProcess::CellRemaining(std::int64_t column, std::int64_t row) const
{
    const std::uint32_t target = TargetState(), state = CellState(column, row);
    return target > state ? target - state : 0;
}

bool CPixProcess::RunRegion(const Range &range, std::uint64_t &count, const Callback &callback)
{
    return overTiles(range,
                     [&](std::int64_t column, std::int64_t row) { return RunCell(column, row, count, callback); });
}

std::uint64_t CPixProcess::StepRegion(const Range &range)
{
    std::uint64_t done = 0;
    overTiles(range, [&](std::int64_t column, std::int64_t row) {
        done = ProcessCell(column, row, false);
        return done == 0;
    });
    return done;
}

std::uint64_t CPixProcess::ForceRegion(const Range &range)
{
    return sumOverTiles(range, [&](std::int64_t column, std::int64_t row) { return RunCellFully(column, row); });
}

std::uint64_t CPixProcess::DoneRegion(const Range &range) const
{
    return sumOverTiles(range, [&](std::int64_t column, std::int64_t row) { return CellState(column, row); });
}

std::uint64_t CPixProcess::RemainingRegion(const Range &range) const
{
    return sumOverTiles(range, [&](std::int64_t column, std::int64_t row) { return CellRemaining(column, row); });
}

std::uint64_t CPixProcess::TotalRegion(const Range &range) const
{
    return static_cast<std::uint64_t>(range.columns) * static_cast<std::uint64_t>(range.rows) * TargetState();
}

bool CPixProcess::RunAll(std::uint64_t &count, const Callback &callback)
{
    return RunRegion(All(), count, callback) && RunExtra(count, callback);
}

std::uint64_t CPixProcess::StepAll()
{
    const std::uint64_t done = StepRegion(All());
    return done != 0 ? done : StepExtra();
}

std::uint64_t CPixProcess::ForceAll()
{
    const std::uint64_t done = ForceRegion(All());
    return done + ForceExtra();
}

} // namespace Sarnik
