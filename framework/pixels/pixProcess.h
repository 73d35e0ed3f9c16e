#pragma once

#include "framework/pixels/pixState.h"

#include <functional>

namespace Sarnik
{

/// Work on a large picture, tile by tile and step by step. A stage derives from it and fills ProcessCell; whoever needs
/// a rectangle of its result asks for steps until nothing is left to do there.
///
/// Loops over tiles go row by row, left to right. Counts are work units, one for a step of a tile. One thread at a
/// time.
class CPixProcess : public CPixState
{
public:
    /// Told how many units are done so far; false asks for a stop. Empty: nobody wants to know.
    using Callback = std::function<bool(std::uint64_t done)>;

    /// targetState: the steps that a tile goes through until it is finished.
    explicit CPixProcess(std::uint32_t steps = 1, bool keepTheRects = false)
        : CPixState(keepTheRects), targetState(steps)
    {
    }
    virtual ~CPixProcess() = default;

    /// Forgets the grid.
    virtual void Reset() { Clear(); }
    /// Cuts `bounds` by the grid of `tile`; all tiles at 0.
    virtual void Allocate(const CRect &bounds, const CRect &tile) { Setup(bounds, tile); }
    virtual bool Progress(std::uint64_t done, const Callback &callback) { return !callback || callback(done); }

    // Tiles as a count: no work is done, their states alone move.
    /// One state further unless the tile is finished; `count` goes up with it and is reported. False: stop.
    virtual bool AdvanceCell(std::int64_t column, std::int64_t row, std::uint64_t &count, const Callback &callback);
    /// To the end; false where the callback stopped it.
    virtual bool RunCell(std::int64_t column, std::int64_t row, std::uint64_t &count, const Callback &callback);

    /// The work of one step; returns the units done, 0 if nothing was to do. Not forced, and with a tile of an earlier
    /// stage still behind: does that tile's step instead, returns its count and leaves its own state alone. Forced:
    /// first brings the earlier stage forward itself. Here: advances the state.
    virtual std::uint64_t ProcessCell(std::int64_t column, std::int64_t row, bool force);
    /// Forced steps until the tile is finished, or until a step says that it can do nothing now.
    virtual std::uint64_t RunCellFully(std::int64_t column, std::int64_t row);

    virtual std::uint32_t CellState(std::int64_t column, std::int64_t row) const { return State(column, row); }
    /// 0 for a tile that is past the target.
    virtual std::uint32_t CellRemaining(std::int64_t column, std::int64_t row) const;
    virtual std::uint32_t TargetState() const { return targetState; }

    // The same over a block of tiles, which lies inside the grid.
    virtual bool RunRegion(const Range &range, std::uint64_t &count, const Callback &callback);
    /// One unforced step, of the first tile that has something to do.
    virtual std::uint64_t StepRegion(const Range &range);
    virtual std::uint64_t ForceRegion(const Range &range);
    virtual std::uint64_t DoneRegion(const Range &range) const;
    virtual std::uint64_t RemainingRegion(const Range &range) const;
    virtual std::uint64_t TotalRegion(const Range &range) const;

    // The same over the grid, with the stage's own extra work after it.
    virtual bool RunAll(std::uint64_t &count, const Callback &callback);
    virtual std::uint64_t StepAll();
    virtual std::uint64_t ForceAll();
    virtual std::uint64_t DoneAll() const { return DoneRegion(All()) + DoneExtra(); }
    virtual std::uint64_t RemainingAll() const { return RemainingRegion(All()) + RemainingExtra(); }
    virtual std::uint64_t TotalAll() const { return TotalRegion(All()) + TotalExtra(); }

    /// The same over the tiles that a rectangle of pixels touches.
    std::uint64_t StepRect(const CRect &rect) { return StepRegion(Touched(rect)); }
    std::uint64_t ForceRect(const CRect &rect) { return ForceRegion(Touched(rect)); }

protected:
    virtual bool RunExtra(std::uint64_t &, const Callback &) { return true; }
    virtual std::uint64_t StepExtra() { return 0; }
    virtual std::uint64_t ForceExtra() { return 0; }
    virtual std::uint64_t DoneExtra() const { return 0; }
    virtual std::uint64_t RemainingExtra() const { return 0; }
    virtual std::uint64_t TotalExtra() const { return 0; }

    std::uint32_t targetState;
};

} // namespace Sarnik
