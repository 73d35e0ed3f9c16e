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

enum class form
{
    fast,
    literal
};

/// The result of a method on a tile's periodic grid, without the limits of pixel storage.
floatArray deconvolved(deconvolutionMethod method, form how, const floatArray &padded, const floatArray &kernel,
                       float smoothing, float suppression, const floatArray &out, workers who = workers::all)
{
    const bool fast = how == form::fast;
    switch (method)
    {
    case deconvolutionMethod::wiener:
        if (fast)
            wienerDeconvolve(padded, kernel, smoothing, out, who);
        else
            Reference::literalWiener(padded, kernel, smoothing, out);
        break;
    case deconvolutionMethod::classic:
        if (fast)
            classicDeconvolver(padded, tables(), who).run(out, kernel, smoothing, suppression);
        else
            Reference::literalHyperLaplacianOld(padded, kernel, smoothing, suppression, tables(), out);
        break;
    case deconvolutionMethod::fast:
        if (fast)
            hyperLaplacianDeconvolver(padded, tables(), who).run(out, kernel, smoothing, suppression);
        else
            Reference::literalHyperLaplacian(padded, kernel, smoothing, suppression, tables(), out);
        break;
    }
    return out;
}

struct referenceCase
{
    const char *name;
    deconvolutionMethod method;
    float smoothing, suppression;
};

class Method : public testing::TestWithParam<referenceCase>
{
};

TEST_P(Method, MatchesReferenceValues)
{
    const referenceCase &c = GetParam();
    const floatArray tile = readFloats(c.name, "tile"), kernel = readFloats(c.name, "kernel");
    const floatArray expected = readFloats(c.name, "out"), padded = extendedFor(tile, kernel);
    for (const form how : {form::fast, form::literal})
    {
        SCOPED_TRACE(how == form::fast ? "fast" : "literal");
        const floatArray out = floatArray::allocate(tile.rows, tile.cols);
        deconvolved(c.method, how, padded, kernel, c.smoothing, c.suppression, out);
        if (c.method == deconvolutionMethod::wiener)
            EXPECT_TRUE(arrayWithin(out, expected, 3e-5, 3e-6));
        else
            EXPECT_TRUE(arrayWithin(out, expected, 0.02, 3e-5, 2e-4));
    }
}

INSTANTIATE_TEST_SUITE_P(Cases, Method,
                         testing::Values(referenceCase{"wiener_0", deconvolutionMethod::wiener, 0.0f, 0.0f},
                                         referenceCase{"wiener_0.3", deconvolutionMethod::wiener, 0.3f, 0.0f},
                                         referenceCase{"wiener_1", deconvolutionMethod::wiener, 1.0f, 0.0f},
                                         referenceCase{"fast_0_0", deconvolutionMethod::fast, 0.0f, 0.0f},
                                         referenceCase{"fast_0.3_0.3", deconvolutionMethod::fast, 0.3f, 0.3f},
                                         referenceCase{"fast_0.3_0.9", deconvolutionMethod::fast, 0.3f, 0.9f},
                                         referenceCase{"fast_0.3_1", deconvolutionMethod::fast, 0.3f, 1.0f},
                                         referenceCase{"fast_1_0.5", deconvolutionMethod::fast, 1.0f, 0.5f},
                                         referenceCase{"classic_0_0", deconvolutionMethod::classic, 0.0f, 0.0f},
                                         referenceCase{"classic_0.3_0.3", deconvolutionMethod::classic, 0.3f, 0.3f},
                                         referenceCase{"classic_0.3_0.9", deconvolutionMethod::classic, 0.3f, 0.9f},
                                         referenceCase{"classic_0.3_1", deconvolutionMethod::classic, 0.3f, 1.0f},
                                         referenceCase{"classic_1_0.5", deconvolutionMethod::classic, 1.0f, 0.5f}),
                         [](const auto &instance) {
                             std::string name = instance.param.name;
                             for (char &c : name)
                                 c = c == '.' ? '_' : c;
                             return name;
                         });

constexpr deconvolutionMethod allMethods[] = {deconvolutionMethod::wiener, deconvolutionMethod::classic,
                                              deconvolutionMethod::fast};

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
            deconvolved(method, form::fast, stridedCopy(padded), stridedCopy(kernel), c.smoothing, c.suppression, out);
            deconvolved(method, form::literal, padded, kernel, c.smoothing, c.suppression, expected);
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
        deconvolved(method, form::fast, padded, kernel, 0.1f, 0.1f, one, workers::one);
        EXPECT_LT(differenceOf(one, scene, 0.0).rms, 0.75 * before);
        for (const int threads : {1, 2, 8})
        {
            const floatArray out = floatArray::allocate(90, 110);
            tbb::task_arena arena(threads);
            arena.execute([&] { deconvolved(method, form::fast, padded, kernel, 0.1f, 0.1f, out); });
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
                deconvolved(method, form::fast, extendedFor(tile, kernel), kernel, setting, setting, out);
                EXPECT_TRUE(arrayNear(out, tile, 3e-6)) << static_cast<int>(method) << " at " << setting;
            }
}

TEST(Methods, OneSampleKernelReturnsTheInput)
{
    const floatArray kernel = floatArray::allocate(1, 1), tile = noiseImage(30, 41, 98);
    fill(kernel, 1.0f);
    const floatArray padded = extendedFor(tile, kernel), out = floatArray::allocate(30, 41);
    deconvolved(deconvolutionMethod::wiener, form::fast, padded, kernel, 0.0f, 0.0f, out);
    EXPECT_TRUE(arrayNear(out, tile, 2e-6));
    // The strongest data weight leaves little room for the prior.
    deconvolved(deconvolutionMethod::fast, form::fast, padded, kernel, 0.0f, 0.0f, out);
    EXPECT_TRUE(arrayNear(out, tile, 0.03));
}

TEST(Methods, SuppressionPullsTowardsTheInput)
{
    const floatArray kernel = shakeKernel(9, 9, 99), tile = blurred(edgeScene(60, 60, 100), kernel, 0.002f, 101);
    const floatArray padded = extendedFor(tile, kernel);
    double last = 1.0;
    for (const float suppression : {0.0f, 0.3f, 0.6f, 0.8f, 0.9f, 1.0f})
    {
        const floatArray out = floatArray::allocate(60, 60);
        deconvolved(deconvolutionMethod::fast, form::fast, padded, kernel, 0.3f, suppression, out);
        const double distance = differenceOf(out, tile, 0.0).rms;
        EXPECT_LT(distance, last) << suppression;
        last = distance;
    }
}

// 8-bit storage truncates, so a level may be lost on the way through a method, but never two.
TEST(LatentEstimator, FlatPicturesLoseAtMostOneLevel)
{
    const floatArray kernel = shakeKernel(7, 7, 102);
    const int rows = 24, cols = 30;
    for (const deconvolutionMethod method : allMethods)
        for (const int level : {0, 1, 127, 178, 255})
        {
            const auto estimator = createLatentEstimator(method, tables());
            latentKernel trace;
            trace.kernel = kernel;
            estimator->setKernels({trace}, 1.0f);
            std::vector<std::byte> in(rows * cols * 3, std::byte(level)), out(in.size(), std::byte(99));
            estimator->deconvolve(in.data(), out.data(), 0, 0, cols, rows, 3, cols, cols, 8);
            for (const std::byte b : out)
            {
                ASSERT_LE(std::to_integer<int>(b), level);
                ASSERT_GE(std::to_integer<int>(b), level - 1);
            }
        }
}

// The classes behind the methods' numbers are those of the functions above, plane by plane, in every depth.
TEST(LatentEstimator, PlanesEqualTheMethodOnEach)
{
    const int rows = 41, cols = 36, planes = 3;
    const floatArray kernel = shakeKernel(7, 5, 103);
    for (const deconvolutionMethod method : allMethods)
    {
        latentKernel trace;
        trace.kernel = cloned(kernel);
        scaleInto(trace.kernel, trace.kernel, 3.0f); // setKernels scales it back
        trace.smoothing = 0.2f;
        trace.suppression = 0.4f;
        const auto estimator = createLatentEstimator(method, tables());
        estimator->setKernels({trace}, 1.0f);

        std::vector<float> in, out(static_cast<std::size_t>(rows * (cols + 3) * planes), -1.0f);
        std::vector<floatArray> tiles;
        for (unsigned p = 0; p < planes; ++p)
        {
            tiles.push_back(noiseImage(rows, cols, 104 + p, 0.3f, 0.6f));
            in.insert(in.end(), tiles.back().data, tiles.back().data + rows * cols);
        }
        estimator->deconvolve(reinterpret_cast<const std::byte *>(in.data()), reinterpret_cast<std::byte *>(out.data()),
                              5, 6, cols, rows, planes, cols * 4, (cols + 3) * 4, 32);
        for (int p = 0; p < planes; ++p)
        {
            floatArray actual = floatArray::allocate(rows, cols), expected = floatArray::allocate(rows, cols);
            deconvolved(method, form::fast, extendedFor(tiles[p], kernel), kernel, 0.2f, 0.4f, expected);
            for (int y = 0; y < rows; ++y)
                for (int x = 0; x < cols; ++x)
                {
                    actual.at(y, x) = out[static_cast<std::size_t>((p * rows + y) * (cols + 3) + x)];
                    expected.at(y, x) = std::min(std::max(expected.at(y, x), 0.0f), 1.0f);
                }
            EXPECT_TRUE(arrayWithin(actual, expected, 0.01, 2e-5)) << "method " << static_cast<int>(method);
            EXPECT_EQ(out[static_cast<std::size_t>(p * rows * (cols + 3) + cols)], -1.0f) << "past a row's end";
        }
    }
}

// A kernel without weight says nothing about the blur; a sample that is no number costs a few pixels, not the tile.
TEST(LatentEstimator, UnusableKernelsAndSamples)
{
    const int rows = 30, cols = 34;
    latentKernel trace;
    for (const deconvolutionMethod method : allMethods)
    {
        const auto run = [&](const std::vector<float> &in) {
            const auto estimator = createLatentEstimator(method, tables());
            estimator->setKernels({trace}, 1.0f);
            std::vector<float> out(in.size(), -1.0f);
            estimator->deconvolve(reinterpret_cast<const std::byte *>(in.data()),
                                  reinterpret_cast<std::byte *>(out.data()), 0, 0, cols, rows, 1, cols * 4, cols * 4,
                                  32);
            return out;
        };
        const floatArray tile = noiseImage(rows, cols, 110);
        std::vector<float> in(tile.data, tile.data + rows * cols);
        trace.kernel = floatArray::allocate(5, 5);
        fill(trace.kernel, 0.0f);
        EXPECT_EQ(run(in), in);

        trace.kernel = shakeKernel(5, 5, 111);
        in[200] = in[300] = in[400] = 0.0f;
        const std::vector<float> expected = run(in);
        in[200] = std::numeric_limits<float>::quiet_NaN();
        in[300] = std::numeric_limits<float>::infinity();
        in[400] = -std::numeric_limits<float>::infinity();
        EXPECT_EQ(run(in), expected);
    }
}

} // namespace
