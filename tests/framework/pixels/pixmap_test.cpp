#include "framework/pixels/fills.h"
#include "framework/pixels/virtualPixmap.h"
#include "tests/framework/pixels/memoryPages.h"

#include <gtest/gtest.h>

#include <random>

namespace
{

using namespace Sarnik;
using TestSupport::memoryPages;

std::uint32_t sampleAt(CPixmap &pixmap, int plane, std::int32_t x, std::int32_t y)
{
    const CPixelLock lock = pixmap.LockArea({x, y, x + 1, y + 1}, plane, CPixelAccess::read);
    switch (pixmap.GetDepth())
    {
    case 8:
        return *lock[0].Row<std::uint8_t>(y);
    case 16:
        return *lock[0].Row<std::uint16_t>(y);
    default:
        return *lock[0].Row<std::uint32_t>(y);
    }
}

/// A value that no other sample near it has.
std::uint32_t patternAt(int depth, int plane, std::int32_t x, std::int32_t y)
{
    const std::uint32_t v = static_cast<std::uint32_t>(x) * 2654435761u ^ static_cast<std::uint32_t>(y) * 40503u ^
                            static_cast<std::uint32_t>(plane) * 97u;
    return depth == 32 ? v : (v ^ v >> 16) & (depth == 8 ? 255u : 65535u);
}

void drawPattern(CMemoryPixmap &pixmap)
{
    const CRect r = pixmap.Bounds();
    for (int p = 0; p < pixmap.GetPlaneCount(); ++p)
        for (std::int32_t y = r.top; y < r.bottom; ++y)
            for (std::int32_t x = r.left; x < r.right; ++x)
                fillArea(pixmap, p, {x, y, x + 1, y + 1}, patternAt(pixmap.GetDepth(), p, x, y));
}

TEST(TileShape, HoldsItsBytesAndIsNearlySquare)
{
    for (int depthLog = 3; depthLog <= 5; ++depthLog)
        for (std::uint32_t c = 0; c < 16; ++c)
        {
            const CTileShape s = tileShape(c, depthLog);
            EXPECT_EQ(static_cast<std::size_t>(s.width) * static_cast<std::size_t>(s.height) << depthLog,
                      tileBytes(static_cast<int>(c)) * 8);
            EXPECT_TRUE(s.width == s.height || s.width == 2 * s.height) << s.width << " x " << s.height;
        }
    for (std::uint32_t preset = 0; preset < 5; ++preset)
        for (int depthLog = 3; depthLog <= 5; ++depthLog)
        {
            const CTileShape s = tileShape(tilePreset | preset, depthLog);
            EXPECT_EQ(s.width, 64 << preset);
            EXPECT_EQ(s.height, 64 << preset);
        }
    EXPECT_EQ(tileShape(9, 5).width, 256);
    EXPECT_EQ(tileShape(9, 5).height, 128);
    EXPECT_ANY_THROW(tileShape(16, 3));
    EXPECT_ANY_THROW(tileShape(tilePreset | 5, 3));
    EXPECT_ANY_THROW(tileShape(3, 6));
}

/// Whatever the tiles and the order of planes, a paged pixmap gives back what was put in, at any place.
TEST(VirtualPixmap, EqualsAMemoryPixmap)
{
    std::mt19937 random(11);
    for (const int depthLog : {3, 4, 5})
        for (const bool interleaved : {false, true})
            for (const std::uint32_t spec : {0u, 1u, 3u, tilePreset})
            {
                SCOPED_TRACE(testing::Message() << (1 << depthLog) << " bits, tiles " << spec);
                const int depth = 1 << depthLog;
                memoryPages pages;
                {
                    CVirtualPixmap paged(pages, depthLog, 83, 61, 3, spec, interleaved, interleaved);
                    paged.SetOrigin(-20, 13);
                    ASSERT_EQ(paged.Bounds(), (CRect{-20, 13, 63, 74}));
                    EXPECT_EQ(pages.Live(), interleaved ? paged.TilesX() * paged.TilesY() * 3 : 0);
                    CMemoryPixmap truth(paged.Bounds(), depth, 3), copy(paged.Bounds(), depth, 3);
                    for (int i = 0; i < 12; ++i)
                    {
                        const auto in = [&](int low, int high) {
                            return std::uniform_int_distribution(low, high)(random);
                        };
                        const int left = in(-30, 60), top = in(0, 70);
                        const CRect rect{left, top, left + in(1, 60), top + in(1, 50)};
                        CMemoryPixmap patch(rect, depth, 2);
                        drawPattern(patch);
                        const int plane = in(0, 1);
                        copyPlanes(paged, plane, patch, 0, 2, rect);
                        copyPlanes(truth, plane, patch, 0, 2, rect);
                    }
                    copyPlanes(copy, 0, paged, 0, 3, paged.Bounds());
                    for (int p = 0; p < 3; ++p)
                        for (std::int32_t y = 13; y < 74; ++y)
                            for (std::int32_t x = -20; x < 63; ++x)
                                ASSERT_EQ(sampleAt(copy, p, x, y), sampleAt(truth, p, x, y))
                                    << "plane " << p << " at " << x << ", " << y;
                    EXPECT_EQ(pages.Locked(), 0);
                    paged.SetSize(10, 10);
                    EXPECT_EQ(sampleAt(paged, 2, -20, 13), 0u);
                }
                EXPECT_EQ(pages.Live(), 0);
            }
}

TEST(VirtualPixmap, NumbersItsTilesByPlaneOrByPlace)
{
    memoryPages pages;
    const CVirtualPixmap together(pages, 3, 33, 17, 4, 0, true, false), apart(pages, 3, 33, 17, 4, 0, false, false);
    ASSERT_EQ(together.TilesX(), 3); // of 16 x 16
    ASSERT_EQ(together.TilesY(), 2);
    EXPECT_EQ(together.TileNumber(2, 1, 3), 23u);
    EXPECT_EQ(together.TileNumber(1, 0, 2), 6u);
    EXPECT_EQ(apart.TileNumber(1, 0, 2), 13u);
}

/// Wherever the store fails, nothing stays locked and nothing leaks.
TEST(VirtualPixmap, SurvivesAStoreThatFails)
{
    for (int n = 0; n < 12; ++n)
        for (const bool prepare : {false, true})
        {
            memoryPages pages;
            (n % 2 == 0 ? pages.failAcquireAt : pages.failLockAt) = n;
            try
            {
                CVirtualPixmap paged(pages, 4, 40, 40, 3, 0, true, prepare);
                CMemoryPixmap out(paged.Bounds(), 16, 3);
                EXPECT_ANY_THROW(copyPlanes(out, 0, paged, 0, 3, paged.Bounds()));
                EXPECT_EQ(pages.Locked(), 0);
                EXPECT_NO_THROW(copyPlanes(out, 0, paged, 0, 3, paged.Bounds())) << "a second try works";
                EXPECT_EQ(sampleAt(paged, 1, 5, 5), 0u);
            }
            catch (const std::bad_alloc &)
            {
                EXPECT_TRUE(prepare && n % 2 == 0);
            }
            EXPECT_EQ(pages.Live(), 0);
        }
}

TEST(MemoryPixmap, RefusesWhatItCannotHold)
{
    EXPECT_THROW(CMemoryPixmap(CRect{INT32_MIN, INT32_MIN, INT32_MAX, INT32_MAX}, 64, 5), std::bad_alloc);
    EXPECT_THROW(CMemoryPixmap(4, 4, 12, 1), std::invalid_argument);
    CMemoryPixmap reversed(CRect{5, 5, 2, 9}, 8, 1);
    EXPECT_TRUE(reversed.Bounds().Empty());
    EXPECT_TRUE(reversed.LockArea({0, 0, 9, 9}, 0, CPixelAccess::read).Rect().Empty());
}

/// Border fills against the definition, at every depth, for rectangles inside, at the edges, one pixel wide, outside.
TEST(Fills, BorderAndReplication)
{
    const CRect all{-4, 10, 19, 31};
    for (const int depth : {8, 16, 32})
        for (const CRect &inner :
             {CRect{0, 12, 9, 20}, CRect{-4, 10, 19, 31}, CRect{3, 10, 4, 31}, CRect{-4, 30, 19, 31},
              CRect{18, 30, 40, 50}, CRect{-4, 15, -3, 16}, CRect{50, 50, 60, 60}})
        {
            SCOPED_TRACE(testing::Message() << depth << " bits, from " << inner.left << ", " << inner.top);
            CMemoryPixmap border(all, depth, 2), repeated(all, depth, 2);
            drawPattern(border);
            drawPattern(repeated);
            const CRect cut = inner.Intersected(all);
            const std::uint32_t value = opaqueValue(depth);
            fillBorder(border, 1, inner, value);
            replicateBorder(repeated, 1, inner);
            for (std::int32_t y = all.top; y < all.bottom; ++y)
                for (std::int32_t x = all.left; x < all.right; ++x)
                {
                    const bool inside = x >= cut.left && x < cut.right && y >= cut.top && y < cut.bottom;
                    ASSERT_EQ(sampleAt(border, 1, x, y), inside ? patternAt(depth, 1, x, y) : value);
                    const std::int32_t nx = cut.Empty() ? x : std::clamp(x, cut.left, cut.right - 1);
                    const std::int32_t ny = cut.Empty() ? y : std::clamp(y, cut.top, cut.bottom - 1);
                    ASSERT_EQ(sampleAt(repeated, 1, x, y), patternAt(depth, 1, nx, ny)) << x << ", " << y;
                    ASSERT_EQ(sampleAt(border, 0, x, y), patternAt(depth, 0, x, y)) << "the other plane";
                }
        }

    CMemoryPixmap deep(4, 4, 64, 1);
    fillArea(deep, 0, deep.Bounds(), 1);
    fillBorder(deep, 0, {}, 1);
    EXPECT_EQ(*deep.Plane(0).Row<double>(0), 0.0) << "no fill at 64 bits";
}

} // namespace
