#include "stages/result.h"

#include "stages/imageHub.h"
#include "stages/render/collectKernels.h"
#include "stages/source.h"

#include <cmath>

namespace Project
{

using Sarnik::CMemoryPixmap;
using Sarnik::CRect;

namespace
{

/// Kernels of fewer pixels at the render's scale change nothing that can be seen.
constexpr float leastKernelSize = 5.0f;

} // namespace

PResult::PResult(PImageHub &owner, bool onlyFast) : PStage(owner, 1), fastOnly(onlyFast)
{
}

void PResult::SetBounds(const CRect &newRect)
{
    if (newRect == Rect() && HasPixmap())
        return;
    const PPlaneLayout layout = hub.Layout();
    Reset();
    Place(newRect, layout.depth, layout.ResultPlanes());
    scaled = newRect != hub.ImageBounds();
    scale = scaled && !newRect.Empty()
                ? static_cast<float>(newRect.Width()) / static_cast<float>(hub.ImageBounds().Width())
                : 1.0f;
}

PStage &PResult::SourceStage() const
{
    return hub.Source();
}

bool PResult::NeedsRender(const CRect &cell) const
{
    const int kernel = largestReadyKernel(hub.Host().Kernels());
    if (kernel == 0 || static_cast<float>(kernel) * scale < leastKernelSize)
        return false;
    return !hub.SelectionAt(*this).Intersected(cell).Empty();
}

CRect PResult::SourceRect(const CRect &cell) const
{
    // The kernel's width at full resolution: at a smaller scale that is more than needed, and does no harm.
    const std::int64_t margin = 2 * std::int64_t{largestReadyKernel(hub.Host().Kernels())};
    return CRect{CRect::Clamped(cell.left - margin), CRect::Clamped(cell.top - margin),
                 CRect::Clamped(cell.right + margin), CRect::Clamped(cell.bottom + margin)}
        .Intersected(Rect());
}

bool PResult::CollectSettings(renderSettings &settings) const
{
    const CRect &image = hub.ImageBounds();
    const bool reduced = scale < 1.0f;
    const bool ready = collectAllKernels(hub.Host().Kernels(), hub.Host().Params(), hub.Layout().colours, scale,
                                         reduced ? image.left : 0, reduced ? image.top : 0, settings);
    if (fastOnly)
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
        count = source.ForceRect(wanted);
    else if ((count = source.StepRect(wanted)) != 0)
        return count;
    if (render)
        RenderNow(cell, column, row);
    else
        TakeSource(column, row);
    return count + 1;
}

} // namespace Project
