#include "stages/imageHub.h"

#include "stages/finalRender.h"
#include "stages/result.h"
#include "stages/source.h"
#include "store/traces/kernelCollection.h"

#include <algorithm>
#include <cmath>

namespace Project
{

using Sarnik::CRect;

PImageHub::PImageHub(PStageHost &stageHost) : host(stageHost), imageBounds(stageHost.ImageBounds())
{
}

PImageHub::~PImageHub() = default;

PSource &PImageHub::Source()
{
    if (!source)
        source = std::make_unique<PSource>(*this);
    source->SetBounds(imageBounds);
    return *source;
}

PResult &PImageHub::ResultFull()
{
    if (!resultFull)
        resultFull = std::make_unique<PResult>(*this, false);
    Source();
    resultFull->SetBounds(imageBounds);
    return *resultFull;
}

PPlaneLayout PImageHub::Layout() const
{
    const Sarnik::CImageFormat format = host.Format();
    return {format.depth, format.planes, host.HasTransparency(), host.HasSelection()};
}

CorvaneDeblur::shrinkageTableStore &PImageHub::Tables() const
{
    return host.Kernels().ShrinkageTables();
}

void PImageHub::SetCellSize(std::int64_t side)
{
    cellSize = static_cast<std::int32_t>(std::clamp<std::int64_t>(side, 16, 8192));
}

CRect PImageHub::SelectionAt(const PResult &stage) const
{
    const CRect selected = host.SelectionBounds().Intersected(imageBounds);
    if (!stage.Scaled() || selected.Empty())
        return selected;
    const CRect &rect = stage.Rect();
    const double x = static_cast<double>(rect.Width()) / static_cast<double>(imageBounds.Width());
    const double y = static_cast<double>(rect.Height()) / static_cast<double>(imageBounds.Height());
    const auto at = [](std::int32_t start, std::int64_t distance, double factor, double (*round)(double)) {
        return CRect::Clamped(start + static_cast<std::int64_t>(round(static_cast<double>(distance) * factor)));
    };
    const auto down = [](double v) { return std::floor(v); };
    const auto up = [](double v) { return std::ceil(v); };
    return {at(rect.left, std::int64_t{selected.left} - imageBounds.left, x, down),
            at(rect.top, std::int64_t{selected.top} - imageBounds.top, y, down),
            at(rect.left, std::int64_t{selected.right} - imageBounds.left, x, up),
            at(rect.top, std::int64_t{selected.bottom} - imageBounds.top, y, up)};
}

bool PImageHub::RenderWithCallbacks()
{
    return renderFinal(*this, {[this] { return host.Abort(); },
                               [this](std::uint64_t done, std::uint64_t total) { host.Progress(done, total); }});
}

} // namespace Project
