#pragma once

#include "framework/base/exceptions.h"
#include "stages/stageHost.h"
#include "store/params.h"
#include "store/traces/kernelCollection.h"
#include "tests/framework/pixels/memoryPages.h"

#include <cstring>
#include <random>
#include <thread>

namespace TestSupport
{

using Sarnik::CBasicPixmap;
using Sarnik::CMemoryPixmap;
using Sarnik::CRect;

/// The samples of one plane at one place, whatever the depth.
template <class Visit> void withSamples(int depth, Visit visit)
{
    if (depth == 8)
        visit(std::uint8_t());
    else if (depth == 16)
        visit(std::uint16_t());
    else
        visit(float());
}

/// What a picture is.
struct pictureKind
{
    CRect bounds{0, 0, 64, 64};
    int depth = 8;
    int planes = 3;
    bool transparency = false;
    CRect selected{}; ///< an empty rectangle: no selection
};

/// A picture in memory: random samples, a selection with soft borders, and a second picture that takes what is written.
/// Checks that it is called by the thread that made it and only as its interface promises.
class memoryHost final : public Project::PStageHost
{
public:
    memoryHost(const pictureKind &what, Project::PKernelCollection &collection, unsigned seed = 1)
        : kind(what), picture(what.bounds, what.depth, what.planes + (what.transparency ? 1 : 0)),
          selection(what.bounds, what.depth, 1), written(what.bounds, what.depth, picture.GetPlaneCount()),
          kernels(collection), params(what.planes)
    {
        fill(picture, seed);
        copyPlanes(written, 0, picture, 0, picture.GetPlaneCount(), kind.bounds);
        fillSelection();
    }

    Sarnik::CImageFormat Format() const override
    {
        const auto colours = kind.planes == 3   ? Sarnik::CPixelKind::rgb
                             : kind.planes == 4 ? Sarnik::CPixelKind::cmyk
                                                : Sarnik::CPixelKind::grey;
        return {colours, kind.depth, kind.planes};
    }
    CRect ImageBounds() const override { return kind.bounds; }
    CRect SelectionBounds() const override { return HasSelection() ? kind.selected : kind.bounds; }
    bool HasSelection() const override { return !kind.selected.Empty(); }
    bool HasTransparency() const override { return kind.transparency; }

    void ReadSource(CBasicPixmap &pixmap) override
    {
        check(pixmap.Bounds());
        ++reads;
        copyPlanes(pixmap, 0, picture, 0, picture.GetPlaneCount(), pixmap.Bounds());
        if (failAtRead == reads)
            throw Sarnik::CAbort(true);
    }
    void ReadSelection(CBasicPixmap &pixmap, int plane) override
    {
        check(pixmap.Bounds());
        copyPlanes(pixmap, plane, selection, 0, 1, pixmap.Bounds());
    }
    void Write(CBasicPixmap &pixmap, const CRect &rect) override
    {
        check(rect);
        if (pixmap.GetPlaneCount() != picture.GetPlaneCount())
            throw std::logic_error("another number of planes");
        writes.push_back(rect);
        copyPlanes(written, 0, pixmap, 0, picture.GetPlaneCount(), rect);
    }
    Sarnik::CPageStore &PageStore() override { return pages; }
    Project::PParams &Params() override { return params; }
    Project::PKernelCollection &Kernels() override { return kernels; }
    void Progress(std::uint64_t done, std::uint64_t total) override { progress.push_back({done, total}); }
    bool Abort() override { return abortAtPoll != 0 && ++polls >= abortAtPoll; }

    const pictureKind kind;
    CMemoryPixmap picture, selection, written;
    memoryPages pages;
    Project::PKernelCollection &kernels;
    Project::PParams params;
    int reads = 0, failAtRead = 0, polls = 0, abortAtPoll = 0;
    std::vector<CRect> writes;
    std::vector<std::pair<std::uint64_t, std::uint64_t>> progress;

    static void fill(CMemoryPixmap &pixmap, unsigned seed)
    {
        std::mt19937 random(seed);
        const CRect r = pixmap.Bounds();
        withSamples(pixmap.GetDepth(), [&]<class Sample>(Sample) {
            for (int p = 0; p < pixmap.GetPlaneCount(); ++p)
                for (std::int32_t y = r.top; y < r.bottom; ++y)
                    for (int x = 0; x < r.Width(); ++x)
                    {
                        // Patches with a little noise: there are edges to restore and flat parts.
                        const unsigned patch = static_cast<unsigned>((x / 9) * 7 + (y / 11) * 13 + p * 5) % 16;
                        const double v = (patch + (random() % 64) / 64.0) / 17.0;
                        const double full = pixmap.GetDepth() == 8 ? 255 : pixmap.GetDepth() == 16 ? 32768 : 1.0;
                        pixmap.Plane(p).Row<Sample>(y)[x] = static_cast<Sample>(v * full);
                    }
        });
    }

private:
    void check(const CRect &rect) const
    {
        if (std::this_thread::get_id() != owner)
            throw std::logic_error("called on another thread");
        if (rect.Empty() || !kind.bounds.Contains(rect))
            throw std::logic_error("a rectangle outside of the picture");
    }

    /// Within its bounds whole, half, and not selected pixels.
    void fillSelection()
    {
        withSamples(kind.depth, [&]<class Sample>(Sample) {
            const double full = kind.depth == 8 ? 255 : kind.depth == 16 ? 32768 : 1.0;
            for (std::int32_t y = kind.selected.top; y < kind.selected.bottom; ++y)
                for (std::int32_t x = kind.selected.left; x < kind.selected.right; ++x)
                    selection.Plane(0).Row<Sample>(y)[x - kind.bounds.left] =
                        static_cast<Sample>(full * ((x + y) % 5) / 4.0);
        });
    }

    const std::thread::id owner = std::this_thread::get_id();
};

} // namespace TestSupport
