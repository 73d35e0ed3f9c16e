#include "stages/imageHub.h"

#include "framework/base/localisedString.h"
#include "stages/finalRender.h"
#include "stages/preview.h"
#include "stages/progressWindow.h"
#include "stages/result.h"
#include "stages/scaledStage.h"
#include "stages/source.h"
#include "stages/stageView.h"
#include "store/params.h"
#include "store/timeLog.h"
#include "store/traces/kernelCollection.h"

#include <algorithm>
#include <cmath>

namespace Project
{

using Sarnik::CRect;

PImageHub::PImageHub(PStageHost &stageHost)
    : host(stageHost), taskPool(std::make_unique<PTaskPool>()), imageBounds(stageHost.ImageBounds())
{
}

PImageHub::~PImageHub() = default;

PPlaneLayout PImageHub::Layout() const
{
    const Sarnik::CImageFormat format = host.Format();
    return {format.depth, format.planes, host.HasTransparency(), host.HasSelection()};
}

CorvaneDeblur::shrinkageTableStore &PImageHub::Tables() const
{
    return host.Kernels().ShrinkageTables();
}

void PImageHub::SetImageBounds(const CRect &rect)
{
    if (rect == imageBounds)
        return;
    EmptyStages();
    imageBounds = rect;
    SetView({}, 1.0);
}

void PImageHub::SetCellSize(std::int64_t side)
{
    const auto wanted = static_cast<std::int32_t>(std::clamp<std::int64_t>(side, 16, 8192));
    if (wanted == cellSize)
        return;
    cellSize = wanted;
    EmptyStages();
    const CRect rect = viewBounds;
    const double factor = reduction;
    SetView({}, 1.0);
    SetView(rect, factor);
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

void PImageHub::SetViewObject(PStageView *pane)
{
    view = pane;
    if (view == nullptr)
        SetView({}, 100.0);
    else
        Rebuild();
}

double PImageHub::ReductionFor(const CRect &wholeView, const CRect &visible) const
{
    const auto side = std::min({wholeView.Width(), wholeView.Height(), visible.Width(), visible.Height()});
    const double shown = static_cast<double>(side), cap = host.Params().previewCap;
    LogLine("Visible View Area (Device): [%d, %d].", static_cast<int>(visible.Width()),
            static_cast<int>(visible.Height()));
    LogLine("Image Dimesion: [%d, %d].", static_cast<int>(imageBounds.Width()), static_cast<int>(imageBounds.Height()));
    const double factor = cap >= 1.0 && shown > cap ? shown / cap : 1.0;
    LogLine("Use rough down factor: %lf.", factor);
    return factor;
}

CRect PImageHub::ReducedView() const
{
    if (reduction <= 1.0 || viewBounds.Empty())
        return viewBounds;
    const auto over = [this](std::int32_t edge, double (*round)(double)) {
        return CRect::Clamped(static_cast<std::int64_t>(round(static_cast<double>(edge) / reduction)));
    };
    const auto down = [](double v) { return std::floor(v); };
    const auto up = [](double v) { return std::ceil(v); };
    return {over(viewBounds.left, down), over(viewBounds.top, down), over(viewBounds.right, up),
            over(viewBounds.bottom, up)};
}

void PImageHub::BeginBusy()
{
    ++busyDepth;
    if (view != nullptr)
        view->WantIdle(false);
}

void PImageHub::EndBusy()
{
    if (busyDepth >= 2)
    {
        --busyDepth;
        return;
    }
    busyDepth = 0;
    Rebuild();
}

namespace
{

/// Ends with the scope, however that is left.
class busyScope
{
public:
    explicit busyScope(PImageHub &owner) : hub(owner) { hub.BeginBusy(); }
    busyScope(const busyScope &) = delete;
    busyScope &operator=(const busyScope &) = delete;
    ~busyScope() { hub.EndBusy(); }

private:
    PImageHub &hub;
};

} // namespace

bool PImageHub::RenderWithCallbacks()
{
    const busyScope busy(*this);
    return renderFinal(*this, {[this] { return host.Abort(); },
                               [this](std::uint64_t done, std::uint64_t total) { host.Progress(done, total); }});
}

bool PImageHub::RenderWithDialog(PProgressWindow &window)
{
    const int traces = static_cast<int>(host.Kernels().RenderTraces().size());
    const char *const message = traces >= 2
                                    ? "$$$/Deblur/Final/Progress/PluralMessage=Applying Stillmark with ^0 Blur Traces."
                                    : "$$$/Deblur/Final/Progress/Message=Applying Stillmark with ^0 Blur Trace.";
    const busyScope busy(*this);
    struct closing
    {
        PProgressWindow &window;
        ~closing() { window.Close(); }
    } const atTheEnd{window};
    bool open = false;
    const auto show = [&](std::uint64_t done, std::uint64_t total) {
        if (!open)
            window.Open(Sarnik::Localize("$$$/Deblur/Final/Progress/Title=Progress"),
                        Sarnik::Localize(message, {std::to_string(traces)}), done, total);
        else
            window.Show(done, total);
        open = true;
    };
    return renderFinal(*this, {[&window] { return window.Cancelled(); }, show});
}

} // namespace Project
