#include "stages/finalRender.h"

#include "platform/clock.h"
#include "stages/final.h"
#include "stages/imageHub.h"
#include "stages/result.h"
#include "stages/source.h"

#include <tbb/global_control.h>
#include <tbb/task_arena.h>

#include <algorithm>
#include <deque>

namespace Project
{

using Sarnik::CRect;

namespace
{

constexpr std::uint64_t showEvery = 200; ///< milliseconds

/// Threads that compute, the calling one among them.
std::size_t threads()
{
    const auto limit = tbb::global_control::active_value(tbb::global_control::max_allowed_parallelism);
    return std::max<std::size_t>(1, std::min(limit, static_cast<std::size_t>(tbb::this_task_arena::max_concurrency())));
}

class finalJob
{
public:
    explicit finalJob(PImageHub &owner)
        : hub(owner), result(hub.ResultFull()), final(hub), ready(result.CollectSettings(settings)),
          pool(settings, hub.Tables()),
          // As many again as are computed: this thread, busy with a cell of its own, leaves the others enough to do.
          line(2 * threads() + 2)
    {
        result.CancelJobs();
        final.SetBounds(hub.Host().SelectionBounds());
    }
    finalJob(const finalJob &) = delete;
    finalJob &operator=(const finalJob &) = delete;
    /// What is still under way, after a failure or at the user's wish, ends soon.
    ~finalJob() { pool.Stop(); }

    bool Run(const PFinalWatcher &watcher)
    {
        const std::uint64_t total = final.TotalAll();
        std::uint64_t shown = Platform::systemClock().ticks();
        while (written < total)
        {
            if (watcher.cancelled && watcher.cancelled())
                return false;
            if (next < total && !line.Full())
                Begin(next++);
            else
                End();
            const std::uint64_t now = Platform::systemClock().ticks();
            if (watcher.show && now - shown >= showEvery && written < total)
            {
                watcher.show(written, total);
                shown = now;
            }
        }
        if (watcher.show)
            watcher.show(written, total);
        return true;
    }

private:
    struct cellPlace
    {
        std::int64_t column, row;
    };

    static cellPlace PlaceOf(std::uint64_t index, std::int64_t columns)
    {
        return {static_cast<std::int64_t>(index) % columns, static_cast<std::int64_t>(index) / columns};
    }

    /// The result's cell that holds one of this pass: both are cut along the same lines.
    cellPlace ResultCell(cellPlace cell) const
    {
        const Sarnik::CPixGrid::Range range = result.Touched(final.TileRect(cell.column, cell.row));
        return {range.column, range.row};
    }

    /// Reads what the next cell needs, and puts it into the line.
    void Begin(std::uint64_t index)
    {
        const cellPlace cell = PlaceOf(index, final.columns), place = ResultCell(cell);
        std::unique_ptr<PRenderJob> job;
        if (result.CellRemaining(place.column, place.row) != 0)
        {
            // The whole cell, whatever part of it is written: that is what the preview shows, too.
            const CRect area = result.TileRect(place.column, place.row);
            const bool render = ready && result.NeedsRender(area);
            hub.Source().ForceRect(render ? result.SourceRect(area) : final.TileRect(cell.column, cell.row));
            if (render)
                job = result.MakeJob(area, settings, pool);
        }
        line.Add(std::move(job));
    }

    /// Takes the oldest cell out of the line and writes it.
    void End()
    {
        const cellPlace cell = PlaceOf(written, final.columns), place = ResultCell(cell);
        if (const std::unique_ptr<PLineJob> job = line.Take())
            final.Write(cell.column, cell.row, static_cast<PRenderJob &>(*job).Result());
        else if (result.CellRemaining(place.column, place.row) == 0)
            final.WriteFrom(cell.column, cell.row, result);
        else
            final.WriteFrom(cell.column, cell.row, hub.Source());
        ++written;
    }

    PImageHub &hub;
    PResult &result;
    PFinal final;
    renderSettings settings;
    const bool ready;
    PEstimatorPool pool;
    PJobLine line; ///< after what its jobs use
    std::uint64_t next = 0, written = 0;
};

} // namespace

bool renderFinal(PImageHub &hub, const PFinalWatcher &watcher)
{
    return finalJob(hub).Run(watcher);
}

} // namespace Project
