#include "bench/transformTally.h"

#include "deblur/deconv/classicDeconvolver.h"
#include "deblur/deconv/fastSize.h"
#include "deblur/deconv/hyperLaplacianDeconvolver.h"
#include "deblur/estimate/kernelPyramid.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <map>
#include <mutex>
#include <utility>

using namespace CorvaneDeblur;

namespace Bench
{
namespace
{

/// Deconvolves as the method does, and counts.
class countingEstimator final : public latentEstimator
{
public:
    struct sums
    {
        std::mutex lock;
        std::map<std::pair<int, int>, transformCount> grids;
    };

    countingEstimator(deconvolutionMethod chosen, shrinkageTableStore &store, sums &target)
        : method(chosen), tables(store), counts(target)
    {
    }

protected:
    void deconvolvePlane(const floatArray &padded, const latentKernel &trace, const floatArray &out) const override
    {
        long forward = 2, inverse = 1;
        if (method == deconvolutionMethod::fast)
        {
            hyperLaplacianDeconvolver deconvolver(padded, tables, workers::one);
            deconvolver.run(out, trace.kernel, trace.smoothing, trace.suppression);
            forward += deconvolver.gradientRounds();
            inverse = 6;
        }
        if (method == deconvolutionMethod::classic)
        {
            classicDeconvolver deconvolver(padded, tables, workers::one);
            deconvolver.run(out, trace.kernel, trace.smoothing, trace.suppression);
            forward += deconvolver.gradientTransforms();
            inverse = 6 + 5;
        }
        const std::lock_guard guard(counts.lock);
        transformCount &grid = counts.grids.try_emplace({padded.rows, padded.cols}).first->second;
        grid.rows = padded.rows;
        grid.cols = padded.cols;
        grid.forward += forward;
        grid.inverse += inverse;
    }

private:
    deconvolutionMethod method;
    shrinkageTableStore &tables;
    sums &counts;
};

} // namespace

std::vector<transformCount> transformsOfDeconvolution(deconvolutionMethod method, memoryPhoto &photo,
                                                      const std::vector<pixelRect> &areas, const latentKernel &trace,
                                                      shrinkageTableStore &tables)
{
    countingEstimator::sums counts;
    tbb::parallel_for(std::size_t{0}, areas.size(), [&](std::size_t i) {
        const pixelRect &area = areas[i];
        countingEstimator estimator(method, tables, counts);
        estimator.setKernels({trace}, 1.0f);
        std::vector<std::byte> in(static_cast<std::size_t>(area.width) * static_cast<std::size_t>(area.height) *
                                  static_cast<std::size_t>(photo.planes));
        std::vector<std::byte> out(in.size());
        photo.read(area, in.data(), area.width);
        estimator.deconvolve(in.data(), out.data(), area.x, area.y, area.width, area.height, photo.planes, area.width,
                             area.width, 8);
    });
    photo.takeReads();

    std::vector<transformCount> result;
    for (const auto &entry : counts.grids)
        result.push_back(entry.second);
    return result;
}

std::vector<transformCount> transformsOfEstimation(int imageRows, int imageCols, int kernelSize, int passes)
{
    std::vector<transformCount> result;
    for (const levelSize &level : buildPyramid(kernelSize, kernelSize, pyramidScale, pyramidMinimum))
    {
        const float share = static_cast<float>(level.cols) / static_cast<float>(kernelSize);
        const int rows = std::min(scaledSize(imageRows, share), imageRows);
        const int cols = std::min(scaledSize(imageCols, share), imageCols);
        result.push_back(
            {fastSize(rows + level.rows - 1), fastSize(cols + level.cols - 1), 2 + 3L * passes, 1 + 3L * passes});
    }
    return result;
}

} // namespace Bench
