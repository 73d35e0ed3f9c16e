#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/edgeFilters.h"
#include "deblur/estimate/fastDeconvolver.h"
#include "deblur/estimate/filters.h"
#include "deblur/estimate/gradientPredictor.h"
#include "deblur/estimate/kernelSolver.h"
#include "deblur/estimate/resample.h"
#include "tests/reference/literalFastDeconvolver.h"
#include "tests/reference/literalKernelSolver.h"
#include "tests/reference/literalPredictor.h"
#include "tests/reference/spectra.h"
#include "tests/support/matchers.h"
#include "tests/support/npy.h"
#include "tests/support/synthetic.h"

#include <cmath>
#include <string>
#include <tuple>

using namespace CorvaneDeblur;
using namespace TestSupport;

// The literal forms are held against the reference values too: a fast form equal to a wrong reference is wrong.
namespace
{

floatArray flat(int rows, int cols, float value)
{
    const floatArray a = floatArray::allocate(rows, cols);
    fill(a, value);
    return a;
}

floatArray like(const floatArray &a)
{
    return floatArray::allocate(a.rows, a.cols);
}

TEST(Bilateral, MatchesReferenceValues)
{
    const floatArray in = readFloats("bilateral", "in"), out = like(in);
    for (const auto &[name, rangeSigma] : {std::pair("wide", 0.5f), std::pair("narrow", 0.1f)})
    {
        const floatArray expected = readFloats("bilateral", name);
        bilateralFilter(in, out, 2.0f, rangeSigma, 2);
        EXPECT_TRUE(arrayNear(out, expected, 3e-6)) << name;
        Reference::literalBilateral(in, out, 2.0f, rangeSigma, 2);
        EXPECT_TRUE(arrayNear(out, expected, 3e-6)) << name << ", literal";
    }
}

TEST(Shock, MatchesReferenceValues)
{
    const floatArray in = readFloats("shock", "in"), expected = readFloats("shock", "out"), out = like(in);
    shockFilter(in, out, 1.0f);
    EXPECT_TRUE(arrayNear(out, expected, 1e-5, 0.002));
    copyTo(in, out);
    Reference::literalShock(out, 1.0f);
    EXPECT_TRUE(arrayNear(out, expected, 1e-5, 0.002)) << "literal";
}

// Images smaller than the window, one row, one column, and sizes off every vector width.
TEST(EdgeFilters, EqualLiteralOnesOnAnyShape)
{
    for (const auto &[rows, cols] : {std::pair(1, 1), std::pair(1, 9), std::pair(7, 1), std::pair(2, 3),
                                     std::pair(3, 17), std::pair(33, 29), std::pair(64, 61)})
        for (const workers who : {workers::one, workers::all})
        {
            SCOPED_TRACE(std::to_string(rows) + " x " + std::to_string(cols));
            const floatArray image = noiseImage(rows, cols, 11), out = stridedCopy(image), expected = like(image);
            bilateralFilter(stridedCopy(image), out, 2.0f, 0.25f, 2, who);
            Reference::literalBilateral(image, expected, 2.0f, 0.25f, 2);
            EXPECT_TRUE(arrayNear(out, expected, 3e-6));
            EXPECT_TRUE(marginUntouched(out));
            shockFilter(stridedCopy(image), out, 0.7f, who);
            copyTo(image, expected);
            Reference::literalShock(expected, 0.7f);
            EXPECT_TRUE(arrayNear(out, expected, 2e-6));
            EXPECT_TRUE(marginUntouched(out));
        }
}

// Directions on the borders between the bands (axes and diagonals) are as frequent as on any picture with straight
// edges; each seed makes another band the scarce one.
TEST(OrientationThreshold, EqualsLiteralOneOnBandBorders)
{
    int positive = 0;
    for (unsigned seed = 0; seed < 40; ++seed)
    {
        const int rows = 24, cols = 31;
        const floatArray pick = noiseImage(rows, cols, seed), size = noiseImage(rows, cols, 100 + seed, 0.05f, 1.0f);
        const floatArray gradX = like(pick), gradY = like(pick), magnitude = like(pick);
        for (int y = 0; y < rows; ++y)
            for (int x = 0; x < cols; ++x)
            {
                static constexpr float directions[][2] = {{1, 0},  {1, 1},   {0, 1},  {-1, 1}, {-1, 0}, {-1, -1},
                                                          {0, -1}, {1, -1},  {2, 1},  {1, 2},  {-1, 2}, {-2, 1},
                                                          {0, 0},  {-2, -1}, {1, -2}, {2, -1}};
                const float power = seed % 3 == 0 ? 1.0f : 0.3f + static_cast<float>(seed % 5);
                const float *d = directions[static_cast<int>(std::pow(pick.at(y, x), power) * 15.999f)];
                gradX.at(y, x) = d[0] * size.at(y, x);
                gradY.at(y, x) = d[1] * size.at(y, x);
                magnitude.at(y, x) = std::hypot(gradX.at(y, x), gradY.at(y, x));
            }
        const float expected = Reference::literalOrientationThreshold(gradX, gradY, magnitude, 4, 18, std::sqrt(2.0f));
        positive += expected > 0.0f;
        EXPECT_NEAR(orientationThreshold(gradX, gradY, magnitude, 18, std::sqrt(2.0f)), expected, 1e-6) << seed;
    }
    EXPECT_GT(positive, 20);
}

TEST(OrientationThreshold, NothingToFind)
{
    const floatArray zero = flat(10, 10, 0.0f), tiny = flat(10, 10, 0.00009f), strong = flat(10, 10, 0.5f);
    EXPECT_EQ(orientationThreshold(zero, zero, zero, 10, 1.4f), 0.0f);
    EXPECT_EQ(orientationThreshold(tiny, zero, tiny, 10, 1.4f), 0.0f);
    EXPECT_EQ(orientationThreshold(strong, zero, strong, 10, 1.4f), 0.0f) << "three bands are empty";
}

TEST(Predictor, MatchesReferenceValues)
{
    const floatArray latent = readFloats("predict", "latent");
    const floatArray gradX = like(latent), gradY = like(latent);
    const floatArray weights = flat(latent.rows, latent.cols, 1.0f);
    gradientPredictor fast(latent.rows, latent.cols, 9, 9, weights);
    Reference::literalPredictor literal(weights, 9, 9);
    const struct
    {
        const char *x, *y;
        float threshold;
    } calls[] = {{"gradX1", "gradY1", 0.23243260f}, {"gradX2", "gradY2", 0.20918934f}};
    for (const auto &call : calls)
    {
        SCOPED_TRACE(call.x);
        const floatArray expectedX = readFloats("predict", call.x), expectedY = readFloats("predict", call.y);
        fast.predict(latent, gradX, gradY);
        EXPECT_TRUE(arrayNear(gradX, expectedX, 1e-5, 0.002));
        EXPECT_TRUE(arrayNear(gradY, expectedY, 1e-5, 0.002));
        EXPECT_NEAR(fast.threshold, 0.9f * call.threshold, 1e-5);
        literal.predict(latent, gradX, gradY);
        EXPECT_TRUE(arrayNear(gradX, expectedX, 1e-5, 0.002));
        EXPECT_TRUE(arrayNear(gradY, expectedY, 1e-5, 0.002));
        EXPECT_NEAR(literal.selectionThreshold, call.threshold, 1e-5);
    }
}

TEST(Predictor, EqualsLiteralOneCallAfterCallAndOnlyGrows)
{
    for (const auto &[rows, cols] : {std::pair(40, 61), std::pair(75, 52)})
    {
        const floatArray latent = blurred(edgeScene(rows, cols, 12), shakeKernel(3, 3, 1), 0.005f, 13);
        const floatArray weights = flat(rows, cols, 1.0f);
        fill(weights.subRect(0, 0, rows, cols / 4), 0.0f);
        fill(weights.subRect(0, cols / 4, rows, 5), 0.4f);
        gradientPredictor fast(rows, cols, 5, 7, weights);
        Reference::literalPredictor literal(weights, 5, 7);
        const floatArray gradX = like(latent), gradY = like(latent), literalX = like(latent), literalY = like(latent);
        floatArray before;
        for (int call = 0; call < 5; ++call)
        {
            SCOPED_TRACE(call);
            fast.predict(latent, gradX, gradY);
            literal.predict(latent, literalX, literalY);
            EXPECT_TRUE(arrayNear(gradX, literalX, 1e-5, 0.002));
            EXPECT_TRUE(arrayNear(gradY, literalY, 1e-5, 0.002));
            EXPECT_NEAR(fast.threshold, literal.threshold, 1e-5);
            EXPECT_GT(sumAbs(gradX) + sumAbs(gradY), 0.0f);
            if (call == 0)
                EXPECT_EQ(sumAbs(gradX.subRect(0, 0, rows, cols / 4)), 0.0f) << "near saturation";
            else
                for (int y = 0; y < rows; ++y)
                    for (int x = 0; x < cols; ++x)
                        EXPECT_LE(fast.rejected.at(y, x), before.at(y, x));
            before = cloned(fast.rejected);
        }
    }
}

TEST(Predictor, FlatImageHasNoEdgesAndReachesTheFloor)
{
    const floatArray latent = flat(20, 30, 0.6f), gradX = flat(20, 30, 9.0f), gradY = flat(20, 30, 9.0f);
    gradientPredictor predictor(20, 30, 5, 5, flat(20, 30, 1.0f));
    for (int call = 0; call < 3; ++call)
    {
        predictor.predict(latent, gradX, gradY);
        EXPECT_NEAR(sumAbs(gradX) + sumAbs(gradY), 0.0f, 1e-4);
        EXPECT_EQ(predictor.threshold, 0.1f);
    }
}

class Solvers : public testing::TestWithParam<int>
{
protected:
    const int order = GetParam();
    const std::string name = "solvers_order" + std::to_string(order);
    floatArray given(const char *array) const { return readFloats(name.c_str(), array); }
    derivativeOrder fastOrder() const { return static_cast<derivativeOrder>(order); }
};

TEST_P(Solvers, LatentMatchesReferenceValues)
{
    const floatArray padded = given("padded"), kernel = given("kernel"), expected = given("latent");
    const floatArray latent = like(expected);
    const blurredGrid grid(padded, workers::all);
    fastDeconvolver fast(grid, fastOrder());
    fast.setLowPass(gaussianLowPass(grid.grid, 0.8f));
    fast.solve(kernel, latent, 0.01f);
    EXPECT_TRUE(arrayNear(latent, expected, 2e-4));

    Reference::literalFastDeconvolver literal(padded, order);
    literal.lowPass = Reference::gaussianSpectrum(0.8f, padded.rows, padded.cols);
    literal.solve(kernel, latent, 0.01f);
    EXPECT_TRUE(arrayNear(latent, expected, 2e-4)) << "literal";
}

TEST_P(Solvers, KernelMatchesReferenceValues)
{
    const floatArray padded = given("padded"), kernel = given("kernel");
    const floatArray gradX = given("gradX"), gradY = given("gradY");
    const blurredGrid grid(padded, workers::all);
    kernelSolver fast(grid, kernel.rows, kernel.cols, fastOrder());
    fast.setLowPass(gaussianLowPass(grid.grid, 0.8f));
    fast.kernelWeights = flat(kernel.rows, kernel.cols, 0.7f);
    Reference::literalKernelSolver literal(padded, order);
    literal.lowPass = Reference::gaussianSpectrum(0.8f, padded.rows, padded.cols);
    literal.kernelWeights = fast.kernelWeights;

    const auto check = [&](auto &solver) {
        const floatArray out = like(kernel);
        solver.prepare(gradX, gradY);
        solver.rightHandSide(out);
        EXPECT_TRUE(arrayNear(out, given("rhs"), 2e-4));
        solver.applyOperator(out, kernel, 0.001f, 0.02f);
        EXPECT_TRUE(arrayNear(out, given("applied"), 2e-4));
        fill(out, 0.0f);
        out.at(4, 4) = 1.0f;
        solver.solve(gradX, gradY, out, 0.001f, 0.02f);
        EXPECT_TRUE(arrayNear(out, given("solved"), 2e-4));
    };
    {
        SCOPED_TRACE("fast");
        check(fast);
    }
    {
        SCOPED_TRACE("literal");
        check(literal);
    }

    const floatArray cleaned = given("solved"), literalCleaned = given("solved");
    kernelSolver::cleanKernel(cleaned);
    EXPECT_TRUE(arrayNear(cleaned, given("cleaned"), 2e-4));
    kernelSolver::recentre(cleaned);
    EXPECT_TRUE(arrayNear(cleaned, given("recentred"), 2e-4));
    Reference::literalCleanKernel(literalCleaned);
    Reference::literalRecentre(literalCleaned);
    EXPECT_TRUE(arrayNear(literalCleaned, given("recentred"), 2e-4)) << "literal";
}

// Grids odd and even on either axis, kernels wide, tall and even, with and without low-pass and weights.
TEST_P(Solvers, EqualLiteralOnes)
{
    const struct
    {
        int rows, cols, kernelRows, kernelCols, gridRows, gridCols;
        bool lowPass;
    } cases[] = {{40, 61, 5, 9, 44, 72, true},   {64, 49, 7, 7, 72, 55, true}, {33, 90, 3, 11, 35, 100, false},
                 {50, 50, 15, 15, 65, 66, true}, {45, 38, 6, 4, 50, 41, true}, {20, 24, 19, 13, 39, 36, false}};
    for (const auto &c : cases)
    {
        SCOPED_TRACE(std::to_string(c.gridRows) + " x " + std::to_string(c.gridCols));
        const floatArray scene = edgeScene(c.rows, c.cols, 21), kernel = shakeKernel(c.kernelRows, c.kernelCols, 22);
        const floatArray padded = floatArray::allocate(c.gridRows, c.gridCols);
        taperedExtension(blurred(scene, kernel, 0.003f, 23), padded, c.kernelCols, c.kernelRows);
        const blurredGrid grid(padded, workers::all);

        fastDeconvolver deconvolver(grid, fastOrder());
        Reference::literalFastDeconvolver literalDeconvolver(padded, order);
        if (c.lowPass)
        {
            deconvolver.setLowPass(gaussianLowPass(grid.grid, 0.5f));
            literalDeconvolver.lowPass = Reference::gaussianSpectrum(0.5f, c.gridRows, c.gridCols);
        }
        for (const floatArray &k : {kernel, noiseImage(c.kernelRows, c.kernelCols, 24, 0.0f, 0.05f)})
        {
            const floatArray latent = stridedCopy(scene), expected = like(scene);
            deconvolver.solve(k, latent, 0.96f);
            literalDeconvolver.solve(k, expected, 0.96f);
            EXPECT_TRUE(arrayNear(latent, expected, 2e-5));
            EXPECT_TRUE(marginUntouched(latent));
        }

        const floatArray gradX = like(scene), gradY = like(scene);
        forwardDiffX(scene, gradX);
        forwardDiffY(scene, gradY);
        kernelSolver solver(grid, c.kernelRows, c.kernelCols, fastOrder());
        Reference::literalKernelSolver literalSolver(padded, order);
        if (c.lowPass)
        {
            solver.setLowPass(gaussianLowPass(grid.grid, 0.5f));
            literalSolver.lowPass = Reference::gaussianSpectrum(0.5f, c.gridRows, c.gridCols);
            solver.kernelWeights = literalSolver.kernelWeights = noiseImage(c.kernelRows, c.kernelCols, 25);
        }
        solver.prepare(gradX, gradY);
        literalSolver.prepare(gradX, gradY);
        const floatArray out = like(kernel), expected = like(kernel);
        solver.rightHandSide(out);
        literalSolver.rightHandSide(expected);
        EXPECT_TRUE(arrayNear(out, expected, 1e-5 * std::abs(peakAbs(expected))));
        const floatArray signedKernel = noiseImage(c.kernelRows, c.kernelCols, 26, -1.0f, 1.0f);
        solver.applyOperator(out, signedKernel, 0.3f, 2.0f);
        literalSolver.applyOperator(expected, signedKernel, 0.3f, 2.0f);
        EXPECT_TRUE(arrayNear(out, expected, 1e-5 * std::abs(peakAbs(expected))));

        fill(out, 1.0f / static_cast<float>(c.kernelRows * c.kernelCols));
        copyTo(out, expected);
        solver.solve(gradX, gradY, out, 0.01f, 0.3f);
        literalSolver.solve(gradX, gradY, expected, 0.01f, 0.3f);
        EXPECT_TRUE(arrayNear(out, expected, 1e-3 * peak(expected)));
        EXPECT_GT(kernelCorrelation(expected, kernel), 0.8) << "the true gradients give the true kernel";
    }
}

INSTANTIATE_TEST_SUITE_P(Orders, Solvers, testing::Values(0, 1),
                         [](const auto &instance) { return "Order" + std::to_string(instance.param); });

TEST(KernelSolver, NoGradientsLeaveASystemThatTheSamplePenaltySolves)
{
    const floatArray padded = flat(30, 36, 0.5f), none = flat(24, 30, 0.0f), kernel = flat(5, 5, 0.04f);
    const blurredGrid grid(padded, workers::one);
    kernelSolver solver(grid, 5, 5, derivativeOrder::first);
    solver.solve(none, none, kernel, 0.5f, 0.1f);
    EXPECT_NEAR(peakAbs(kernel), 0.0f, 1e-5);
    kernelSolver::cleanKernel(kernel);
    EXPECT_FLOAT_EQ(sumAbs(kernel), 1.0f);
}

TEST(CleanKernel, OneSampleCollapsedAndNegativeKernels)
{
    const floatArray one = flat(5, 7, -0.3f);
    one.at(1, 6) = 0.2f;
    kernelSolver::cleanKernel(one);
    EXPECT_EQ(one.at(1, 6), 1.0f);
    EXPECT_EQ(sumAbs(one), 1.0f);

    for (const float value : {0.0f, -1.0f, 1e-7f})
    {
        const floatArray collapsed = flat(5, 5, value), gaussian = floatArray::allocate(5, 5);
        kernelSolver::cleanKernel(collapsed);
        gaussianFill(gaussian, 0.5f);
        EXPECT_TRUE(arrayIdentical(collapsed, gaussian)) << value;
    }
}

TEST(Recentre, MovesTheMassAndEqualsLiteralOne)
{
    const floatArray corner = flat(7, 9, 0.0f);
    corner.at(0, 8) = 1.0f;
    kernelSolver::recentre(corner);
    EXPECT_EQ(corner.at(3, 4), 1.0f);
    EXPECT_EQ(sumAbs(corner), 1.0f);

    // Even shapes move by half a sample as well; what leaves the array is lost.
    for (const auto &[rows, cols] : {std::pair(7, 9), std::pair(6, 6), std::pair(1, 5), std::pair(12, 3)})
        for (unsigned seed = 0; seed < 6; ++seed)
        {
            const floatArray kernel = noiseImage(rows, cols, seed);
            kernel.at(0, 0) += 5.0f;
            normaliseSum(kernel);
            const floatArray moved = stridedCopy(kernel);
            kernelSolver::recentre(moved);
            Reference::literalRecentre(kernel);
            EXPECT_TRUE(arrayNear(moved, kernel, 1e-7)) << rows << " x " << cols << ", seed " << seed;
            EXPECT_TRUE(marginUntouched(moved));
        }
}

} // namespace
