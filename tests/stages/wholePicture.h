#pragma once

#include "deblur/deconv/cellRenderer.h"
#include "framework/pixels/maskBlend.h"
#include "framework/pixels/sixteenBit.h"
#include "stages/render/collectKernels.h"
#include "tests/stages/stageFixture.h"
#include "tests/stages/stageTraces.h"

namespace TestSupport
{

/// A pixmap as the engine's renderer sees pictures: from 0, 0 on, 16-bit samples in the estimator's range.
class engineView final : public CorvaneDeblur::planeReader, public CorvaneDeblur::planeWriter
{
public:
    engineView(CMemoryPixmap &samples, int colours) : pixmap(samples), planes(colours) {}

    void read(const CorvaneDeblur::pixelRect &area, std::byte *to, std::ptrdiff_t rowBytes) override
    {
        forRows(area, [&](std::byte *row, std::size_t bytes, std::ptrdiff_t line) {
            std::memcpy(to + line * rowBytes, row, bytes);
            if (pixmap.GetDepth() == 16)
                Sarnik::expandSamples(reinterpret_cast<std::uint16_t *>(to + line * rowBytes), bytes / 2);
        });
    }
    void write(const CorvaneDeblur::pixelRect &area, const std::byte *from, std::ptrdiff_t rowBytes) override
    {
        forRows(area, [&](std::byte *row, std::size_t bytes, std::ptrdiff_t line) {
            std::memcpy(row, from + line * rowBytes, bytes);
            if (pixmap.GetDepth() == 16)
                Sarnik::compressSamples(reinterpret_cast<std::uint16_t *>(row), bytes / 2);
        });
    }

private:
    template <class Body> void forRows(const CorvaneDeblur::pixelRect &area, Body body)
    {
        const CRect all = pixmap.Bounds();
        for (int p = 0; p < planes; ++p)
            for (int y = 0; y < area.height; ++y)
                body(pixmap.Plane(p).Row<std::byte>(all.top + area.y + y) + area.x * (pixmap.GetDepth() / 8),
                     static_cast<std::size_t>(area.width * (pixmap.GetDepth() / 8)),
                     std::ptrdiff_t{p} * area.height + y);
    }
    CMemoryPixmap &pixmap;
    int planes;
};

/// The picture as renderCells leaves it, then mixed with what it was by the mask.
inline std::unique_ptr<CMemoryPixmap> expectedPicture(memoryHost &host, int cellSize)
{
    const CRect all = host.kind.bounds;
    const int colours = host.kind.planes, planes = host.picture.GetPlaneCount();
    CorvaneDeblur::cellRenderSettings settings;
    settings.imageCols = static_cast<int>(all.Width());
    settings.imageRows = static_cast<int>(all.Height());
    settings.planes = colours;
    settings.depth = host.kind.depth;
    settings.cellSize = cellSize;
    Project::renderSettings collected;
    if (Project::collectAllKernels(host.kernels, host.params, colours, 1.0f, all.left, all.top, collected))
        settings.kernels = collected.kernels;
    settings.method = collected.method;

    auto result = std::make_unique<CMemoryPixmap>(all, host.kind.depth, planes);
    CMemoryPixmap &rendered = *result;
    copyPlanes(rendered, 0, host.picture, 0, planes, all);
    engineView from(host.picture, colours), to(rendered, colours);
    const std::atomic<bool> stop{false};
    CorvaneDeblur::renderCells(settings, host.kernels.ShrinkageTables(), from, to, {}, stop);

    const bool masked = host.HasSelection() || host.HasTransparency();
    if (masked && !settings.kernels.empty())
    {
        CMemoryPixmap source(all, host.kind.depth, colours + 1);
        copyPlanes(source, 0, host.picture, 0, colours, all);
        if (host.HasSelection())
            copyPlanes(source, colours, host.selection, 0, 1, all);
        else
            copyPlanes(source, colours, host.picture, colours, 1, all);
        blendByMask(rendered, source, colours, colours);
    }
    for (int p = 0; p < colours; ++p)
        if (p < static_cast<int>(collected.channels.size()) && !collected.channels[static_cast<std::size_t>(p)])
            copyPlanes(rendered, p, host.picture, p, 1, all);
    return result;
}

/// Different bytes, of all planes.
inline std::int64_t differences(const CMemoryPixmap &a, const CMemoryPixmap &b)
{
    std::int64_t count = 0;
    const CRect all = a.Bounds();
    for (int p = 0; p < a.GetPlaneCount(); ++p)
        for (std::int32_t y = all.top; y < all.bottom; ++y)
            for (std::int64_t i = 0; i < all.Width() * a.GetDepth() / 8; ++i)
                count += a.Plane(p).Row<std::byte>(y)[i] != b.Plane(p).Row<std::byte>(y)[i];
    return count;
}

} // namespace TestSupport
