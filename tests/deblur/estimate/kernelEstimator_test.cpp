#include "deblur/estimate/kernelEstimator.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/kernelPyramid.h"
#include "deblur/estimate/saturationMask.h"
#include "tests/reference/literalEstimator.h"
#include "tests/support/matchers.h"
#include "tests/support/npy.h"
#include "tests/support/synthetic.h"

#include <tbb/global_control.h>
#include <tbb/task_arena.h>

#include <atomic>
#include <string>
#include <thread>
#include <tuple>
#include <vector>

using namespace CorvaneDeblur;
using namespace TestSupport;

namespace
{

constexpr float untouched = -7.0f;

floatArray filled(int rows, int cols, float value)
{
    const floatArray a = floatArray::allocate(rows, cols);
    fill(a, value);
    return a;
}

bool isUntouched(const floatArray &kernel)
{
    return bool(arrayIdentical(kernel, filled(kernel.rows, kernel.cols, untouched)));
}

TEST(Pyramid, MatchesReferenceSizes)
{
    const struct
    {
        const char *name;
        int cols, rows;
    } cases[] = {{"pyramid_3", 3, 3},    {"pyramid_5", 5, 5},       {"pyramid_17", 17, 17},
                 {"pyramid_31", 31, 31}, {"pyramid_45", 45, 45},    {"pyramid_51", 51, 51},
                 {"pyramid_99", 99, 99}, {"pyramid_199", 199, 199}, {"pyramid_31x45", 31, 45}};
    for (const auto &c : cases)
    {
        std::vector<std::int64_t> sizes;
        for (const levelSize &size : buildPyramid(c.cols, c.rows, pyramidScale, pyramidMinimum))
            sizes.insert(sizes.end(), {size.cols, size.rows});
        EXPECT_EQ(sizes, readInts(c.name, "sizes")) << c.name;
    }
}

TEST(SaturationMask, MatchesReferenceValues)
{
    const byteArray mask = readBytes("saturation", "mask");
    const floatArray image = readFloats("saturation", "image");
    const floatArray weights = floatArray::allocate(image.rows, image.cols);
    const floatArray guide = floatArray::allocate(image.rows, image.cols);
    applySaturationMask(mask, image, 15, 21, weights, guide);
    EXPECT_TRUE(arrayNear(weights, readFloats("saturation", "weights"), 2e-5, 0.001));
    EXPECT_TRUE(arrayNear(guide, readFloats("saturation", "guide"), 2e-5, 0.001));
}

struct wholeCase
{
    const char *name;
    noiseMode noise = noiseMode::medium;
    float noiseLevel = 0.0f;
    int levels = 0; ///< 0 .. levels - 1
    int derivativesOrder = 0, randomKernelLevel = 0, pyramidLevel = 0;
};

constexpr float mediumSigma = 3.0f / 255.0f;
const wholeCase wholeCases[] = {
    {.name = "estimate_0", .noise = noiseMode::low, .noiseLevel = 1.0f / 255.0f, .levels = 5},
    {.name = "estimate_1", .noiseLevel = mediumSigma, .levels = 6},
    {.name = "estimate_2", .noise = noiseMode::automatic, .noiseLevel = 0.01f, .levels = 6},
    {.name = "estimate_3", .noiseLevel = mediumSigma, .levels = 6, .derivativesOrder = 1},
    {.name = "estimate_4", .noiseLevel = mediumSigma, .levels = 6, .randomKernelLevel = 3},
    {.name = "estimate_5", .noiseLevel = mediumSigma, .levels = 5, .pyramidLevel = 2}};

class WholeEstimation : public testing::TestWithParam<wholeCase>
{
};

TEST_P(WholeEstimation, MatchesReferenceValues)
{
    const wholeCase &c = GetParam();
    const floatArray expected = readFloats(c.name, "kernel");
    const floatArray kernel = floatArray::allocate(expected.rows, expected.cols);
    std::vector<floatArray> levelKernels;
    kernelEstimator estimator;
    estimator.noise = c.noise;
    estimator.noiseLevel = c.noiseLevel;
    estimator.derivativesOrder = c.derivativesOrder;
    estimator.randomKernelLevel = c.randomKernelLevel;
    estimator.pyramidLevel = c.pyramidLevel;
    estimator.levelKernels = &levelKernels;
    estimator.estimate(readFloats(c.name, "image"), {}, kernel);
    EXPECT_EQ(estimator.status(), estimateStatus::finished);

    // The levels recorded are the last ones; earlier ones were run by the seed search.
    const int first = c.levels - static_cast<int>(levelKernels.size());
    ASSERT_EQ(first, c.randomKernelLevel);
    for (int level = first; level < c.levels; ++level)
    {
        const floatArray wanted = readFloats(c.name, ("level" + std::to_string(level)).c_str());
        const floatArray &actual = levelKernels[level - first];
        ASSERT_TRUE(actual.sameShape(wanted));
        EXPECT_GT(kernelCorrelation(actual, wanted), level < 3 ? 0.9999 : 0.99) << "level " << level;
    }
    EXPECT_GT(kernelCorrelation(kernel, expected), 0.99);
    EXPECT_GT(sumAbs(kernel), 0.96f);
    EXPECT_LT(sumAbs(kernel), 1.0001f);
}

INSTANTIATE_TEST_SUITE_P(Cases, WholeEstimation, testing::ValuesIn(wholeCases),
                         [](const auto &instance) { return std::string(instance.param.name); });

// Shapes that the reference cases lack: kernels wide and tall, odd image sizes, a mask; every noise mode.
TEST(KernelEstimator, EqualsLiteralOne)
{
    const struct
    {
        int rows, cols, kernelRows, kernelCols;
        noiseMode noise;
        float sigma;
        int order;
        bool mask;
    } cases[] = {{97, 120, 9, 13, noiseMode::medium, 3.0f / 255.0f, 0, false},
                 {110, 91, 15, 11, noiseMode::high, 6.0f / 255.0f, 1, false},
                 {101, 101, 11, 11, noiseMode::low, 1.0f / 255.0f, 1, true},
                 {90, 130, 7, 17, noiseMode::automatic, 2.0f / 255.0f, 0, true}};
    for (const auto &c : cases)
    {
        SCOPED_TRACE(std::to_string(c.kernelRows) + " x " + std::to_string(c.kernelCols));
        const floatArray truth = shakeKernel(c.kernelRows, c.kernelCols, 51);
        const floatArray image = blurred(edgeScene(c.rows, c.cols, 52), truth, 0.004f, 53);
        floatArray guide = image, weights = filled(c.rows, c.cols, 1.0f);
        byteArray mask;
        if (c.mask)
        {
            mask = byteArray::allocate(c.rows, c.cols);
            for (int y = 0; y < c.rows; ++y)
                for (int x = 0; x < c.cols; ++x)
                    mask.at(y, x) = y > 20 && y < 30 && x > 40 && x < 60;
            guide = floatArray::allocate(c.rows, c.cols);
            applySaturationMask(mask, image, c.kernelRows, c.kernelCols, weights, guide);
        }

        kernelEstimator estimator;
        estimator.noise = c.noise;
        estimator.noiseLevel = c.sigma;
        estimator.derivativesOrder = c.order;
        std::vector<floatArray> levels, expectedLevels;
        estimator.levelKernels = &levels;
        const floatArray kernel = floatArray::allocate(c.kernelRows, c.kernelCols), expected = cloned(kernel);
        estimator.estimate(image, mask, kernel);

        Reference::estimatorSettings settings;
        settings.sigma = c.sigma;
        settings.trackFinestLevels = c.noise != noiseMode::low;
        settings.derivativesOrder = c.order;
        Reference::literalEstimate(settings, guide, weights, expected, &expectedLevels);
        ASSERT_EQ(levels.size(), expectedLevels.size());
        // Later levels drift: a threshold or a tie flips a single sample, and the alternation answers it.
        for (const std::size_t level : {0, 1})
            EXPECT_TRUE(arrayNear(levels[level], expectedLevels[level], 1e-4)) << "level " << level;
        EXPECT_GT(kernelCorrelation(kernel, expected), 0.97);
    }
}

TEST(KernelEstimator, ResultDoesNotDependOnTheNumberOfThreads)
{
    const tbb::global_control eightThreads(tbb::global_control::max_allowed_parallelism, 8);
    const floatArray image = blurred(edgeScene(180, 200, 71), shakeKernel(9, 9, 72), 0.003f, 73);
    floatArray first;
    for (const int threads : {1, 2, 8})
    {
        const floatArray kernel = floatArray::allocate(13, 13);
        tbb::task_arena arena(threads);
        arena.execute([&] {
            kernelEstimator estimator;
            estimator.randomKernelLevel = 1;
            estimator.estimate(image, {}, kernel);
        });
        if (first.empty())
            first = kernel;
        EXPECT_TRUE(arrayIdentical(kernel, first)) << threads << " threads";
    }
}

TEST(KernelEstimator, AnyShapeFinishesOrLeavesTheKernel)
{
    const struct
    {
        int rows, cols, kernelRows, kernelCols, randomKernelLevel, pyramidLevel, ratio;
        estimateStatus status;
    } cases[] = {
        {3, 3, 3, 3, 0, 0, 1, estimateStatus::finished},
        {5, 9, 5, 9, 0, 0, 1, estimateStatus::finished},
        {20, 20, 3, 3, 0, 0, 1, estimateStatus::finished},
        {60, 70, 3, 7, 1, 0, 1, estimateStatus::noSeedFits},  // one level of this size: seeds are 3 and 5 columns wide
        {60, 70, 9, 9, 0, 30, 1, estimateStatus::noSeedFits}, // all levels skipped
        // More levels asked for than there are, all run by the search; seeds of another shape than the level's.
        {60, 70, 7, 7, 100, 0, 1, estimateStatus::finished},
        {60, 70, 9, 3, 100, 0, 1, estimateStatus::finished},
        {60, 70, 3, 3, 100, 0, 1, estimateStatus::finished},
        // Three kernels at least on each side.
        {45, 57, 15, 19, 0, 0, 3, estimateStatus::finished},
        {44, 57, 15, 19, 0, 0, 3, estimateStatus::imageTooSmall},
        {45, 56, 15, 19, 0, 0, 3, estimateStatus::imageTooSmall},
    };
    for (const auto &c : cases)
    {
        SCOPED_TRACE(std::to_string(c.kernelRows) + " x " + std::to_string(c.kernelCols));
        kernelEstimator estimator;
        estimator.randomKernelLevel = c.randomKernelLevel;
        estimator.pyramidLevel = c.pyramidLevel;
        estimator.imageToKernelRatio = c.ratio;
        const floatArray kernel = filled(c.kernelRows, c.kernelCols, untouched);
        estimator.estimate(edgeScene(c.rows, c.cols, 83), {}, kernel);
        const bool finished = c.status == estimateStatus::finished;
        EXPECT_EQ(estimator.status(), c.status);
        EXPECT_TRUE(!finished || estimator.progress() == 1.0);
        EXPECT_EQ(isUntouched(kernel), !finished);
        EXPECT_TRUE(!finished || (sumAbs(kernel) > 0.0f && sumAbs(kernel) < 1.001f)) << sumAbs(kernel);
    }
}

TEST(KernelEstimator, CancelledAtOnceLeavesTheKernel)
{
    for (const int seeds : {0, 2})
    {
        kernelEstimator estimator;
        estimator.randomKernelLevel = seeds;
        EXPECT_EQ(estimator.progress(), 0.0);
        estimator.cancel();
        const floatArray kernel = filled(9, 9, untouched);
        estimator.estimate(edgeScene(60, 70, 84), {}, kernel);
        EXPECT_EQ(estimator.status(), estimateStatus::cancelled);
        EXPECT_TRUE(isUntouched(kernel));
        EXPECT_LT(estimator.progress(), 1.0);
    }
}

TEST(KernelEstimator, ProgressOnlyGrowsAndCancellingStopsTheRun)
{
    const floatArray image = blurred(edgeScene(150, 160, 85), shakeKernel(7, 7, 86), 0.003f, 87);
    for (const bool cancelling : {false, true})
    {
        kernelEstimator estimator;
        estimator.randomKernelLevel = 2;
        const floatArray kernel = filled(11, 11, untouched);
        std::atomic<bool> done = false;
        bool falling = false;
        std::thread watcher([&] {
            double last = 0.0;
            while (!done)
            {
                const double p = estimator.progress();
                falling |= p < last;
                last = p;
                if (cancelling && p > 0.1)
                    estimator.cancel();
                std::this_thread::yield();
            }
        });
        estimator.estimate(image, {}, kernel);
        done = true;
        watcher.join();
        EXPECT_FALSE(falling);
        // A watcher that got no time sees nothing to cancel: either way the kernel tells the same as the status.
        EXPECT_TRUE(cancelling || estimator.status() == estimateStatus::finished);
        EXPECT_EQ(isUntouched(kernel), estimator.status() == estimateStatus::cancelled);
        EXPECT_EQ(estimator.progress() == 1.0, estimator.status() == estimateStatus::finished);
    }
}

} // namespace
