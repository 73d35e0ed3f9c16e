#include "deblur/deconv/classicDeconvolver.h"
#include "deblur/deconv/extendPeriodic.h"
#include "deblur/deconv/fastSize.h"
#include "deblur/deconv/hyperLaplacianDeconvolver.h"
#include "deblur/deconv/latentEstimator.h"
#include "deblur/deconv/latentEstimatorWiener.h"
#include "deblur/deconv/shrinkageTableStore.h"
#include "deblur/estimate/arrayOps.h"
#include "tests/reference/literalHyperLaplacian.h"
#include "tests/reference/literalWiener.h"
#include "tests/support/matchers.h"
#include "tests/support/npy.h"
#include "tests/support/synthetic.h"

#include <tbb/global_control.h>
#include <tbb/task_arena.h>

#include <algorithm>
#include <cstddef>
#include <limits>
#include <string>
#include <vector>

using namespace CorvaneDeblur;
using namespace TestSupport;

namespace
{

/// Tables for all tests of this program: building them costs more than most tests.
shrinkageTableStore &tables()
{
    static shrinkageTableStore store("");
    return store;
}

floatArray extendedFor(const floatArray &tile, const floatArray &kernel)
{
    const floatArray padded =
        floatArray::allocate(fastSize(tile.rows + kernel.rows - 1), fastSize(tile.cols + kernel.cols - 1));
    extendPeriodic(tile, padded);
    return padded;
}

constexpr deconvolutionMethod allMethods[] = {deconvolutionMethod::wiener, deconvolutionMethod::classic,
                                              deconvolutionMethod::fast};

/// The result of a method on a tile's periodic grid, without the limits of pixel storage.
void deconvolve(deconvolutionMethod method, const floatArray &padded, const floatArray &kernel, float smoothing,
                float suppression, const floatArray &out, workers who = workers::all)
{
    if (method == deconvolutionMethod::wiener)
        wienerDeconvolve(padded, kernel, smoothing, out, who);
    else if (method == deconvolutionMethod::classic)
        classicDeconvolver(padded, tables(), who).run(out, kernel, smoothing, suppression);
    else
        hyperLaplacianDeconvolver(padded, tables(), who).run(out, kernel, smoothing, suppression);
}

void literalDeconvolve(deconvolutionMethod method, const floatArray &padded, const floatArray &kernel, float smoothing,
                       float suppression, const floatArray &out)
{
    if (method == deconvolutionMethod::wiener)
        Reference::literalWiener(padded, kernel, smoothing, out);
    else if (method == deconvolutionMethod::classic)
        Reference::literalHyperLaplacianOld(padded, kernel, smoothing, suppression, tables(), out);
    else
        Reference::literalHyperLaplacian(padded, kernel, smoothing, suppression, tables(), out);
}

struct referenceCase
{
    const char *name;
    deconvolutionMethod method;
    float smoothing, suppression;
};

TEST(Methods, MatchReferenceValues)
{
    const auto wiener = deconvolutionMethod::wiener, fast = deconvolutionMethod::fast;
    const auto classic = deconvolutionMethod::classic;
    for (const referenceCase &c : {referenceCase{"wiener_0", wiener, 0.0f, 0.0f},
                                   {"wiener_0.3", wiener, 0.3f, 0.0f},
                                   {"wiener_1", wiener, 1.0f, 0.0f},
                                   {"fast_0_0", fast, 0.0f, 0.0f},
                                   {"fast_0.3_0.3", fast, 0.3f, 0.3f},
                                   {"fast_0.3_0.9", fast, 0.3f, 0.9f},
                                   {"fast_0.3_1", fast, 0.3f, 1.0f},
                                   {"fast_1_0.5", fast, 1.0f, 0.5f},
                                   {"classic_0_0", classic, 0.0f, 0.0f},
                                   {"classic_0.3_0.3", classic, 0.3f, 0.3f},
                                   {"classic_0.3_0.9", classic, 0.3f, 0.9f},
                                   {"classic_0.3_1", classic, 0.3f, 1.0f},
                                   {"classic_1_0.5", classic, 1.0f, 0.5f}})
    {
        SCOPED_TRACE(c.name);
        const floatArray tile = readFloats(c.name, "tile"), kernel = readFloats(c.name, "kernel");
        const floatArray expected = readFloats(c.name, "out"), out = floatArray::allocate(tile.rows, tile.cols);
        deconvolve(c.method, extendedFor(tile, kernel), kernel, c.smoothing, c.suppression, out);
        if (c.method == wiener)
            EXPECT_TRUE(arrayWithin(out, expected, 3e-5, 3e-6));
        else
            EXPECT_TRUE(arrayWithin(out, expected, 0.02, 3e-5, 2e-4));
    }
}

// Tiles and grids odd and even on either axis, kernels wide, tall, even, of one sample, and larger than the tile.
TEST(Methods, EqualLiteralOnesOnAnyShape)
{
    const struct
    {
        int rows, cols, kernelRows, kernelCols, gridRows, gridCols;
        float smoothing, suppression;
    } cases[] = {{31, 44, 5, 9, 35, 52, 0.3f, 0.3f},  {64, 51, 7, 7, 70, 63, 0.0f, 0.0f},
                 {40, 40, 4, 6, 44, 45, 1.0f, 1.0f},  {23, 70, 1, 15, 25, 84, 0.5f, 0.85f},
                 {50, 33, 17, 3, 66, 35, 0.2f, 0.5f}, {12, 9, 21, 25, 32, 33, 0.3f, 0.3f},
                 {20, 26, 1, 1, 20, 26, 0.1f, 0.0f},  {1, 40, 1, 9, 1, 48, 0.3f, 0.2f}};
    for (const auto &c : cases)
        for (const deconvolutionMethod method : allMethods)
        {
            SCOPED_TRACE("method " + std::to_string(static_cast<int>(method)) + ", " + std::to_string(c.rows) + " x " +
                         std::to_string(c.cols) + ", kernel " + std::to_string(c.kernelRows) + " x " +
                         std::to_string(c.kernelCols));
            const floatArray kernel = shakeKernel(c.kernelRows, c.kernelCols, 91);
            const floatArray tile = blurred(edgeScene(c.rows, c.cols, 92), kernel, 0.004f, 93);
            const floatArray padded = floatArray::allocate(c.gridRows, c.gridCols);
            extendPeriodic(tile, padded);
            const floatArray out = stridedCopy(tile), expected = floatArray::allocate(c.rows, c.cols);
            deconvolve(method, stridedCopy(padded), stridedCopy(kernel), c.smoothing, c.suppression, out);
            literalDeconvolve(method, padded, kernel, c.smoothing, c.suppression, expected);
            if (method == deconvolutionMethod::wiener)
                EXPECT_TRUE(arrayNear(out, expected, 2e-5));
            else
                EXPECT_TRUE(arrayWithin(out, expected, 0.02, 1e-4));
            EXPECT_TRUE(marginUntouched(out));
        }
}

TEST(Methods, SharpenAndDoNotDependOnTheNumberOfThreads)
{
    const tbb::global_control eightThreads(tbb::global_control::max_allowed_parallelism, 8);
    const floatArray scene = edgeScene(90, 110, 94), kernel = shakeKernel(9, 9, 95);
    const floatArray tile = blurred(scene, kernel, 0.002f, 96), padded = extendedFor(tile, kernel);
    const double before = differenceOf(tile, scene, 0.0).rms;
    for (const deconvolutionMethod method : allMethods)
    {
        SCOPED_TRACE(static_cast<int>(method));
        const floatArray one = floatArray::allocate(90, 110);
        deconvolve(method, padded, kernel, 0.1f, 0.1f, one, workers::one);
        EXPECT_LT(differenceOf(one, scene, 0.0).rms, 0.75 * before);
        for (const int threads : {1, 2, 8})
        {
            const floatArray out = floatArray::allocate(90, 110);
            tbb::task_arena arena(threads);
            arena.execute([&] { deconvolve(method, padded, kernel, 0.1f, 0.1f, out); });
            EXPECT_TRUE(arrayIdentical(out, one)) << threads << " threads";
        }
    }
}

TEST(Methods, FlatPlaneStaysFlat)
{
    const floatArray kernel = shakeKernel(7, 11, 97), tile = floatArray::allocate(33, 40);
    for (const float level : {0.0f, 0.2f, 0.7f, 1.0f})
        for (const deconvolutionMethod method : allMethods)
            for (const float setting : {0.0f, 0.3f, 1.0f})
            {
                fill(tile, level);
                const floatArray out = floatArray::allocate(33, 40);
                deconvolve(method, extendedFor(tile, kernel), kernel, setting, setting, out);
                EXPECT_TRUE(arrayNear(out, tile, 3e-6)) << static_cast<int>(method) << " at " << setting;
            }
}

std::vector<float> estimated(deconvolutionMethod method, const latentKernel &trace, const std::vector<float> &in,
                             int cols, int rows)
{
    const auto estimator = createLatentEstimator(method, tables());
    estimator->setKernels({trace}, 1.0f);
    std::vector<float> out(in.size(), -1.0f);
    estimator->deconvolve(reinterpret_cast<const std::byte *>(in.data()), reinterpret_cast<std::byte *>(out.data()), 5,
                          6, cols, rows, 1, cols * 4, cols * 4, 32);
    return out;
}

// The classes behind the methods' numbers are those of the functions above. A sample that is no number costs a few
// pixels, not the tile.
TEST(LatentEstimator, PlanesEqualTheMethodAndSpoiltSamplesCountAsZero)
{
    const int rows = 41, cols = 36;
    const floatArray kernel = shakeKernel(7, 5, 103), tile = noiseImage(rows, cols, 104, 0.3f, 0.6f);
    latentKernel trace;
    trace.kernel = cloned(kernel);
    scaleInto(trace.kernel, trace.kernel, 3.0f); // setKernels scales it back
    trace.smoothing = 0.2f;
    trace.suppression = 0.4f;
    tile.data[200] = tile.data[300] = tile.data[400] = 0.0f;
    for (const deconvolutionMethod method : allMethods)
    {
        std::vector<float> in(tile.data, tile.data + rows * cols);
        const std::vector<float> out = estimated(method, trace, in, cols, rows);
        const floatArray actual = floatArray::allocate(rows, cols), expected = floatArray::allocate(rows, cols);
        std::copy(out.begin(), out.end(), actual.data);
        deconvolve(method, extendedFor(tile, kernel), kernel, 0.2f, 0.4f, expected);
        for (int i = 0; i < rows * cols; ++i)
            expected.data[i] = std::clamp(expected.data[i], 0.0f, 1.0f);
        EXPECT_TRUE(arrayWithin(actual, expected, 0.01, 2e-5)) << "method " << static_cast<int>(method);

        in[200] = std::numeric_limits<float>::quiet_NaN();
        in[300] = std::numeric_limits<float>::infinity();
        in[400] = -std::numeric_limits<float>::infinity();
        EXPECT_EQ(estimated(method, trace, in, cols, rows), out) << "method " << static_cast<int>(method);
    }
}

} // namespace
