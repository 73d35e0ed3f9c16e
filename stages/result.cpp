#include "stages/result.h"

#include "stages/imageHub.h"
#include "stages/render/collectKernels.h"
#include "stages/scaledStage.h"
#include "stages/source.h"
#include "store/traces/ctrlThread.h"

#include <algorithm>
#include <atomic>
#include <exception>

namespace Project
{

using Sarnik::CMemoryPixmap;
using Sarnik::CRect;

namespace
{

CRect grown(const CRect &area, std::int64_t margin)
{
    return {CRect::Clamped(area.left - margin), CRect::Clamped(area.top - margin), CRect::Clamped(area.right + margin),
            CRect::Clamped(area.bottom + margin)};
}

/// Kernels of fewer pixels at the render's scale change nothing that can be seen.
constexpr float leastKernelSize = 5.0f;

} // namespace

struct PResult::PPendingCell
{
    PPendingCell(const CRect &area, renderSettings &&with, CorvaneDeblur::shrinkageTableStore &tables)
        : cell(area), settings(std::move(with)), pool(settings, tables)
    {
    }

    void Run() noexcept
    {
        try
        {
            job->Run();
        }
        catch (...)
        {
            error = std::current_exception();
        }
        finished.store(true, std::memory_order_release);
    }

    const CRect cell;
    const renderSettings settings;
    PEstimatorPool pool;
    std::unique_ptr<PRenderJob> job;
    std::exception_ptr error;
    std::atomic<bool> finished{false};
};

PResult::PResult(PImageHub &owner, Role what)
    : PStage(owner, 1), role(what), control(std::make_unique<PCtrlThread>(owner.TaskPool()))
{
}

PResult::~PResult()
{
    CancelJobs();
}

void PResult::Reset()
{
    CancelJobs();
    PStage::Reset();
}

void PResult::SetBounds(const CRect &newRect)
{
    if (newRect == Rect() && HasPixmap())
        return;
    const PPlaneLayout layout = hub.Layout();
    CancelJobs();
    if (scaled != (newRect != hub.ImageBounds()))
        Reset(); // from now on out of another source
    Place(newRect, layout.depth, layout.ResultPlanes());
    scaled = newRect != hub.ImageBounds();
    scale = scaled && !newRect.Empty()
                ? static_cast<float>(newRect.Width()) / static_cast<float>(hub.ImageBounds().Width())
                : 1.0f;
}

PStage &PResult::SourceStage() const
{
    if (scaled)
        return hub.SourceFast();
    return hub.Source();
}

bool PResult::NeedsRender(const CRect &cell) const
{
    const int kernel = largestReadyKernel(hub.Host().Kernels());
    if (kernel == 0 || static_cast<float>(kernel) * scale < leastKernelSize)
        return false;
    return !hub.SelectionAt(*this).Intersected(cell).Empty();
}

std::int64_t PResult::Margin() const
{
    // The kernel's width at full resolution: at a smaller scale that is more than needed, and does no harm.
    return 2 * std::int64_t{largestReadyKernel(hub.Host().Kernels())};
}

CRect PResult::SourceRect(const CRect &cell) const
{
    return grown(cell, Margin()).Intersected(Rect());
}

bool PResult::CollectSettings(renderSettings &settings) const
{
    const CRect &image = hub.ImageBounds();
    const bool reduced = scale < 1.0f;
    const bool ready = collectAllKernels(hub.Host().Kernels(), hub.Host().Params(), hub.Layout().colours, scale,
                                         reduced ? image.left : 0, reduced ? image.top : 0, settings);
    if (role == Role::rough)
        settings.method = CorvaneDeblur::deconvolutionMethod::wiener;
    return ready;
}

std::unique_ptr<PRenderJob> PResult::MakeJob(const CRect &cell, const renderSettings &settings,
                                             PEstimatorPool &pool) const
{
    const PPlaneLayout layout = hub.Layout();
    const CRect area = SourceRect(cell);
    auto pixels = std::make_unique<CMemoryPixmap>(area, layout.depth, layout.JobPlanes());
    Sarnik::CPixmap &source = SourceStage().Pixmap();
    copyPlanes(*pixels, 0, source, 0, layout.ResultPlanes(), area);
    if (layout.selection)
        copyPlanes(*pixels, layout.ResultPlanes(), source, layout.SelectionPlane(), 1, area);

    // Traces lie where they lie in the picture. A scaled stage's own corner means nothing; where it enlarges, the
    // regions keep the picture's offset.
    int originX = area.left, originY = area.top;
    if (scaled)
    {
        const CRect &image = hub.ImageBounds();
        originX -= Rect().left - (scale < 1.0f ? 0 : static_cast<int>(static_cast<float>(image.left) * scale));
        originY -= Rect().top - (scale < 1.0f ? 0 : static_cast<int>(static_cast<float>(image.top) * scale));
    }
    return std::make_unique<PRenderJob>(settings, pool, layout, cell, std::move(pixels), originX, originY);
}

void PResult::TakeOver(std::int64_t column, std::int64_t row, PRenderJob &job)
{
    copyPlanes(Pixmap(), 0, job.Result(), 0, hub.Layout().ResultPlanes(), job.Cell());
    ++State(column, row);
}

void PResult::TakeSource(std::int64_t column, std::int64_t row)
{
    CopySource(TileRect(column, row));
    ++State(column, row);
}

void PResult::CopySource(const CRect &area)
{
    copyPlanes(Pixmap(), 0, SourceStage().Pixmap(), 0, hub.Layout().ResultPlanes(), area);
}

void PResult::RenderNow(const CRect &cell, std::int64_t column, std::int64_t row)
{
    renderSettings settings;
    CollectSettings(settings);
    PEstimatorPool pool(settings, hub.Tables());
    const std::unique_ptr<PRenderJob> job = MakeJob(cell, settings, pool);
    job->Run();
    TakeOver(column, row, *job);
}

PResult::Cells::iterator PResult::FindPending(const CRect &cell)
{
    return std::find_if(pending.begin(), pending.end(), [&](const auto &p) { return p->cell == cell; });
}

/// As many cells at a time as there are threads, and two more, so that no thread waits for the main thread to come by.
bool PResult::RoomInLine()
{
    // Those that were dropped end at their next plane, or never begin.
    std::erase_if(ending, [](const auto &p) { return p->finished.load(std::memory_order_acquire); });
    if (control->Running() == 0)
        ending.clear();
    return pending.size() + ending.size() < static_cast<std::size_t>(hub.TaskPool().Threads()) + 2;
}

void PResult::Begin(const CRect &cell)
{
    renderSettings settings;
    CollectSettings(settings);
    const auto next = std::make_shared<PPendingCell>(cell, std::move(settings), hub.Tables());
    next->job = MakeJob(cell, next->settings, next->pool);
    control->Queue([next] { next->Run(); });
    pending.push_back(next);
    CopySource(cell); // something to look at
}

bool PResult::RenderBeside(const CRect &cell, std::int64_t column, std::int64_t row)
{
    const auto found = FindPending(cell);
    if (found == pending.end())
    {
        // A line that is full of other cells is one for another view.
        if (!pending.empty() && !RoomInLine())
            CancelJobs();
        if (RoomInLine())
            Begin(cell);
        return false;
    }
    if (!(*found)->finished.load(std::memory_order_acquire))
        return false;
    const std::shared_ptr<PPendingCell> done = std::move(*found);
    pending.erase(found);
    if (done->error)
        std::rethrow_exception(done->error);
    TakeOver(column, row, *done->job);
    return true;
}

/// One step for the next cell of the area ahead that nobody has begun: of its source, or its beginning. 0 where there
/// is none, or no room for it.
std::uint64_t PResult::WorkAhead()
{
    if (!RoomInLine())
        return 0;
    const Range cells = Touched(ahead);
    for (std::int64_t row = cells.row; row < cells.row + cells.rows; ++row)
        for (std::int64_t column = cells.column; column < cells.column + cells.columns; ++column)
        {
            const CRect cell = TileRect(column, row).Intersected(Rect());
            if (CellRemaining(column, row) == 0 || cell.Empty() || !NeedsRender(cell) ||
                FindPending(cell) != pending.end())
                continue;
            if (const std::uint64_t count = SourceStage().StepRect(SourceRect(cell)); count != 0)
                return count;
            Begin(cell);
            return 1;
        }
    return 0;
}

void PResult::CancelJobs()
{
    for (std::shared_ptr<PPendingCell> &cell : pending)
    {
        cell->pool.Stop();
        ending.push_back(std::move(cell));
    }
    pending.clear();
    control->Withdraw();
}

void PResult::Notify(const CRect &changed)
{
    if (HasPixmap())
        Invalidate(grown(changed, Margin()));
}

void PResult::Invalidate(const CRect &wanted)
{
    const Range cells = Touched(wanted);
    if (cells.columns == 0 || cells.rows == 0)
        return;
    LowerState(wanted, 0);
    CancelJobs();
    // A cell is transformed as a whole: all of it may come out different.
    const CRect first = TileRect(cells.column, cells.row);
    const CRect last = TileRect(cells.column + cells.columns - 1, cells.row + cells.rows - 1);
    const CRect area{first.left, first.top, last.right, last.bottom};
    switch (role)
    {
    case Role::rough:
        hub.TellPreviews(area, PNotice::resultRough);
        break;
    case Role::fast:
        hub.TellPreviews(area, PNotice::resultFast);
        break;
    case Role::full:
        hub.TellPreviews(area, PNotice::resultFull);
        if (hub.Stages().resultFullScaled)
            hub.Stages().resultFullScaled->Notify(area);
        break;
    }
    hub.MarkDirty();
}

std::uint64_t PResult::ProcessCell(std::int64_t column, std::int64_t row, bool force)
{
    if (CellRemaining(column, row) == 0)
        return 0;
    const CRect cell = TileRect(column, row).Intersected(Rect());
    if (cell.Empty())
    {
        ++State(column, row);
        return 1;
    }
    const bool render = NeedsRender(cell);
    const CRect wanted = render ? SourceRect(cell) : cell;
    PStage &source = SourceStage();
    std::uint64_t count = 0;
    if (force)
    {
        count = source.ForceRect(wanted);
        if (!source.Finished(wanted))
            return count;
    }
    else if ((count = source.StepRect(wanted)) != 0)
        return count;
    if (!render)
        TakeSource(column, row);
    else if (!useWorker)
        RenderNow(cell, column, row);
    else if (!RenderBeside(cell, column, row))
    {
        if (force)
            return count;
        if (const std::uint64_t others = WorkAhead(); others != 0)
            return count + others;
        hub.AddAbandoned(1);
    }
    return count + 1;
}

} // namespace Project
