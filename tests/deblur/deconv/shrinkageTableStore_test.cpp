#include "deblur/deconv/shrinkageTableStore.h"

#include <gtest/gtest.h>
#include <tbb/global_control.h>
#include <tbb/parallel_for.h>
#include <tbb/task_arena.h>

#include <atomic>
#include <cmath>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
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
    void SetUp() override
    {
        std::string name = testing::TempDir() + "shrinkageTables.XXXXXX";
        ASSERT_NE(::mkdtemp(name.data()), nullptr);
        directory = name;
    }
    void TearDown() override { fs::remove_all(directory); }

    fs::path file(int round) const { return directory / (std::to_string(round) + "_1.tmp"); }

    shrinkageTable content(int round) const
    {
        std::ifstream in(file(round), std::ios::binary);
        const std::string bytes{std::istreambuf_iterator<char>(in), {}};
        shrinkageTable table(bytes.size() / sizeof(float));
        std::copy_n(bytes.data(), table.size() * sizeof(float), reinterpret_cast<char *>(table.data()));
        return table;
    }

    void write(int round, const shrinkageTable &table, std::size_t bytes) const
    {
        std::ofstream(file(round), std::ios::binary)
            .write(reinterpret_cast<const char *>(table.data()), static_cast<std::streamsize>(bytes));
    }

    fs::path directory;
};

TEST_F(ShrinkageTableStore, KeepsSixTablesInFiles)
{
    const shrinkageTableStore store(directory.string());
    float beta = 1.0f;
    for (int round = 0; round < 6; ++round, beta *= std::sqrt(2.0f) + std::sqrt(2.0f))
    {
        EXPECT_EQ(store.prepared(round), buildShrinkageTable(beta, alpha23)) << round;
        EXPECT_EQ(content(round), store.prepared(round)) << round;
        EXPECT_EQ(fs::file_size(file(round)), 800004u);
    }
    EXPECT_EQ(std::distance(fs::directory_iterator(directory), {}), 6) << "nothing else is left behind";
}

TEST_F(ShrinkageTableStore, TakesGoodFilesAndRebuildsOthers)
{
    const shrinkageTable good = buildShrinkageTable(1.0f, alpha23);
    // A file that tells whether it was read: exactly right in form, different in one value.
    shrinkageTable marked = good;
    marked[5] += 0.25f;
    marked.resize(marked.size() + 1);
    write(0, marked, 800004);
    write(1, marked, 800003);
    write(2, marked, 800005);
    write(3, marked, 0);
    shrinkageTable spoilt = good;
    spoilt[77] = std::numeric_limits<float>::quiet_NaN();
    write(4, spoilt, 800004);
    fs::create_directory(file(5));

    const shrinkageTableStore store(directory.string());
    EXPECT_EQ(store.prepared(0)[5], marked[5]);
    const shrinkageTableStore fresh("");
    for (int round = 1; round < 6; ++round)
    {
        EXPECT_EQ(store.prepared(round), fresh.prepared(round)) << round;
        if (round < 5)
        {
            EXPECT_EQ(content(round), fresh.prepared(round)) << "the file is good again";
        }
    }
}

TEST_F(ShrinkageTableStore, WorksWithoutADirectory)
{
    const fs::path missing = directory / "missing";
    shrinkageTableStore store(missing.string());
    EXPECT_EQ(store.prepared(0), buildShrinkageTable(1.0f, alpha23));
    EXPECT_FALSE(fs::exists(missing));
}

TEST_F(ShrinkageTableStore, TwoStoresShareADirectory)
{
    const shrinkageTableStore fresh("");
    std::atomic<int> wrong = 0;
    const auto start = [&] {
        for (int i = 0; i < 4; ++i)
        {
            const shrinkageTableStore store(directory.string());
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
