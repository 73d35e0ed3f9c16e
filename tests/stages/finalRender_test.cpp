#include "deblur/deconv/cellRenderer.h"
#include "framework/pixels/maskBlend.h"
#include "framework/pixels/sixteenBit.h"
#include "stages/imageHub.h"
#include "stages/render/collectKernels.h"
#include "tests/stages/stageFixture.h"
#include "tests/stages/stageTraces.h"
#include "tests/support/synthetic.h"

#include <gtest/gtest.h>
#include <tbb/global_control.h>
#include <tbb/task_arena.h>

using namespace TestSupport;
using namespace Project;
using namespace CorvaneDeblur;

namespace
{

/// A pixmap as the engine's renderer sees pictures: from 0, 0 on, 16-bit samples in the estimator's range.
class engineView final : public planeReader, public planeWriter
{
public:
    engineView(CMemoryPixmap &samples, int colours) : pixmap(samples), planes(colours) {}

    void read(const pixelRect &area, std::byte *to, std::ptrdiff_t rowBytes) override
    {
        forRows(area, [&](std::byte *row, std::size_t bytes, std::ptrdiff_t line) {
            std::memcpy(to + line * rowBytes, row, bytes);
            if (pixmap.GetDepth() == 16)
                Sarnik::expandSamples(reinterpret_cast<std::uint16_t *>(to + line * rowBytes), bytes / 2);
        });
    }
    void write(const pixelRect &area, const std::byte *from, std::ptrdiff_t rowBytes) override
    {
        forRows(area, [&](std::byte *row, std::size_t bytes, std::ptrdiff_t line) {
            std::memcpy(row, from + line * rowBytes, bytes);
            if (pixmap.GetDepth() == 16)
                Sarnik::compressSamples(reinterpret_cast<std::uint16_t *>(row), bytes / 2);
        });
    }

private:
    template <class Body> void forRows(const pixelRect &area, Body body)
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
std::unique_ptr<CMemoryPixmap> expectedPicture(memoryHost &host, int cellSize)
{
    const CRect all = host.kind.bounds;
    const int colours = host.kind.planes, planes = host.picture.GetPlaneCount();
    cellRenderSettings settings;
    settings.imageCols = static_cast<int>(all.Width());
    settings.imageRows = static_cast<int>(all.Height());
    settings.planes = colours;
    settings.depth = host.kind.depth;
    settings.cellSize = cellSize;
    renderSettings collected;
    if (collectAllKernels(host.kernels, host.params, colours, 1.0f, all.left, all.top, collected))
        settings.kernels = collected.kernels;
    settings.method = collected.method;

    auto result = std::make_unique<CMemoryPixmap>(all, host.kind.depth, planes);
    CMemoryPixmap &rendered = *result;
    copyPlanes(rendered, 0, host.picture, 0, planes, all);
    engineView from(host.picture, colours), to(rendered, colours);
    const std::atomic<bool> stop{false};
    renderCells(settings, host.kernels.ShrinkageTables(), from, to, {}, stop);

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
std::int64_t differences(const CMemoryPixmap &a, const CMemoryPixmap &b)
{
    std::int64_t count = 0;
    const CRect all = a.Bounds();
    for (int p = 0; p < a.GetPlaneCount(); ++p)
        for (std::int32_t y = all.top; y < all.bottom; ++y)
            for (std::int64_t i = 0; i < all.Width() * a.GetDepth() / 8; ++i)
                count += a.Plane(p).Row<std::byte>(y)[i] != b.Plane(p).Row<std::byte>(y)[i];
    return count;
}

class FinalRender : public testing::Test
{
protected:
    bool render(memoryHost &host, int cellSize = 48)
    {
        PImageHub hub(host);
        hub.SetCellSize(cellSize);
        return hub.RenderWithCallbacks();
    }

    stageTraces traces;
};

TEST_F(FinalRender, EqualsTheEnginesCellsBitForBit)
{
    traces.add(shakeKernel(7, 7, 3), {20, 20, 90, 90});
    traces.add(shakeKernel(9, 9, 5), {90, 40, 170, 150});
    const CRect away{37, 21, 37 + 181, 21 + 139}, atZero{0, 0, 150, 97};
    const CRect part{61, 44, 147, 133};
    const pictureKind kinds[] = {{atZero, 8, 3, false, {}},  {away, 8, 3, false, part},  {away, 8, 1, true, {}},
                                 {away, 8, 4, true, part},   {away, 16, 3, false, {}},   {away, 16, 3, true, part},
                                 {atZero, 16, 1, false, {}}, {away, 16, 4, false, part}, {away, 32, 3, false, {}},
                                 {away, 32, 1, true, part}};
    unsigned seed = 1;
    for (const pictureKind &kind : kinds)
        for (const int threads : {1, 2, 8})
        {
            const tbb::global_control limit(tbb::global_control::max_allowed_parallelism,
                                            static_cast<std::size_t>(threads));
            memoryHost host(kind, traces.collection, ++seed);
            host.params.fineResult = kind.depth != 8; // both methods
            if (kind.planes == 4)
                host.params.deconvChannels = {0, 2, 9};
            ASSERT_TRUE(tbb::task_arena(threads).execute([&] { return render(host); }));
            const auto expected = expectedPicture(host, 48);
            EXPECT_EQ(differences(host.written, *expected), 0)
                << kind.depth << " bits, " << kind.planes << " planes, " << threads << " threads";
            EXPECT_GT(differences(host.written, host.picture), 1000) << "something was rendered";
            EXPECT_EQ(host.pages.Live(), 0);

            CRect last{kind.bounds.left, kind.bounds.top - 1, 0, 0};
            for (const CRect &cell : host.writes)
            {
                EXPECT_TRUE(cell.top > last.top || (cell.top == last.top && cell.left > last.left)) << "row order";
                EXPECT_TRUE(host.SelectionBounds().Contains(cell));
                last = cell;
            }
            EXPECT_LE(host.reads, 4 * 4) << "each cell of the source is read once";
            EXPECT_EQ(host.progress.back().first, host.progress.back().second);
        }
}

TEST_F(FinalRender, WithoutATraceNothingChanges)
{
    for (const int kernelSize : {0, 4})
    {
        if (kernelSize > 0)
            traces.add(shakeKernel(kernelSize, kernelSize, 3), {20, 20, 90, 90});
        memoryHost host({{5, 5, 160, 120}, 16, 3, false, {30, 30, 80, 99}}, traces.collection);
        ASSERT_TRUE(render(host));
        EXPECT_EQ(differences(host.written, host.picture), 0);
        EXPECT_FALSE(host.writes.empty());
    }
}

TEST_F(FinalRender, StopsWhenAskedAndPassesFailuresOn)
{
    traces.add(shakeKernel(9, 9, 3), {20, 20, 90, 90});
    for (int i = 1; i < 40; i += 6)
    {
        memoryHost host({{0, 0, 300, 300}, 8, 3, false, {}}, traces.collection);
        host.abortAtPoll = i;
        EXPECT_FALSE(render(host));
        EXPECT_LT(host.writes.size(), 49u);
        host.abortAtPoll = 0;
        host.failAtRead = host.reads + i;
        EXPECT_THROW(render(host), Sarnik::CAbort);
        host.failAtRead = 0;
        EXPECT_TRUE(render(host)) << "and works again";
        EXPECT_EQ(differences(host.written, *expectedPicture(host, 48)), 0);
    }
}

} // namespace
