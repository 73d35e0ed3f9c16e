#include "deblur/deconv/fastSize.h"

#include "tests/support/npy.h"

#include <gtest/gtest.h>

using CorvaneDeblur::fastSize;

namespace
{

TEST(FastSize, MatchesReference)
{
    const std::vector<std::int64_t> n = TestSupport::readInts("fast_size", "n");
    const std::vector<std::int64_t> size = TestSupport::readInts("fast_size", "size");
    for (std::size_t i = 0; i < n.size(); ++i)
        EXPECT_EQ(fastSize(static_cast<int>(n[i])), size[i]) << n[i];
}

TEST(FastSize, TakesAnyNumber)
{
    EXPECT_EQ(fastSize(0), 1);
    EXPECT_EQ(fastSize(-5), 1);
    EXPECT_EQ(fastSize(2147483646), 2147483647) << "no product lies between";
}

} // namespace
