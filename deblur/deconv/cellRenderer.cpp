#include "deblur/deconv/cellRenderer.h"

#include "deblur/deconv/cellGrid.h"
#include "platform/math/alignedBuffer.h"

#include <tbb/parallel_for.h>
#include <tbb/partitioner.h>
#include <tbb/task_arena.h>

#include <algorithm>
#include <cstring>
#include <exception>
#include <mutex>

namespace CorvaneDeblur
{
namespace
{

/// Kernels with fewer columns change nothing that can be seen.
constexpr int leastKernelCols = 5;

int largestKernelCols(const std::vector<latentKernel> &kernels)
{
    int cols = 0;
    for (const latentKernel &trace : kernels)
        cols = std::max(cols, trace.kernel.cols);
    return cols;
}

/// Memory for the samples of a rectangle; keeps what it has.
class cellMemory
{
public:
    std::byte *sized(std::size_t bytes)
    {
        if (buffer.count() < bytes)
            buffer = alignedBuffer<std::byte>(bytes);
        return buffer.data();
    }

private:
    alignedBuffer<std::byte> buffer;
};

/// What the threads of one render share.
class cellJob
{
public:
    cellJob(const cellRenderSettings &what, shrinkageTableStore &store, planeReader &from, planeWriter &to,
            const std::function<void(int, int)> &report, const std::atomic<bool> &stopFlag)
        : settings(what), tables(store), source(from), destination(to), progress(report), stop(stopFlag),
          grid(what.imageCols, what.imageRows, what.cellSize), kernelCols(largestKernelCols(what.kernels))
    {
    }

    int cells() const { return grid.count(); }

    /// One thread's share: the next cell until there is none. Never throws.
    void work() noexcept
    {
        try
        {
            worker state;
            if (kernelCols >= leastKernelCols)
            {
                state.estimator = createLatentEstimator(settings.method, tables);
                state.estimator->setKernels(settings.kernels, 1.0f);
                state.estimator->setStopFlag(&stop);
            }
            while (!stop && !failed)
            {
                const int index = next++;
                if (index >= cells())
                    break;
                if (!render(grid.cell(index), state))
                    break;
                countDone();
            }
        }
        catch (...)
        {
            fail(std::current_exception());
        }
    }

    /// After all threads are through: throws what one of them caught, or tells whether every cell is done.
    bool finished() const
    {
        if (error)
            std::rethrow_exception(error);
        return done == cells();
    }

private:
    struct worker
    {
        std::unique_ptr<latentEstimator> estimator; ///< none: cells are copied
        cellMemory in, out;
    };

    std::ptrdiff_t rowBytes(const pixelRect &area) const
    {
        return static_cast<std::ptrdiff_t>(area.width) * (settings.depth / 8);
    }

    std::size_t bytes(const pixelRect &area) const
    {
        return static_cast<std::size_t>(rowBytes(area)) * static_cast<std::size_t>(area.height) *
               static_cast<std::size_t>(std::max(settings.planes, 0));
    }

    /// False when it was stopped on the way; nothing is written then.
    bool render(const pixelRect &cell, worker &state)
    {
        const pixelRect area = state.estimator ? grid.grown(cell, 2 * kernelCols) : cell;
        const std::ptrdiff_t pitch = rowBytes(area);
        std::byte *in = state.in.sized(bytes(area));
        source.read(area, in, pitch);
        if (state.estimator)
        {
            std::byte *out = state.out.sized(bytes(area));
            // Isolated: while it waits for planes on other threads, this one must not start a second cell.
            tbb::this_task_arena::isolate([&] {
                state.estimator->deconvolve(in, out, area.x, area.y, area.width, area.height, settings.planes, pitch,
                                            pitch, settings.depth);
            });
            if (stop)
                return false;
            takeCell(out, area, in, cell);
        }
        if (failed)
            return false;
        destination.write(cell, in, rowBytes(cell));
        return true;
    }

    /// Copies the cell out of the planes of the area around it, into memory that is free by now.
    void takeCell(const std::byte *planes, const pixelRect &area, std::byte *cellPlanes, const pixelRect &cell) const
    {
        const std::ptrdiff_t pitch = rowBytes(area), cellPitch = rowBytes(cell);
        const std::ptrdiff_t first = pitch * (cell.y - area.y) + (cell.x - area.x) * (settings.depth / 8);
        for (int plane = 0; plane < settings.planes; ++plane)
            for (int y = 0; y < cell.height; ++y)
                std::memcpy(cellPlanes + cellPitch * (static_cast<std::ptrdiff_t>(plane) * cell.height + y),
                            planes + pitch * (static_cast<std::ptrdiff_t>(plane) * area.height + y) + first,
                            static_cast<std::size_t>(cellPitch));
    }

    void countDone()
    {
        const std::lock_guard guard(lock);
        ++done;
        if (progress)
            progress(done, cells());
    }

    void fail(std::exception_ptr caught) noexcept
    {
        const std::lock_guard guard(lock);
        if (!error)
            error = std::move(caught);
        failed = true;
    }

    const cellRenderSettings &settings;
    shrinkageTableStore &tables;
    planeReader &source;
    planeWriter &destination;
    const std::function<void(int, int)> &progress;
    const std::atomic<bool> &stop;
    const cellGrid grid;
    const int kernelCols;

    std::atomic<int> next{0};
    std::atomic<bool> failed{false};
    std::mutex lock; ///< guards done and error, and is held while progress is told
    int done = 0;
    std::exception_ptr error;
};

} // namespace

bool renderCells(const cellRenderSettings &settings, shrinkageTableStore &tables, planeReader &source,
                 planeWriter &destination, const std::function<void(int done, int total)> &progress,
                 const std::atomic<bool> &stop)
{
    cellJob job(settings, tables, source, destination, progress, stop);
    const int workers = std::min(tbb::this_task_arena::max_concurrency(), job.cells());
    // One task a worker, whatever the number of threads that come: the first ones take all cells if need be.
    tbb::parallel_for(
        0, workers, 1, [&](int) { job.work(); }, tbb::simple_partitioner());
    return job.finished();
}

} // namespace CorvaneDeblur
