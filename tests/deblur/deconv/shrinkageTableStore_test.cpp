#include "deblur/deconv/shrinkageTableStore.h"

#include "tests/support/temporaryFolder.h"

#include <gtest/gtest.h>
#include <tbb/global_control.h>
#include <tbb/parallel_for.h>
#include <tbb/task_arena.h>

#include <atomic>
#include <cmath>
#include <filesystem>
#include <limits>
#include <thread>

using namespace CorvaneDeblur;
namespace fs = std::filesystem;

namespace
{

constexpr float alpha23 = 2.0f / 3.0f;

class ShrinkageTableStore : public testing::Test
{
protected:
    std::string file(int round) const { return folder.file(std::to_string(round) + "_1.tmp"); }

    static std::string asBytes(const shrinkageTable &table)
    {
        return {reinterpret_cast<const char *>(table.data()), table.size() * sizeof(float)};
    }

    TestSupport::temporaryFolder folder;
    const std::string directory = folder.path().string();
};

TEST_F(ShrinkageTableStore, KeepsSixTablesInFiles)
{
    const shrinkageTableStore store(directory);
    float beta = 1.0f;
    for (int round = 0; round < 6; ++round, beta *= std::sqrt(2.0f) + std::sqrt(2.0f))
    {
        EXPECT_EQ(store.prepared(round), buildShrinkageTable(beta, alpha23)) << round;
        EXPECT_EQ(store.prepared(round).size(), 200001u);
        EXPECT_EQ(TestSupport::bytesOf(file(round)), asBytes(store.prepared(round))) << round;
    }
    EXPECT_EQ(folder.names().size(), 6u) << "nothing else is left behind";
}

TEST_F(ShrinkageTableStore, TakesGoodFilesAndRebuildsOthers)
{
    const shrinkageTable good = buildShrinkageTable(1.0f, alpha23);
    // A file that tells whether it was read: exactly right in form, different in one value.
    shrinkageTable marked = good;
    marked[5] += 0.25f;
    const std::string bytes = asBytes(marked);
    shrinkageTable spoilt = good;
    spoilt[77] = std::numeric_limits<float>::quiet_NaN();
    const std::string contents[] = {bytes, bytes.substr(0, 800003), bytes + "x", "", asBytes(spoilt)};
    for (int round = 0; round < 5; ++round)
        TestSupport::writeBytes(file(round), contents[round]);
    fs::create_directory(file(5));

    const shrinkageTableStore store(directory);
    EXPECT_EQ(store.prepared(0)[5], marked[5]);
    const shrinkageTableStore fresh("");
    for (int round = 1; round < 6; ++round)
    {
        EXPECT_EQ(store.prepared(round), fresh.prepared(round)) << round;
        if (round < 5)
        {
            EXPECT_EQ(TestSupport::bytesOf(file(round)), asBytes(fresh.prepared(round))) << "the file is good again";
        }
    }
}

TEST_F(ShrinkageTableStore, TwoStoresShareADirectory)
{
    const shrinkageTableStore fresh("");
    std::atomic<int> wrong = 0;
    const auto start = [&] {
        for (int i = 0; i < 4; ++i)
        {
            const shrinkageTableStore store(directory);
            for (int round = 0; round < 6; ++round)
                wrong += store.prepared(round) != fresh.prepared(round);
            std::error_code ignored;
            fs::remove(file(i), ignored);
        }
    };
    std::thread other(start);
    start();
    other.join();
    EXPECT_EQ(wrong, 0);
}

TEST_F(ShrinkageTableStore, FindsOneTableFromManyTasks)
{
    // Inside of a parallel loop, as from planes; the builds are parallel loops themselves.
    const tbb::global_control threads(tbb::global_control::max_allowed_parallelism, 8);
    shrinkageTableStore store("");
    std::vector<std::shared_ptr<const shrinkageTable>> found(200);
    const auto find = [&](int i) { found[static_cast<std::size_t>(i)] = store.findTable(1.0f, 1.0f + i % 50); };
    tbb::task_arena(8).execute([&] { tbb::parallel_for(0, 200, 1, find, tbb::simple_partitioner()); });
    for (std::size_t i = 0; i < found.size(); ++i)
        EXPECT_EQ(found[i], found[i % 50]);
    EXPECT_NE(found[0], found[1]);
    EXPECT_EQ(*found[1], buildShrinkageTable(2.0f, 1.0f));

    // Keys count as equal within 2^-23; the prepared tables are found as well.
    EXPECT_EQ(store.findTable(std::nextafter(alpha23, 0.0f), 1.0f).get(), &store.prepared(0));
    EXPECT_NE(store.findTable(alpha23, 1.000001f).get(), &store.prepared(0));
}

} // namespace
