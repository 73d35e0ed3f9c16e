#include "deblur/estimate/suggestRegion.h"

#include "deblur/estimate/arrayOps.h"
#include "tests/deblur/estimate/measuresImage.h"
#include "tests/support/synthetic.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <optional>

using namespace CorvaneDeblur;

namespace
{

std::optional<regionRect> suggest(const floatArray &grey, int size, regionMode mode = regionMode::first,
                                  const std::vector<regionRect> &existing = {}, imagePoint point = {})
{
    regionRect rect;
    if (!suggestRegion(grey, grey.cols, grey.rows, size, size, noiseMode::medium, 0.0f, existing, mode, point, rect))
        return std::nullopt;
    return rect;
}

void expectNear(const std::optional<regionRect> &rect, const regionRect &expected, int pixels)
{
    ASSERT_TRUE(rect);
    EXPECT_NEAR(rect->x, expected.x, pixels);
    EXPECT_NEAR(rect->y, expected.y, pixels);
    EXPECT_NEAR(rect->width, expected.width, pixels);
    EXPECT_NEAR(rect->height, expected.height, pixels);
}

double overlapShare(const regionRect &a, const regionRect &b)
{
    const double width = std::min(a.x + a.width, b.x + b.width) - std::max(a.x, b.x);
    const double height = std::min(a.y + a.height, b.y + b.height) - std::max(a.y, b.y);
    return std::max(width, 0.0) * std::max(height, 0.0) / (static_cast<double>(a.width) * a.height);
}

} // namespace

TEST(SuggestRegion, ReferencePicture)
{
    const floatArray grey = TestSupport::measuresImage();
    std::vector<regionRect> existing;
    for (const regionRect &expected :
         {regionRect{138, 38, 217, 217}, regionRect{314, 188, 217, 217}, regionRect{0, 188, 217, 217}})
    {
        const auto rect = suggest(grey, 21, existing.empty() ? regionMode::first : regionMode::more, existing);
        expectNear(rect, expected, 2);
        existing.push_back(expected);
    }
    expectNear(suggest(grey, 21, regionMode::near, {}, {100, 300}), {0, 194, 217, 217}, 2);
}

TEST(SuggestRegion, RegionsDoNotRepeatAndRunOut)
{
    const floatArray grey = TestSupport::edgeScene(500, 700, 12);
    std::vector<regionRect> existing;
    while (const auto rect = suggest(grey, 31, existing.empty() ? regionMode::first : regionMode::more, existing))
    {
        for (const regionRect &other : existing)
            EXPECT_LE(overlapShare(*rect, other), 0.8);
        EXPECT_TRUE(rect->x >= 0 && rect->y >= 0 && rect->x + rect->width <= 700 && rect->y + rect->height <= 500);
        existing.push_back(*rect);
        ASSERT_LT(existing.size(), 50u);
    }
    EXPECT_GE(existing.size(), 2u);
    EXPECT_FALSE(suggest(grey, 31, regionMode::more, {{0, 0, 700, 500}})) << "all is taken";
}

// A strip of discs beside a region that reaches to the right edge: a rectangle around the strip lies mostly in the
// region, the more so the larger it is. 310 pixels are the first size tried, and the image has no room to the left.
TEST(SuggestRegion, FourFifthsInARegionAreTheMost)
{
    const floatArray grey = floatArray::allocate(420, 1000);
    for (int y = 0; y < 420; ++y)
        for (int x = 0; x < 1000; ++x)
            grey.at(y, x) = std::hypot(x - 47, y % 30 - 15) < 10 ? 0.8f : 0.2f;

    const auto exact = suggest(grey, 31, regionMode::more, {{62, 0, 938, 420}});
    ASSERT_TRUE(exact);
    EXPECT_EQ(exact->x, 0);
    EXPECT_EQ(exact->width, 310);

    const auto smaller = suggest(grey, 31, regionMode::more, {{61, 0, 939, 420}});
    ASSERT_TRUE(smaller);
    EXPECT_EQ(smaller->width, 279);
}

TEST(SuggestRegion, LeavesDarkAndClippedPartsAlone)
{
    const floatArray scene = TestSupport::edgeScene(400, 400, 7);
    const floatArray grey = floatArray::allocate(400, 800);
    copyTo(scene, grey.subRect(0, 400, 400, 400));
    for (const float shift : {0.8f, -0.8f})
    {
        for (int y = 0; y < 400; ++y)
            for (int x = 0; x < 400; ++x)
                grey.at(y, x) = scene.at(y, x) + shift;
        const auto rect = suggest(grey, 21, regionMode::more);
        ASSERT_TRUE(rect);
        EXPECT_GE(rect->centreX(), 400);
    }
}

TEST(SuggestRegion, NeedsEdgesInManyDirections)
{
    const floatArray flat = floatArray::allocate(400, 500);
    fill(flat, 0.5f);
    EXPECT_FALSE(suggest(flat, 21));

    for (int y = 0; y < 400; ++y)
        for (int x = 0; x < 500; ++x)
            flat.at(y, x) = x / 50 % 2 == 0 ? 0.3f : 0.7f;
    EXPECT_FALSE(suggest(flat, 21)) << "stripes have one direction";

    EXPECT_TRUE(suggest(TestSupport::edgeScene(400, 500, 1), 21));
}

TEST(SuggestRegion, SmallBlursGetRegionsAsForThirtyOne)
{
    const floatArray grey = TestSupport::edgeScene(400, 500, 1);
    const auto rect = suggest(grey, 31);
    ASSERT_TRUE(rect);
    EXPECT_GE(std::min(rect->width, rect->height), 5 * 31);
    EXPECT_EQ(suggest(grey, 0), rect);
    EXPECT_EQ(suggest(grey, 11), rect);
}

TEST(SuggestRegion, BrokenSamplesCountAsBlack)
{
    const floatArray grey = TestSupport::edgeScene(400, 500, 1), broken = cloned(grey);
    broken.at(5, 5) = std::numeric_limits<float>::quiet_NaN();
    broken.at(300, 20) = std::numeric_limits<float>::infinity();
    const auto rect = suggest(broken, 21);
    ASSERT_TRUE(rect);
    // A black spot each on the thumbnail, whose scale here is about a sixth.
    const auto blackened = [&](int y, int x) { fill(grey.subRect(y - 4, x - 4, 9, 9), 0.0f); };
    blackened(5, 5);
    blackened(300, 20);
    expectNear(rect, *suggest(grey, 21), 20);
}

TEST(SuggestRegion, AnySizeOfImageAndKernel)
{
    for (const int cols : {1, 2, 3, 49, 154, 158, 170, 1200})
    {
        for (const int rows : {1, 2, 49, 170})
        {
            const floatArray grey = TestSupport::noiseImage(rows, cols, 3);
            for (const int size : {-1, 3, 31, 60, 1 << 30})
            {
                for (const regionMode mode : {regionMode::first, regionMode::near, regionMode::more})
                {
                    const auto rect = suggest(grey, size, mode, {{-50, 3, 1 << 30, 2}}, {-1 << 30, 1 << 30});
                    if (!rect)
                        continue;
                    EXPECT_GT(std::min(cols, rows), 5 * 31);
                    EXPECT_TRUE(!rect->empty() && rect->x >= 0 && rect->y >= 0);
                    EXPECT_TRUE(rect->x + rect->width <= cols && rect->y + rect->height <= rows);
                }
            }
        }
    }
    EXPECT_FALSE(suggest(floatArray{}, 31));
    // A source far wider than its reduced grey: the box would have no samples.
    regionRect rect;
    EXPECT_FALSE(suggestRegion(TestSupport::noiseImage(4, 1000, 3), 2000000, 400, 31, 31, noiseMode::high, 0.0f, {},
                               regionMode::first, {}, rect));
}
