#include "deblur/deconv/shrinkageTable.h"

#include "tests/support/matchers.h"
#include "tests/support/npy.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <string>

using namespace CorvaneDeblur;
using namespace TestSupport;

namespace
{

constexpr float alpha23 = 2.0f / 3.0f;

float betaOfRound(int round)
{
    float beta = 1.0f;
    for (int i = 0; i < round; ++i)
        beta *= std::sqrt(2.0f) + std::sqrt(2.0f);
    return beta;
}

TEST(ShrinkageTable, MatchesReference)
{
    for (int round = 0; round < 6; ++round)
    {
        const floatArray expected = readFloats(("shrinkage_" + std::to_string(round)).c_str(), "entries");
        const shrinkageTable table = buildShrinkageTable(betaOfRound(round), alpha23);
        ASSERT_EQ(table.size(), 200001u);
        const floatArray entries = floatArray::allocate(1, expected.cols);
        for (int i = 0; i < expected.cols; ++i)
            entries.at(0, i) = table[static_cast<std::size_t>(500 * i)];
        EXPECT_TRUE(arrayNear(entries, expected, 6e-6)) << "round " << round;
    }
}

// With exponent 1 the least cost lies where soft thresholding takes a sample.
TEST(ShrinkageTable, ExponentOneIsTheSoftThreshold)
{
    for (const float beta : {0.5f, 3.0f, 90.0f})
    {
        const shrinkageTable table = buildShrinkageTable(beta, 1.0f);
        for (int i = 0; i <= 200000; ++i)
        {
            const float v = static_cast<float>(i - 100000) * 1e-4f;
            const float w = std::copysign(std::max(std::abs(v) - 1.0f / beta, 0.0f), v);
            ASSERT_NEAR(table[static_cast<std::size_t>(i)], w, 6e-6f) << v;
        }
    }
}

TEST(ApplyShrinkage, MatchesReference)
{
    const floatArray in = readFloats("shrinkage_lookup", "in"), expected = readFloats("shrinkage_lookup", "out");
    const shrinkageTable table = buildShrinkageTable(betaOfRound(3), alpha23);
    const floatArray out = floatArray::allocate(in.rows, in.cols);
    applyShrinkage(in, table, -10.0f, 0.0001f, out);
    EXPECT_TRUE(arrayNear(out, expected, 6e-6));
    applyShrinkage(in, table, -10.0f, 0.0001f, in);
    EXPECT_TRUE(arrayIdentical(in, out)) << "in place";
}

TEST(ApplyShrinkage, ContinuesTheEndsAndSurvivesOddValues)
{
    const shrinkageTable table = {0.0f, 1.0f, 3.0f}; // at 2, 2.5 and 3
    constexpr float inf = std::numeric_limits<float>::infinity(), nan = std::numeric_limits<float>::quiet_NaN();
    const float values[] = {2.25f, 2.75f, 3.0f, 4.0f, 1.0f, inf, -inf, nan, 1e30f};
    const float expected[] = {0.5f, 2.0f, 3.0f, 7.0f, -2.0f, inf, -inf, nan, 4e30f};
    const floatArray in = floatArray::allocate(1, 9), out = floatArray::allocate(1, 9);
    std::copy_n(values, 9, in.data);
    applyShrinkage(in, table, 2.0f, 0.5f, out);
    for (int i = 0; i < 9; ++i)
        EXPECT_TRUE(out.at(0, i) == expected[i] || (std::isnan(expected[i]) && std::isnan(out.at(0, i)))) << i;

    applyShrinkage(in, {7.0f, 8.0f}, 2.0f, 0.0f, out);
    EXPECT_EQ(out.at(0, 0), 7.0f);
    EXPECT_EQ(out.at(0, 8), 7.0f);
}

} // namespace
