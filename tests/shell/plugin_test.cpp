#include "shell/plugin/hostChecks.h"
#include "shell/plugin/memoryPlan.h"
#include "shell/resources/propertyList.h"
#include "shell/resources/terminology.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <string>

namespace Project
{
namespace
{

using Sarnik::fourFifths;
using Sarnik::heapLimit;
using Sarnik::limitShares;

TEST(MemoryPlan, GivesEachSideItsLeastAndNeverMoreThanThereIs)
{
    struct row
    {
        std::int64_t total, buffers, rest;
    };
    const row rows[] = {
        {0, 0, 0},
        {1, 1, 0},
        {3, 2, 1},
        {1000001, 500001, 500000}, // below twice 512 KiB: halves, the odd byte to the first
        {1048576, 524288, 524288},
        {1310720, 786432, 524288}, // four fifths would leave too little
        {2621440, 2097152, 524288},
        {2621450, 2097160, 524290},
        {std::int64_t{1} << 40, 879609302221, 219902325555},
    };
    for (const row &r : rows)
    {
        const auto shares = limitShares(r.total, fourFifths(r.total));
        EXPECT_EQ(shares.buffers, r.buffers) << r.total;
        EXPECT_EQ(shares.rest, r.rest) << r.total;
    }
    // Wishes beyond the total.
    const auto greedy = limitShares(4 << 20, {8 << 20, 8 << 20});
    EXPECT_EQ(greedy.buffers, (4 << 20) - 524288);
    EXPECT_EQ(greedy.rest, 524288);
}

TEST(MemoryPlan, LimitsTheHeapByBothTheMachineAndTheHost)
{
    constexpr std::uint64_t mega = 1 << 20, giga = 1 << 30;
    EXPECT_EQ(heapLimit(64 * giga, std::int64_t{8} << 30), 3 * giga);
    EXPECT_EQ(heapLimit(2 * giga, std::int64_t{8} << 30), giga);
    EXPECT_EQ(heapLimit(64 * giga, 512 << 20), 512 * mega);
    EXPECT_EQ(heapLimit(64 * giga, 0), 32 * mega);
    EXPECT_EQ(heapLimit(0, -1), 32 * mega);
}

TEST(HostVersion, MustBeAfterThirteen)
{
    constexpr auto version = [](int major, int minor) { return std::intptr_t{major} << 16 | minor << 8 | 9; };
    EXPECT_FALSE(supportsHostVersion(std::nullopt));
    EXPECT_FALSE(supportsHostVersion(version(12, 9)));
    EXPECT_FALSE(supportsHostVersion(version(13, 0)));
    EXPECT_TRUE(supportsHostVersion(version(13, 1)));
    EXPECT_TRUE(supportsHostVersion(version(14, 0)));
}

std::string textOf(const resourceBytes &r, std::size_t from, std::size_t count)
{
    return {r.bytes.begin() + static_cast<std::ptrdiff_t>(from),
            r.bytes.begin() + static_cast<std::ptrdiff_t>(from + count)};
}

std::uint32_t wordAt(const resourceBytes &r, std::size_t at)
{
    std::uint32_t value = 0;
    for (std::size_t i = 4; i-- > 0;)
        value = value << 8 | r.bytes.at(at + i);
    return value;
}

TEST(Resources, ThePropertyListIsWalkedByItsLengths)
{
    const resourceBytes r = propertyList();
    EXPECT_EQ(wordAt(r, 0) & 0xFFFF, 1u);
    ASSERT_EQ(wordAt(r, 6), 14u);
    std::size_t at = 10;
    std::string keys;
    for (int i = 0; i < 14; ++i)
    {
        EXPECT_EQ(textOf(r, at, 4), "WDNT");
        std::string key = textOf(r, at + 4, 4);
        std::reverse(key.begin(), key.end());
        keys += key + " ";
        const std::uint32_t length = wordAt(r, at + 12);
        if (key == "8664")
        {
            EXPECT_EQ(textOf(r, at + 16, length), "EntryFI");
        }
        at += 16 + (length + 3) / 4 * 4;
    }
    EXPECT_EQ(at, r.bytes.size());
    EXPECT_EQ(keys, "nabo kind vers name catg znam zcat cmpt flly ms32 8664 enbl hstm fici ");
}

TEST(Resources, TheTerminologyBeginsAndEndsAsHostsExpect)
{
    const resourceBytes r = terminology();
    EXPECT_EQ(textOf(r, 0, 4), std::string("\1\0\1\0", 4));
    EXPECT_EQ(textOf(r, 10, 8), "\7Corvane");
    EXPECT_EQ(textOf(r, 28, 4), "Lbed");
    const std::string last = "\061$$$/Deblur/Dialog/FineDeconvLabel=&Artifact Suppression";
    const std::string end = std::string("teRf") + "loob" + std::string(1 + 2 + 6, '\0');
    EXPECT_EQ(textOf(r, r.bytes.size() - end.size(), end.size()), end);
    EXPECT_EQ(textOf(r, r.bytes.size() - end.size() - last.size() + 1, last.size() - 1), last.substr(1));
}

} // namespace
} // namespace Project
