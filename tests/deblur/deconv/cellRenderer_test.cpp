#include "deblur/deconv/cellRenderer.h"

#include "deblur/deconv/shrinkageTableStore.h"
#include "tests/support/synthetic.h"

#include <gtest/gtest.h>
#include <tbb/global_control.h>
#include <tbb/task_arena.h>

#include <cstring>
#include <stdexcept>

using namespace CorvaneDeblur;
using namespace TestSupport;

namespace
{

struct readFailure : std::runtime_error
{
    using std::runtime_error::runtime_error;
};

/// A 16-bit picture in memory as source and as destination.
class picture : public planeReader, public planeWriter
{
public:
    picture(int pictureCols, int pictureRows, int picturePlanes)
        : cols(pictureCols), rows(pictureRows), planes(picturePlanes),
          samples(static_cast<std::size_t>(cols * rows * planes)), written(samples.size())
    {
        const floatArray noise = noiseImage(rows * planes, cols, 3, 0.0f, 65535.0f);
        for (std::size_t i = 0; i < samples.size(); ++i)
            samples[i] = static_cast<std::uint16_t>(noise.data[i]);
    }

    void read(const pixelRect &area, std::byte *to, std::ptrdiff_t rowBytes) override
    {
        checkInside(area);
        if (failsAtRow >= area.y && failsAtRow < area.y + area.height)
            throw readFailure("row cannot be read");
        forRows(area, [&](std::size_t first, int line) {
            std::memcpy(to + rowBytes * line, &samples[first], static_cast<std::size_t>(area.width) * 2);
        });
    }

    void write(const pixelRect &area, const std::byte *from, std::ptrdiff_t rowBytes) override
    {
        checkInside(area);
        forRows(area, [&](std::size_t first, int line) {
            std::memcpy(&samples[first], from + rowBytes * line, static_cast<std::size_t>(area.width) * 2);
            for (int x = 0; x < area.width; ++x)
                ++written[first + static_cast<std::size_t>(x)];
        });
    }

    bool writtenOnce() const
    {
        return std::all_of(written.begin(), written.end(), [](int times) { return times == 1; });
    }

    int cols, rows, planes;
    int failsAtRow = -1;
    std::vector<std::uint16_t> samples;
    std::vector<int> written; ///< disjoint cells: each count belongs to one thread

private:
    void checkInside(const pixelRect &area) const
    {
        if (area.x < 0 || area.y < 0 || area.width < 1 || area.height < 1 || area.x + area.width > cols ||
            area.y + area.height > rows)
            throw std::logic_error("rectangle outside of the picture");
    }

    template <typename Body> void forRows(const pixelRect &area, const Body &body) const
    {
        for (int plane = 0; plane < planes; ++plane)
            for (int y = 0; y < area.height; ++y)
                body(static_cast<std::size_t>((plane * rows + area.y + y) * cols + area.x), plane * area.height + y);
    }
};

class CellRenderer : public testing::Test
{
protected:
    cellRenderSettings settingsFor(const picture &p, int kernelSize) const
    {
        cellRenderSettings settings;
        settings.imageCols = p.cols;
        settings.imageRows = p.rows;
        settings.planes = p.planes;
        settings.depth = 16;
        settings.method = deconvolutionMethod::wiener;
        settings.cellSize = 32;
        settings.kernels.resize(1);
        settings.kernels[0].kernel = shakeKernel(kernelSize, kernelSize, 2);
        return settings;
    }

    bool render(const cellRenderSettings &settings, planeReader &source, planeWriter &destination)
    {
        return renderCells(settings, tables, source, destination, progress, stop);
    }

    shrinkageTableStore tables{""};
    std::atomic<bool> stop = false;
    std::function<void(int, int)> progress;
};

TEST_F(CellRenderer, CopiesWhenThereIsNoBlurToRemove)
{
    picture source(71, 53, 3);
    for (const int kernelSize : {0, 3, 4})
    {
        picture result(71, 53, 3);
        std::fill(result.samples.begin(), result.samples.end(), std::uint16_t{0});
        cellRenderSettings settings = settingsFor(source, std::max(kernelSize, 1));
        if (kernelSize == 0)
            settings.kernels.clear();
        EXPECT_TRUE(render(settings, source, result));
        EXPECT_EQ(result.samples, source.samples);
        EXPECT_TRUE(result.writtenOnce());
    }
    picture nothing(0, 0, 1);
    EXPECT_TRUE(render(settingsFor(nothing, 9), nothing, nothing));
}

TEST_F(CellRenderer, ACellIsTheMiddleOfItsRectangle)
{
    picture source(150, 140, 2), result(150, 140, 2);
    const cellRenderSettings settings = settingsFor(source, 7);
    ASSERT_TRUE(render(settings, source, result));
    EXPECT_TRUE(result.writtenOnce());

    const auto estimator = createLatentEstimator(settings.method, tables);
    estimator->setKernels(settings.kernels, 1.0f);
    const pixelRect cells[] = {{64, 32, 32, 32}, {0, 0, 32, 32}, {128, 128, 22, 12}};
    const pixelRect areas[] = {{50, 18, 60, 60}, {0, 0, 46, 46}, {114, 114, 36, 26}}; // 2 * 7 more on each side
    for (int i = 0; i < 3; ++i)
    {
        const pixelRect area = areas[i], cell = cells[i];
        std::vector<std::uint16_t> in(static_cast<std::size_t>(area.width * area.height * 2)), out(in.size());
        source.read(area, reinterpret_cast<std::byte *>(in.data()), area.width * 2);
        estimator->deconvolve(reinterpret_cast<std::byte *>(in.data()), reinterpret_cast<std::byte *>(out.data()),
                              area.x, area.y, area.width, area.height, 2, area.width * 2, area.width * 2, 16);
        int different = 0;
        for (int plane = 0; plane < 2; ++plane)
            for (int y = cell.y; y < cell.y + cell.height; ++y)
                for (int x = cell.x; x < cell.x + cell.width; ++x)
                    different +=
                        result.samples[static_cast<std::size_t>((plane * 140 + y) * 150 + x)] !=
                        out[static_cast<std::size_t>((plane * area.height + y - area.y) * area.width + x - area.x)];
        EXPECT_EQ(different, 0) << "cell " << i;
    }
}

TEST_F(CellRenderer, BytesDoNotDependOnThreads)
{
    picture source(170, 130, 3);
    for (const deconvolutionMethod method :
         {deconvolutionMethod::wiener, deconvolutionMethod::classic, deconvolutionMethod::fast})
    {
        cellRenderSettings settings = settingsFor(source, 9);
        settings.method = method;
        std::vector<std::uint16_t> expected;
        for (const int threads : {1, 2, 8})
        {
            const tbb::global_control limit(tbb::global_control::max_allowed_parallelism,
                                            static_cast<std::size_t>(threads));
            picture result(170, 130, 3);
            std::vector<int> told;
            progress = [&](int done, int total) {
                EXPECT_EQ(total, 30);
                told.push_back(done);
            };
            bool whole = false;
            tbb::task_arena(threads).execute([&] { whole = render(settings, source, result); });
            EXPECT_TRUE(whole && result.writtenOnce());
            ASSERT_EQ(told.size(), 30u);
            for (int i = 0; i < 30; ++i)
                EXPECT_EQ(told[static_cast<std::size_t>(i)], i + 1);
            if (threads == 1)
                expected = result.samples;
            EXPECT_EQ(result.samples, expected) << threads << " threads";
        }
    }
}

TEST_F(CellRenderer, PassesFailuresOn)
{
    picture source(170, 130, 1), result(170, 130, 1);
    const cellRenderSettings settings = settingsFor(source, 9);
    source.failsAtRow = 100;
    EXPECT_THROW(render(settings, source, result), readFailure);
    source.failsAtRow = -1;
    progress = [](int, int) { throw std::length_error("told too much"); };
    EXPECT_THROW(render(settings, source, result), std::length_error);
    progress = nullptr;
    EXPECT_TRUE(render(settings, source, result)) << "and works again";
}

TEST_F(CellRenderer, Stops)
{
    picture source(320, 320, 3), result(320, 320, 3);
    progress = [this](int done, int) { stop = stop || done == 2; };
    EXPECT_FALSE(render(settingsFor(source, 9), source, result));
    const auto pixels = std::count(result.written.begin(), result.written.end(), 1);
    EXPECT_GE(pixels, 2 * 3 * 32 * 32);
    EXPECT_LE(pixels, (2 + tbb::this_task_arena::max_concurrency()) * 3 * 32 * 32) << "cells in flight may be finished";

    picture untouched(320, 320, 3);
    EXPECT_FALSE(render(settingsFor(source, 9), source, untouched)) << "stopped before it began";
    EXPECT_EQ(std::count(untouched.written.begin(), untouched.written.end(), 0), 3 * 320 * 320);
}

} // namespace
