#pragma once

#include "deblur/deconv/latentKernel.h"

#include <atomic>
#include <cstddef>
#include <memory>
#include <vector>

namespace CorvaneDeblur
{

class shrinkageTableStore;

/// Deconvolution methods, by number.
enum class deconvolutionMethod
{
    wiener = 0,  ///< latentEstimatorWiener: closed form, quick
    classic = 1, ///< latentEstimatorFastHyperLaplacian_Old
    fast = 2,    ///< latentEstimatorFastHyperLaplacian: the default
};

/// Turns a blurred rectangle of pixels into a sharpened one. Base of the three methods: it holds the traces, runs the
/// planes in parallel, converts from and to pixel storage and mixes the results of several traces.
///
/// An object serves one rectangle at a time; the planes run on the current tbb arena and only read its members.
class latentEstimator
{
public:
    virtual ~latentEstimator() = default;

    /// Installs the traces of a render: their kernels are copied, resampled by `scale` (at least one row and column
    /// stays) and scaled to a sum of 1, their regions multiplied by `scale`. At least one trace before deconvolve.
    void setKernels(const std::vector<latentKernel> &traces, float scale);

    /// Deconvolves a rectangle; blocks until every plane is done.
    ///
    /// source, destination: planar memory, not overlapping. Sample (plane p, row r, column c) lies at byte
    /// p * rectRows * rowBytes + r * rowBytes + c * (depth / 8); depth is 8, 16 (0..65535) or 32 (float, 0..1).
    /// originX, originY: image position of the rectangle's top left pixel at the render scale.
    /// A kernel without any weight leaves the rectangle as it was.
    void deconvolve(const std::byte *source, std::byte *destination, int originX, int originY, int rectCols,
                    int rectRows, int planes, std::ptrdiff_t sourceRowBytes, std::ptrdiff_t destinationRowBytes,
                    int depth);

    /// While `stop`, which outlives the object, is true, deconvolve starts no plane; the destination's remaining planes
    /// are then undefined. Null for none.
    void setStopFlag(const std::atomic<bool> *stop) { stopFlag = stop; }

    /// Indices, ascending, of the traces that matter in the rectangle of the last deconvolve.
    const std::vector<int> &activeTraces() const { return activeKernels; }

protected:
    /// Deconvolves one extended plane with one trace. padded: the grid; out: rectRows x rectCols, overwritten.
    /// Called on several threads at once.
    virtual void deconvolvePlane(const floatArray &padded, const latentKernel &trace, const floatArray &out) const = 0;

private:
    void prepareRectangle(int originX, int originY, int cols, int rows);
    void runPlane(int plane, const std::byte *source, std::byte *destination, std::ptrdiff_t sourceRowBytes,
                  std::ptrdiff_t destinationRowBytes, int depth) const;
    bool stopped() const { return stopFlag && stopFlag->load(std::memory_order_relaxed); }

    std::vector<latentKernel> kernels;
    std::vector<int> activeKernels;
    int paddedCols = 0, paddedRows = 0; ///< transform grid of the rectangle
    int rectCols = 0, rectRows = 0;
    int originX = 0, originY = 0;
    const std::atomic<bool> *stopFlag = nullptr;
};

/// A new estimator of the method; `tables` is kept as a pointer by the two hyper-Laplacian methods and outlives it.
std::unique_ptr<latentEstimator> createLatentEstimator(deconvolutionMethod method, shrinkageTableStore &tables);

} // namespace CorvaneDeblur
