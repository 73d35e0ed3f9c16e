#pragma once

#include "deblur/deconv/cellGrid.h"
#include "deblur/deconv/latentEstimator.h"

#include <atomic>
#include <cstddef>
#include <functional>
#include <vector>

namespace CorvaneDeblur
{

/// Where the renderer gets pixels from and puts them. Called from several threads at once, for any rectangle inside
/// the image, in planar memory as latentEstimator::deconvolve describes it. Exceptions end the render and come out of
/// it.
class planeReader
{
public:
    virtual ~planeReader() = default;
    virtual void read(const pixelRect &area, std::byte *planes, std::ptrdiff_t rowBytes) = 0;
};

class planeWriter
{
public:
    virtual ~planeWriter() = default;
    /// Each pixel of the image is written exactly once.
    virtual void write(const pixelRect &area, const std::byte *planes, std::ptrdiff_t rowBytes) = 0;
};

/// What a render depends on.
struct cellRenderSettings
{
    int imageCols = 0, imageRows = 0;
    int planes = 1;
    int depth = 8; ///< bits a sample: 8, 16 or 32 (float)
    deconvolutionMethod method = deconvolutionMethod::fast;
    std::vector<latentKernel> kernels; ///< at full resolution; none: the image is copied
    int cellSize = 512;                ///< side of a cell in pixels
};

/// Deconvolves an image of any size cell by cell. A cell reads twice the largest kernel's width more than itself on
/// every side, so that what wraps around its grid stays out of what is kept; kernels of fewer than 5 columns change
/// nothing and the image is copied. Cells are taken in row order and computed by as many threads as the current tbb
/// arena has; memory is bounded by one cell per thread. The result does not depend on the number of threads.
///
/// progress(done, total) is called after every cell, from any thread but never from two at once. `stop` is looked at
/// before every plane of a cell. Returns false when it was stopped.
bool renderCells(const cellRenderSettings &settings, shrinkageTableStore &tables, planeReader &source,
                 planeWriter &destination, const std::function<void(int done, int total)> &progress,
                 const std::atomic<bool> &stop);

} // namespace CorvaneDeblur
