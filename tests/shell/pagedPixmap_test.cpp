#include "framework/pixels/memoryPixmap.h"
#include "framework/pixels/virtualPixmap.h"
#include "shell/heapPageStore.h"
#include "tests/shell/heapFixture.h"

#include <random>

namespace Sarnik
{
namespace
{

class PagedPixmap : public heapTest
{
};

std::uint16_t sampleFor(int plane, std::int32_t x, std::int32_t y)
{
    return static_cast<std::uint16_t>((x * 31 + y * 977 + plane * 10007) % 32769);
}

/// A picture 24 times as large as the memory that it may have comes back exact, whatever the order of its tiles.
TEST_F(PagedPixmap, ComesBackExactWithFarTooLittleMemory)
{
    for (const bool interleaved : {false, true})
    {
        CVirtualHeap heap;
        heap.Open(volume());
        heap.SetLimit(std::uint64_t{1} << 18);
        CHeapPageStore store(heap);
        CVirtualPixmap paged(store, 4, 1200, 900, 3, tilePreset, interleaved, false);
        paged.SetOrigin(-40, 70);
        const CRect all = paged.Bounds();

        for (std::int32_t top = all.top; top < all.bottom; top += 128)
        {
            CMemoryPixmap strip({all.left, top, all.right, std::min(top + 128, all.bottom)}, 16, 3);
            for (int p = 0; p < 3; ++p)
                for (std::int32_t y = top; y < strip.Bounds().bottom; ++y)
                    for (std::int32_t x = all.left; x < all.right; ++x)
                        strip.Plane(p).Row<std::uint16_t>(y)[x - all.left] = sampleFor(p, x, y);
            copyPlanes(paged, 0, strip, 0, 3, all);
        }
        EXPECT_LE(heap.TotalBytes(), heap.Limit() + 3 * tileBytes(paged.TileShape().sizeClass));

        std::mt19937 random(2);
        for (int i = 0; i < 60; ++i)
        {
            const auto left = static_cast<std::int32_t>(random() % 1300) - 60;
            const auto top = static_cast<std::int32_t>(random() % 1000) + 50;
            CMemoryPixmap patch({left, top, left + 90, top + 70}, 16, 3);
            copyPlanes(patch, 0, paged, 0, 3, patch.Bounds());
            const CRect seen = patch.Bounds().Intersected(all);
            for (int p = 0; p < 3; ++p)
                for (std::int32_t y = seen.top; y < seen.bottom; ++y)
                    for (std::int32_t x = seen.left; x < seen.right; ++x)
                        ASSERT_EQ(patch.Plane(p).Row<std::uint16_t>(y)[x - left], sampleFor(p, x, y));
        }
    }
}

} // namespace
} // namespace Sarnik
