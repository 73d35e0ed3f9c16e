#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/edgeFilters.h"
#include "deblur/estimate/fastDeconvolver.h"
#include "deblur/estimate/filters.h"
#include "deblur/estimate/gradientPredictor.h"
#include "deblur/estimate/kernelSolver.h"
#include "tests/reference/literalPredictor.h"
#include "tests/support/matchers.h"
#include "tests/support/npy.h"
#include "tests/support/synthetic.h"

#include <cmath>
#include <string>
#include <tuple>

using namespace CorvaneDeblur;
using namespace TestSupport;

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
    }
}

TEST(Shock, MatchesReferenceValues)
{
    const floatArray in = readFloats("shock", "in"), expected = readFloats("shock", "out"), out = like(in);
    shockFilter(in, out, 1.0f);
    EXPECT_TRUE(arrayNear(out, expected, 1e-5, 0.002));
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

TEST(Predictor, MatchesReferenceValues)
{
    const floatArray latent = readFloats("predict", "latent");
    const floatArray gradX = like(latent), gradY = like(latent);
    gradientPredictor predictor(latent.rows, latent.cols, 9, 9, flat(latent.rows, latent.cols, 1.0f));
    for (const auto &[x, y, threshold] :
         {std::tuple("gradX1", "gradY1", 0.23243260f), std::tuple("gradX2", "gradY2", 0.20918934f)})
    {
        predictor.predict(latent, gradX, gradY);
        EXPECT_TRUE(arrayNear(gradX, readFloats("predict", x), 1e-5, 0.002)) << x;
        EXPECT_TRUE(arrayNear(gradY, readFloats("predict", y), 1e-5, 0.002)) << y;
        EXPECT_NEAR(predictor.threshold, 0.9f * threshold, 1e-5);
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

TEST_P(Solvers, MatchReferenceValues)
{
    const floatArray kernel = given("kernel"), latent = like(given("latent")), out = like(kernel);
    const floatArray gradX = given("gradX"), gradY = given("gradY");
    const blurredGrid grid(given("padded"), workers::all);
    fastDeconvolver deconvolver(grid, fastOrder());
    deconvolver.setLowPass(gaussianLowPass(grid.grid, 0.8f));
    deconvolver.solve(kernel, latent, 0.01f);
    EXPECT_TRUE(arrayNear(latent, given("latent"), 2e-4));

    kernelSolver solver(grid, kernel.rows, kernel.cols, fastOrder());
    solver.setLowPass(gaussianLowPass(grid.grid, 0.8f));
    solver.kernelWeights = flat(kernel.rows, kernel.cols, 0.7f);
    solver.prepare(gradX, gradY);
    solver.rightHandSide(out);
    EXPECT_TRUE(arrayNear(out, given("rhs"), 2e-4));
    solver.applyOperator(out, kernel, 0.001f, 0.02f);
    EXPECT_TRUE(arrayNear(out, given("applied"), 2e-4));
    fill(out, 0.0f);
    out.at(4, 4) = 1.0f;
    solver.solve(gradX, gradY, out, 0.001f, 0.02f);
    EXPECT_TRUE(arrayNear(out, given("solved"), 2e-4));

    const floatArray cleaned = given("solved");
    kernelSolver::cleanKernel(cleaned);
    EXPECT_TRUE(arrayNear(cleaned, given("cleaned"), 2e-4));
    kernelSolver::recentre(cleaned);
    EXPECT_TRUE(arrayNear(cleaned, given("recentred"), 2e-4));
}

INSTANTIATE_TEST_SUITE_P(Orders, Solvers, testing::Values(0, 1),
                         [](const auto &instance) { return "Order" + std::to_string(instance.param); });

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

} // namespace
