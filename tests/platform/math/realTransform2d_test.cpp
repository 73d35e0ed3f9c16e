#include "platform/math/realTransform2d.h"

#include <gtest/gtest.h>

#include <cstring>
#include <random>
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

TEST(RealTransform2d, StridesZeroContinuationAndCropsAreHonoured)
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

TEST(RealTransform2d, AllThreadsGiveTheBytesOfOne)
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
