#include "platform/math/realTransform2d.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstring>
#include <numbers>
#include <random>
#include <tuple>
#include <vector>

using namespace CorvaneDeblur;

namespace
{

std::vector<float> noise(int count, unsigned seed)
{
    std::mt19937 generator(seed);
    std::uniform_real_distribution<float> uniform(-1.0f, 1.0f);
    std::vector<float> samples(static_cast<std::size_t>(count));
    for (float &s : samples)
        s = uniform(generator);
    return samples;
}

complexSample directFrequency(const std::vector<float> &grid, int rows, int cols, int v, int u)
{
    double re = 0.0, im = 0.0;
    for (int y = 0; y < rows; ++y)
        for (int x = 0; x < cols; ++x)
        {
            const double angle =
                -2.0 * std::numbers::pi * (static_cast<double>(v) * y / rows + static_cast<double>(u) * x / cols);
            const double sample = static_cast<double>(grid[static_cast<std::size_t>(y * cols + x)]);
            re += sample * std::cos(angle);
            im += sample * std::sin(angle);
        }
    return {static_cast<float>(re), static_cast<float>(im)};
}

class RealTransform2d : public testing::TestWithParam<std::tuple<int, int>>
{
};

// Odd and even lengths, one row, one column, pieces that are just full and just begun.
INSTANTIATE_TEST_SUITE_P(Shapes, RealTransform2d,
                         testing::Values(std::tuple{1, 1}, std::tuple{1, 7}, std::tuple{6, 1}, std::tuple{2, 2},
                                         std::tuple{3, 8}, std::tuple{5, 14}, std::tuple{8, 15}, std::tuple{17, 16},
                                         std::tuple{13, 31}, std::tuple{12, 33}));

TEST_P(RealTransform2d, EqualsTheDefinitionAndComesBack)
{
    const auto [rows, cols] = GetParam();
    const std::vector<float> grid = noise(rows * cols, 7u + static_cast<unsigned>(cols));
    const realTransform2d transform(rows, cols, workers::one);
    pieceSpectrum spectrum(transform.spectrumCount());
    transform.forward(grid.data(), cols, spectrum.data());
    for (int v = 0; v < rows; ++v)
        for (int u = 0; u <= cols / 2; ++u)
        {
            const complexSample expected = directFrequency(grid, rows, cols, v, u);
            const complexSample actual = spectrum[static_cast<std::size_t>(u / columnLanes * transform.pieceStride() +
                                                                           v * columnLanes + u % columnLanes)];
            EXPECT_NEAR(actual.re, expected.re, 2e-5f) << v << ' ' << u;
            EXPECT_NEAR(actual.im, expected.im, 2e-5f) << v << ' ' << u;
        }
    std::vector<float> back(grid.size());
    transform.inverse(spectrum.data(), back.data(), cols, 1.0f / static_cast<float>(rows * cols));
    for (std::size_t i = 0; i < grid.size(); ++i)
        EXPECT_NEAR(back[i], grid[i], 2e-6f);
}

TEST(RealTransform2dParts, StridesZeroContinuationAndCropsAreHonoured)
{
    // 5 rows of 6 samples in a field of stride 11, continued with zeros to a 7 x 9 grid.
    const int rows = 7, cols = 9, inRows = 5, inCols = 6, stride = 11;
    const std::vector<float> field = noise(rows * stride, 3);
    std::vector<float> compact(static_cast<std::size_t>(rows * cols), 0.0f);
    for (int y = 0; y < inRows; ++y)
        for (int x = 0; x < inCols; ++x)
            compact[static_cast<std::size_t>(y * cols + x)] = field[static_cast<std::size_t>(y * stride + x)];

    const realTransform2d transform(rows, cols, workers::one);
    pieceSpectrum expected(transform.spectrumCount()), actual(transform.spectrumCount());
    transform.forwardRows(compact.data(), cols, cols, 0, rows, expected.data());
    transform.clearRows(inRows, rows - inRows, actual.data());
    transform.forwardRows(field.data(), stride, inCols, 0, inRows, actual.data());
    for (std::size_t i = 0; i < actual.count(); ++i)
    {
        EXPECT_FLOAT_EQ(actual[i].re, expected[i].re);
        EXPECT_FLOAT_EQ(actual[i].im, expected[i].im);
    }

    // Rows 1 to 3, four columns of each, into a field that must stay as it is around them.
    std::vector<float> out(static_cast<std::size_t>(3 * stride), 9.0f);
    transform.inverseRows(actual.data(), 1, 3, out.data(), stride, 4, 1.0f / static_cast<float>(cols));
    for (int y = 0; y < 3; ++y)
        for (int x = 0; x < stride; ++x)
            EXPECT_NEAR(out[static_cast<std::size_t>(y * stride + x)],
                        x < 4 ? compact[static_cast<std::size_t>((y + 1) * cols + x)] : 9.0f, 1e-6f);
}

TEST(RealTransform2dParts, AllThreadsGiveTheBytesOfOne)
{
    const int rows = 211, cols = 330;
    const std::vector<float> grid = noise(rows * cols, 11);
    const realTransform2d one(rows, cols, workers::one), all(rows, cols, workers::all);
    pieceSpectrum a(one.spectrumCount()), b(all.spectrumCount());
    one.forward(grid.data(), cols, a.data());
    all.forward(grid.data(), cols, b.data());
    EXPECT_EQ(std::memcmp(a.data(), b.data(), a.count() * sizeof(complexSample)), 0);
}

} // namespace
