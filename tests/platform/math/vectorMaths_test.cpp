#include "platform/math/sampleMemory.h"
#include "platform/math/vectorOps.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstdint>
#include <limits>
#include <vector>

using namespace CorvaneDeblur;

TEST(VectorOps, ExpIsGoodToTwoUnitsInTheLastPlace)
{
    std::vector<float> x;
    for (float v = -87.0f; v <= 88.0f; v += 0.00317f)
        x.push_back(v);
    std::vector<float> y(x.size());
    vsExp(x.size(), x.data(), y.data());
    for (std::size_t i = 0; i < x.size(); ++i)
    {
        const double exact = std::exp(static_cast<double>(x[i]));
        ASSERT_NEAR(static_cast<double>(y[i]), exact, 2.4e-7 * exact) << x[i];
    }
    const float outside[] = {-1e30f, -std::numeric_limits<float>::infinity(), 1e30f, 0.0f};
    float limited[4];
    vsExp(4, outside, limited);
    EXPECT_LT(limited[0], 1e-37f);
    EXPECT_LT(limited[1], 1e-37f);
    EXPECT_TRUE(std::isfinite(limited[2]));
    EXPECT_EQ(limited[3], 1.0f);
}

TEST(VectorOps, SumsAndSearchesTakeEveryElementOnce)
{
    // Lengths around the eight partial sums; integers add exactly in any order.
    for (std::size_t n = 0; n <= 35; ++n)
    {
        std::vector<float> a(n), ones(n, 1.0f);
        float sum = 0.0f;
        for (std::size_t i = 0; i < n; ++i)
        {
            a[i] = static_cast<float>(i + 1) * (i % 3 == 0 ? -1.0f : 1.0f);
            sum += a[i];
        }
        EXPECT_EQ(sdot(n, a.data(), ones.data()), sum);
        EXPECT_EQ(sasum(n, a.data()), static_cast<float>(n * (n + 1) / 2));
        if (n > 0)
        {
            EXPECT_EQ(isamax(n, a.data()), n - 1);
        }
        for (std::size_t at = 0; at < n; ++at)
        {
            std::vector<float> b(n, -2.0f);
            b[at] = 5.0f;
            EXPECT_EQ(smax(n, b.data(), 1.0f), 5.0f);
        }
    }
}

TEST(SampleMemory, KeepsAtMostItsLimitAndGivesAllBack)
{
    const std::size_t block = idleSampleMemoryLimit() / 3 + 1;
    trimSampleMemory();
    void *blocks[4];
    for (void *&b : blocks)
    {
        b = takeSampleMemory(block);
        EXPECT_EQ(reinterpret_cast<std::uintptr_t>(b) % 64, 0u);
    }
    for (void *b : blocks)
        returnSampleMemory(b, block);
    EXPECT_LE(idleSampleMemory(), idleSampleMemoryLimit());
    trimSampleMemory();
    EXPECT_EQ(idleSampleMemory(), 0u);
    returnSampleMemory(nullptr, block);
    EXPECT_EQ(idleSampleMemory(), 0u);
}
