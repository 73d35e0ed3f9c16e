#include "deblur/deconv/latentEstimator.h"

#include "deblur/deconv/shrinkageTableStore.h"
#include "deblur/estimate/arrayOps.h"
#include "tests/support/matchers.h"
#include "tests/support/npy.h"
#include "tests/support/synthetic.h"

#include <gtest/gtest.h>

#include <atomic>
#include <cstdlib>
#include <cstring>
#include <mutex>
#include <stdexcept>

using namespace CorvaneDeblur;
using namespace TestSupport;

namespace
{

latentKernel traceOf(const floatArray &kernel, int left = 0, int top = 0, int right = 0, int bottom = 0)
{
    latentKernel trace;
    trace.kernel = kernel;
    trace.regionLeft = left;
    trace.regionTop = top;
    trace.regionRight = right;
    trace.regionBottom = bottom;
    return trace;
}

floatArray constantKernel(int rows, int cols, float value)
{
    const floatArray kernel = floatArray::allocate(rows, cols);
    fill(kernel, value);
    return kernel;
}

/// A method that notes what it is given and multiplies the plane by the trace's smoothing.
class notingEstimator : public latentEstimator
{
public:
    mutable std::mutex lock;
    mutable std::vector<latentKernel> seen;
    mutable int gridRows = 0, gridCols = 0;
    std::atomic<bool> *raise = nullptr;
    bool fails = false;

protected:
    void deconvolvePlane(const floatArray &padded, const latentKernel &trace, const floatArray &out) const override
    {
        const std::lock_guard guard(lock);
        if (fails)
            throw std::bad_alloc();
        if (raise)
            *raise = true;
        seen.push_back(trace);
        gridRows = padded.rows;
        gridCols = padded.cols;
        scaleInto(padded.subRect(0, 0, out.rows, out.cols), out, trace.smoothing);
    }
};

std::vector<std::byte> run(latentEstimator &estimator, const std::vector<std::byte> &in, int cols, int rows, int planes,
                           int depth = 8)
{
    std::vector<std::byte> out(in.size(), std::byte{0xEE});
    const std::ptrdiff_t rowBytes = cols * (depth / 8);
    estimator.deconvolve(in.data(), out.data(), 0, 0, cols, rows, planes, rowBytes, rowBytes, depth);
    return out;
}

TEST(LatentEstimator, ScalesKernelsAndRegions)
{
    notingEstimator estimator;
    const floatArray kernel = shakeKernel(45, 30, 1);
    const floatArray untouched = cloned(kernel);
    latentKernel trace = traceOf(kernel, -7, 30, 101, 2147483647);
    trace.smoothing = 1.0f;
    estimator.setKernels({trace}, 0.25f);
    run(estimator, std::vector<std::byte>(600), 30, 20, 1);
    ASSERT_EQ(estimator.seen.size(), 1u);
    const latentKernel &seen = estimator.seen[0];
    EXPECT_EQ(seen.kernel.rows, 11);
    EXPECT_EQ(seen.kernel.cols, 7);
    EXPECT_NEAR(sumAbs(seen.kernel), 1.0f, 1e-5f);
    EXPECT_EQ(seen.regionLeft, -1) << "truncated towards zero";
    EXPECT_EQ(seen.regionTop, 7);
    EXPECT_EQ(seen.regionRight, 25);
    EXPECT_EQ(estimator.gridRows, 30) << "fastSize(20 + 11 - 1)";
    EXPECT_EQ(estimator.gridCols, 36) << "fastSize(30 + 7 - 1)";
    EXPECT_TRUE(arrayIdentical(kernel, untouched)) << "the caller's kernel is its own";
}

TEST(LatentEstimator, KernelsWithoutWeightLeaveTheRectangle)
{
    const float nan = std::numeric_limits<float>::quiet_NaN();
    const float samples[] = {-3.0f, 0.5f, nan, 7.0f, 0.0f, 1.0f, 0.25f, 2e20f};
    std::vector<std::byte> in(sizeof samples);
    std::memcpy(in.data(), samples, sizeof samples);
    for (const floatArray &kernel : {constantKernel(7, 7, 0.0f), constantKernel(7, 7, nan), floatArray()})
    {
        notingEstimator estimator;
        estimator.setKernels({traceOf(kernel)}, 1.0f);
        EXPECT_TRUE(run(estimator, in, 4, 2, 1, 32) == in);
        EXPECT_TRUE(estimator.seen.empty());
    }

    // Beside another trace it stands for the blurred picture: 0.5 * 100 + 0.5 * 200.
    notingEstimator estimator;
    latentKernel half = traceOf(constantKernel(7, 7, 1.0f));
    half.smoothing = 0.5f;
    estimator.setKernels({half, traceOf(constantKernel(7, 7, 0.0f))}, 1.0f);
    const std::vector<std::byte> flat(600, std::byte{200});
    for (const std::byte b : run(estimator, flat, 30, 20, 1))
        EXPECT_NEAR(std::to_integer<int>(b), 150, 1);
}

TEST(LatentEstimator, StopsBetweenPlanesAndPassesFailuresOn)
{
    notingEstimator estimator;
    std::atomic<bool> stop = false;
    estimator.raise = &stop;
    estimator.setStopFlag(&stop);
    estimator.setKernels({traceOf(constantKernel(5, 5, 1.0f))}, 1.0f);
    const int planes = 500;
    run(estimator, std::vector<std::byte>(64 * planes), 8, 8, planes);
    EXPECT_GE(estimator.seen.size(), 1u);
    EXPECT_LT(estimator.seen.size(), 300u);

    stop = false;
    estimator.fails = true;
    EXPECT_THROW(run(estimator, std::vector<std::byte>(64), 8, 8, 1), std::bad_alloc);
}

TEST(LatentEstimator, BlendOfThreeTracesMatchesReference)
{
    const byteArray tile = readBytes("blend", "tile8"), expected = readBytes("blend", "out8");
    const std::vector<latentKernel> traces = {traceOf(readFloats("blend", "kernel0"), 0, 0, 60, 60),
                                              traceOf(readFloats("blend", "kernel1"), 90, 50, 150, 130),
                                              traceOf(readFloats("blend", "kernel2"), 40, 60, 100, 100)};
    shrinkageTableStore tables("");
    const auto estimator = createLatentEstimator(deconvolutionMethod::wiener, tables);
    estimator->setKernels(traces, 1.0f);
    const byteArray out = byteArray::allocate(tile.rows, tile.cols);
    estimator->deconvolve(reinterpret_cast<const std::byte *>(tile.data), reinterpret_cast<std::byte *>(out.data), 10,
                          20, tile.cols, tile.rows, 1, tile.stride, out.stride, 8);
    EXPECT_EQ(estimator->activeTraces(), (std::vector<int>{0, 1, 2}));
    int outside = 0, different = 0;
    for (int i = 0; i < tile.rows * tile.cols; ++i)
    {
        outside += std::abs(out.data[i] - expected.data[i]) > 1;
        different += out.data[i] != expected.data[i];
    }
    EXPECT_LE(outside, 12) << "of 12000 samples";
    EXPECT_LE(different, 60) << "truncation turns the last bit of a float into a level, but seldom";
}

} // namespace
