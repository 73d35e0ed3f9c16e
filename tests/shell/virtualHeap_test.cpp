#include "shell/virtualHeap.h"

#include "shell/heapPageStore.h"
#include "tests/shell/heapFixture.h"

#include <algorithm>
#include <deque>
#include <list>
#include <thread>

namespace Sarnik
{
namespace
{

class VirtualHeap : public heapTest
{
};

/// What a tile is known to hold, and a pin that may be held on it for a while.
struct modelTile
{
    VirtualTile *tile;
    std::vector<std::byte> bytes;
    std::size_t kept; ///< of these bytes, those that survive paging
    std::vector<CPagePin> pins;
};

/// The known bytes, where those behind the kept ones may have turned to zeros.
void expectHolds(const modelTile &known, std::span<const std::byte> found)
{
    ASSERT_EQ(found.size(), known.bytes.size());
    ASSERT_EQ(std::memcmp(found.data(), known.bytes.data(), known.kept), 0);
    for (std::size_t i = known.kept; i < found.size(); ++i)
        ASSERT_TRUE(found[i] == known.bytes[i] || found[i] == std::byte{}) << i;
}

class RandomSequence : public heapTest, public ::testing::WithParamInterface<std::uint64_t>
{
};

INSTANTIATE_TEST_SUITE_P(Limit, RandomSequence, ::testing::Values(0, 3000, 40000, 1u << 20));

TEST_P(RandomSequence, GivesEveryByteBackWithinTheLimit)
{
    std::mt19937 random(static_cast<unsigned>(GetParam()) + 7);
    const auto below = [&](std::size_t n) { return static_cast<std::size_t>(random() % n); };
    CVirtualHeap heap;
    heap.Open(volume());
    heap.SetLimit(GetParam());
    std::vector<modelTile> model;
    for (int step = 0; step < 6000; ++step)
    {
        std::uint64_t locked = 0;
        for (const modelTile &known : model)
            locked += known.pins.empty() ? 0 : known.bytes.size();
        const std::uint64_t before = heap.TotalBytes();
        std::uint64_t asked = 0;

        const std::size_t what = below(20);
        modelTile *known = model.empty() ? nullptr : &model[below(model.size())];
        if (!known || (what == 0 && model.size() < 60))
        {
            const int sizeClass = static_cast<int>(below(7));
            const int diskClass = below(4) == 0 ? static_cast<int>(below(8)) : sizeClass;
            VirtualTile *tile = heap.AcquireTile(sizeClass, diskClass, below(40));
            model.push_back(
                {tile, std::vector<std::byte>(tileBytes(sizeClass)), tileBytes(std::min(sizeClass, diskClass)), {}});
        }
        else if (what == 1 && known->pins.empty())
        {
            heap.ReleaseTile(known->tile);
            model.erase(model.begin() + (known - model.data()));
        }
        else if (what == 2)
            heap.SetLimit(below(4) ? GetParam() : GetParam() / 2);
        else if (what == 3)
            heap.DetachMemory(known->tile);
        else if (what == 4)
            heap.Reserve(below(20000));
        else if (what < 7)
            known->pins.clear();
        else
        {
            asked = known->bytes.size();
            const CPageAccess access = what < 12   ? CPageAccess::read
                                       : what < 16 ? CPageAccess::change
                                                   : CPageAccess::overwrite;
            CPagePin pin = heap.Pin(known->tile, access);
            if (access != CPageAccess::overwrite)
            {
                ASSERT_NO_FATAL_FAILURE(expectHolds(*known, pin.bytes())) << "step " << step;
            }
            if (access != CPageAccess::read)
            {
                const std::size_t from = access == CPageAccess::change ? below(asked) : 0;
                const auto news = patternOf(static_cast<unsigned>(random()), asked - from);
                std::copy(news.begin(), news.end(), known->bytes.begin() + static_cast<std::ptrdiff_t>(from));
                std::copy(news.begin(), news.end(), pin.writableBytes().subspan(from).begin());
            }
            if (known->pins.size() < 2 && below(8) == 0)
                known->pins.push_back(std::move(pin));
        }
        ASSERT_LE(heap.TotalBytes(), std::max({heap.Limit(), before, locked + asked})) << "step " << step;
        ASSERT_LE(heap.FreeBytes(), heap.TotalBytes());
    }
    for (modelTile &known : model)
    {
        known.pins.clear();
        ASSERT_NO_FATAL_FAILURE(expectHolds(known, heap.Pin(known.tile, CPageAccess::read).bytes()));
        heap.ReleaseTile(known.tile);
    }
    EXPECT_EQ(heap.FreeBytes(), heap.TotalBytes());
    heap.SetLimit(0);
    EXPECT_EQ(heap.TotalBytes(), 0u);
}

TEST_F(VirtualHeap, KeepsWhatWasUsedLastAndWhatIsPinned)
{
    constexpr std::size_t room = 5;
    CVirtualHeap heap;
    heap.Open(volume());
    heap.SetLimit(room * tileBytes(4));
    std::vector<VirtualTile *> tiles;
    for (int i = 0; i < 12; ++i)
        tiles.push_back(heap.AcquireTile(4, 4));
    const CPagePin pinned = heap.Pin(tiles[0], CPageAccess::read);

    std::list<VirtualTile *> recent; // newest first, without the pinned one
    std::mt19937 random(3);
    for (int step = 0; step < 500; ++step)
    {
        VirtualTile *tile = tiles[1 + random() % 11];
        if (random() % 3 == 0)
            heap.Touch(tile); // does nothing to a tile without memory
        else
            heap.Pin(tile, CPageAccess::read);
        if (heap.InMemory(tile))
        {
            recent.remove(tile);
            recent.push_front(tile);
        }
        if (recent.size() > room - 1)
            recent.pop_back();
        ASSERT_TRUE(heap.InMemory(tiles[0]));
        for (std::size_t i = 1; i < tiles.size(); ++i)
            ASSERT_EQ(heap.InMemory(tiles[i]), std::find(recent.begin(), recent.end(), tiles[i]) != recent.end());
    }
    EXPECT_EQ(heap.TotalBytes(), heap.Limit()); // nothing was freed while the limit allowed it
}

TEST_F(VirtualHeap, HasSixteenClassesWhateverTheLimit)
{
    CVirtualHeap heap;
    heap.Open(volume());
    heap.SetLimit(100); // below the smallest block
    std::vector<VirtualTile *> tiles;
    for (int c = 0; c < tileClassCount; ++c)
    {
        tiles.push_back(heap.AcquireTile(c, c));
        tiles.push_back(heap.AcquireTile(c, std::min(c + 1, tileClassCount - 1))); // more room on disk than is needed
        EXPECT_EQ(heap.Pin(tiles.back(), CPageAccess::read).bytes().size(), std::size_t{256} << c);
    }
    for (unsigned i = 0; i < tiles.size(); ++i)
        fill(heap, tiles[i], i);
    for (unsigned i = 0; i < tiles.size(); ++i)
        EXPECT_TRUE(holds(heap, tiles[i], i)) << i;
    EXPECT_LE(heap.TotalBytes(), tileBytes(tileClassCount - 1));
}

TEST_F(VirtualHeap, ReleasedMemoryIsKeptForTheNextTileAndReadsAsZeros)
{
    CVirtualHeap heap;
    heap.Open(volume());
    VirtualTile *tile = heap.AcquireTile(3, 3);
    fill(heap, tile, 1);
    heap.DetachMemory(tile); // so that there are old bytes on disk, too
    fill(heap, tile, 2);
    heap.ReleaseTile(tile);
    EXPECT_EQ(heap.FreeBytes(), tileBytes(3));

    VirtualTile *again = nullptr;
    while (again != tile) // the free list comes round to it
        again = heap.AcquireTile(3, 3);
    const CPagePin pin = heap.Pin(again, CPageAccess::read);
    EXPECT_EQ(heap.FreeBytes(), 0u);
    EXPECT_EQ(heap.TotalBytes(), tileBytes(3));
    EXPECT_TRUE(std::all_of(pin.bytes().begin(), pin.bytes().end(), [](std::byte b) { return b == std::byte{}; }));
}

TEST_F(VirtualHeap, ReservesWithAMargin)
{
    CVirtualHeap heap;
    heap.Open(volume());
    heap.SetLimit(1 << 20);
    std::vector<VirtualTile *> tiles;
    for (unsigned i = 0; i < 16; ++i)
        fill(heap, tiles.emplace_back(heap.AcquireTile(8, 8)), i); // 64 KiB each: the limit is reached
    EXPECT_EQ(heap.TotalBytes(), 1u << 20);
    EXPECT_TRUE(heap.Reserve(100)); // and 4096 more: one block
    EXPECT_EQ(heap.TotalBytes(), (1u << 20) - 65536);
    EXPECT_TRUE(heap.Reserve(65536)); // and 4096 more: two blocks
    EXPECT_EQ(heap.TotalBytes(), (1u << 20) - 2 * 65536);
    EXPECT_FALSE(heap.Reserve((1 << 20) - 65535 + 4096)); // with its margin more than the limit
    {
        const CPagePin pin = heap.Pin(tiles[0], CPageAccess::read);
        EXPECT_FALSE(heap.Reserve(960000)); // the pinned page is in the way
    }
    EXPECT_TRUE(heap.Reserve(960000));
    for (unsigned i = 0; i < 16; ++i)
        EXPECT_TRUE(holds(heap, tiles[i], i));
}

TEST_F(VirtualHeap, SpreadsOverFilesInTurn)
{
    const std::uint64_t small = 4 * tileBytes(6);
    CVirtualHeap heap;
    heap.Open({{folder.string(), small}, {(folder / "missing").string()}, {folder.string(), small}});
    heap.SetLimit(0);
    std::vector<VirtualTile *> tiles;
    for (unsigned i = 0; i < 8; ++i)
        fill(heap, tiles.emplace_back(heap.AcquireTile(6, 6, 3)), i);
    EXPECT_NE(errorOf([&] { heap.AcquireTile(6, 6); }), "");

    for (unsigned i = 0; i < 8; ++i)
    {
        EXPECT_TRUE(holds(heap, tiles[i], i));
        CPageFile *file = nullptr;
        CPageFile *first = nullptr;
        std::uint32_t unit = 0;
        heap.FileAndOffset(0, first, unit);
        heap.FileAndOffset(tiles[i]->location, file, unit);
        EXPECT_EQ(file == first, i < 4);
        EXPECT_EQ(unit, i % 4 * (tileBytes(6) / 256));
        EXPECT_EQ(tiles[i]->location, (i < 4 ? 0u : 0x10000000u) + unit);
    }
}

TEST_F(VirtualHeap, ServesSeveralThreads)
{
    CVirtualHeap heap;
    heap.Open(volume());
    heap.SetLimit(3 * tileBytes(5));
    std::deque<bool> good(3, true);
    std::vector<std::thread> threads;
    for (unsigned t = 0; t < 3; ++t)
        threads.emplace_back([&heap, &right = good[t], t] {
            std::vector<VirtualTile *> tiles;
            for (unsigned i = 0; i < 6; ++i)
                fill(heap, tiles.emplace_back(heap.AcquireTile(5, 5)), 100 * t + i);
            for (unsigned step = 0; step < 200; ++step)
                right = right && holds(heap, tiles[step * 7 % 6], 100 * t + step * 7 % 6);
            for (VirtualTile *tile : tiles)
                heap.ReleaseTile(tile);
        });
    for (std::thread &thread : threads)
        thread.join();
    EXPECT_EQ(good, std::deque<bool>(3, true));
}

TEST_F(VirtualHeap, APageStoreKeepsPagesAndOutlivesTheHeap)
{
    auto heap = std::make_unique<CVirtualHeap>();
    heap->Open(volume());
    heap->SetLimit(0);
    CHeapPageStore store(*heap);
    const CPageStore::Page one = store.AcquirePage(4, 2);
    const CPageStore::Page two = store.AcquirePage(4, 2);
    const auto pattern = patternOf(1, tileBytes(4));
    std::memcpy(store.LockPage(one, false), pattern.data(), pattern.size());
    store.UnlockPage(one, true);
    std::memset(store.LockPage(two, true), 0, pattern.size()); // the limit has no place for both
    store.UnlockPage(two, true);
    EXPECT_EQ(std::memcmp(store.LockPage(one, false), pattern.data(), pattern.size()), 0);
    store.UnlockPage(one, false);

    heap.reset();
    EXPECT_NE(errorOf([&] { store.LockPage(one, false); }), "");
    EXPECT_NE(errorOf([&] { store.AcquirePage(4, 1); }), "");
    store.ReleasePage(one);
}

} // namespace
} // namespace Sarnik
