#include "deblur/deconv/shrinkageTable.h"

#include "tests/support/matchers.h"
#include "tests/support/npy.h"

#include <gtest/gtest.h>

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

double cost(double w, double v, double alpha, double beta)
{
    return std::pow(std::fabs(w), alpha) + 0.5 * beta * (w - v) * (w - v);
}

/// The least cost that a walk over 0..v finds.
double leastCost(double v, double alpha, double beta)
{
    double least = cost(0.0, v, alpha, beta);
    for (int i = 0; i <= 2000; ++i)
        least = std::min(least, cost(v * i / 2000.0, v, alpha, beta));
    return least;
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

TEST(ShrinkageTable, EntriesMinimiseTheCost)
{
    struct
    {
        float alpha, beta;
        double slack; ///< four Newton steps from w = v stop a little above the minimum
    } const cases[] = {{1.0f, 3.0f, 1e-6},  {alpha23, 1.0f, 1e-6}, {alpha23, 3801.0f, 1e-6},      {0.5f, 2.0f, 1e-6},
                       {0.5f, 90.0f, 1e-6}, {0.8f, 5.0f, 1e-4},    {alpha23 + 2e-3f, 64.0f, 1e-3}};
    for (const auto &[alpha, beta, slack] : cases)
    {
        const shrinkageTable table = buildShrinkageTable(beta, alpha);
        bool odd = true, monotone = true;
        for (std::size_t i = 0; i < table.size(); ++i)
        {
            odd = odd && table[i] == -table[200000 - i];
            monotone = monotone && (i == 0 || table[i] >= table[i - 1]);
        }
        EXPECT_TRUE(odd && monotone) << alpha << ' ' << beta;
        EXPECT_EQ(table[100000], 0.0f);
        EXPECT_EQ(table[100001], 0.0f) << "small gradients vanish";
        // Steps that grow: the threshold lies at small gradients.
        for (int i = 1; i <= 100000; i += 1 + i / 16)
        {
            const double v = i * 1e-4, w = static_cast<double>(table[static_cast<std::size_t>(100000 + i)]);
            ASSERT_GE(w, 0.0);
            ASSERT_LE(w, v * (1 + 1e-6));
            ASSERT_LE(cost(w, v, static_cast<double>(alpha), static_cast<double>(beta)),
                      leastCost(v, static_cast<double>(alpha), static_cast<double>(beta)) + slack)
                << "alpha " << alpha << ", beta " << beta << ", v " << v << ", w " << w;
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
