#include "deblur/deconv/fastSize.h"

#include "tests/support/npy.h"

#include <gtest/gtest.h>

using CorvaneDeblur::fastSize;

namespace
{

bool isProductOfSmallPrimes(long long n)
{
    for (const int prime : {2, 3, 5, 7, 11, 13})
        while (n % prime == 0)
            n /= prime;
    return n == 1;
}

TEST(FastSize, MatchesReference)
{
    const std::vector<std::int64_t> n = TestSupport::readInts("fast_size", "n");
    const std::vector<std::int64_t> size = TestSupport::readInts("fast_size", "size");
    for (std::size_t i = 0; i < n.size(); ++i)
        EXPECT_EQ(fastSize(static_cast<int>(n[i])), size[i]) << n[i];
}

TEST(FastSize, IsTheNextProductAndStrictlyLargerAboveTheTable)
{
    for (int n = 1; n < 13000; ++n)
    {
        int expected = n < 10000 ? n : n + 1;
        while (!isProductOfSmallPrimes(expected))
            ++expected;
        ASSERT_EQ(fastSize(n), expected) << n;
    }
}

TEST(FastSize, TakesAnyNumber)
{
    EXPECT_EQ(fastSize(0), 1);
    EXPECT_EQ(fastSize(-5), 1);
    EXPECT_EQ(fastSize(2147483646), 2147483647) << "no product lies between";
    const int large = fastSize(1000000007);
    EXPECT_GT(large, 1000000007);
    EXPECT_LT(large, 1010000000);
    EXPECT_TRUE(isProductOfSmallPrimes(large));
}

} // namespace
