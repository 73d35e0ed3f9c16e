#include "deblur/estimate/suggestRegion.h"

#include "deblur/estimate/arrayOps.h"
#include "tests/deblur/estimate/measuresImage.h"
#include "tests/support/synthetic.h"

#include <gtest/gtest.h>

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

TEST(SuggestRegion, AnySizeOfImageAndKernel)
{
    for (const int cols : {1, 3, 154, 170, 1200})
        for (const int rows : {1, 49, 170})
            for (const int size : {-1, 31, 60, 1 << 30})
            {
                const floatArray grey = TestSupport::noiseImage(rows, cols, 3);
                grey.at(rows / 2, cols / 3) = std::numeric_limits<float>::quiet_NaN();
                grey.at(rows / 3, cols / 2) = std::numeric_limits<float>::infinity();
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
    EXPECT_FALSE(suggest(floatArray{}, 31));
    // A source far wider than its reduced grey: the box would have no samples.
    regionRect rect;
    EXPECT_FALSE(suggestRegion(TestSupport::noiseImage(4, 1000, 3), 2000000, 400, 31, 31, noiseMode::high, 0.0f, {},
                               regionMode::first, {}, rect));
}
