#include "cli/greyOfPhoto.h"
#include "cli/jsonWriter.h"
#include "cli/kernelArrays.h"
#include "cli/progressBar.h"
#include "cli/traceRegion.h"

#include <gmock/gmock.h>

#include <cmath>
#include <limits>

using namespace Stillmark;

namespace
{

TEST(JsonWriter, HoldsOnlyWhatJsonAllows)
{
    EXPECT_EQ(jsonString("a\"\\\n\x01z"), "\"a\\\"\\\\\\u000a\\u0001z\"");
    EXPECT_EQ(jsonString("gr\xc3\xbcn \xe2\x82\xac \xf0\x9f\x98\x80"), "\"gr\xc3\xbcn \xe2\x82\xac \xf0\x9f\x98\x80\"");
    // a lone continuation, a cut sequence, an overlong one, a surrogate: replaced byte by byte, the rest kept
    EXPECT_EQ(jsonString("\x80z"), "\"\xef\xbf\xbdz\"");
    EXPECT_EQ(jsonString("\xe2\x82"), "\"\xef\xbf\xbd\xef\xbf\xbd\"");
    EXPECT_EQ(jsonString("\xc0\xaf"), "\"\xef\xbf\xbd\xef\xbf\xbd\"");
    EXPECT_EQ(jsonString("\xed\xa0\x80"), "\"\xef\xbf\xbd\xef\xbf\xbd\xef\xbf\xbd\"");
    EXPECT_EQ(jsonNumber(std::numeric_limits<double>::quiet_NaN()), "null");
    EXPECT_EQ(jsonNumber(std::numeric_limits<float>::infinity()), "null");
    EXPECT_EQ(std::stod(jsonNumber(0.1 + 0.2)), 0.1 + 0.2);
    EXPECT_EQ(jsonObject({{"a", jsonArray({jsonNumber(1), jsonBool(false)})}, {"b", jsonRectangle({1, 2, 3, 4})}}),
              "{\"a\": [1, false], \"b\": [1, 2, 3, 4]}");
}

TEST(ProgressBar, FitsAnyTerminal)
{
    for (int columns = 1; columns < 100; ++columns)
        for (const double done : {0.0, 0.3, 1.0})
            EXPECT_LT(static_cast<int>(progressBar::lineFor("Finding the blur", done, 9, columns).size()), columns);
}

TEST(TraceRegion, GrowsToThreeKernelsInsideThePicture)
{
    const auto grown = [](rectangle r, int size) { return toEngine(grownRegion(r, size, {0, 0, 400, 300})); };
    using region = CorvaneDeblur::regionRect;
    EXPECT_EQ(grown({10, 20, 93, 200}, 31), (region{10, 20, 93, 200})) << "large enough: as drawn";
    EXPECT_EQ(grown({150, 100, 50, 60}, 31), (region{128, 78, 94, 104})) << "43 missing: 22 more on every side";
    EXPECT_EQ(grown({150, 100, 50, 60}, 30), grown({150, 100, 50, 60}, 31)) << "an even size counts as the next";
    EXPECT_EQ(grown({0, 0, 50, 60}, 31), (region{0, 0, 94, 104})) << "pushed in from the top left corner";
    EXPECT_EQ(grown({350, 240, 50, 60}, 31), (region{306, 196, 94, 104})) << "and from the bottom right one";
    EXPECT_EQ(grown({150, 100, 1, 1}, 199), (region{0, 0, 400, 300})) << "no more than the picture";
}

TEST(GreyOfSamples, FollowsTheColourMode)
{
    const auto grey = [](auto samples, int depth, colourMode mode) {
        float out = -1;
        greyOfSamples(samples.data(), 1, 1, depth, mode, &out);
        return out;
    };
    using bytes = std::vector<std::uint8_t>;
    EXPECT_FLOAT_EQ(grey(bytes{51}, 8, colourMode::grey), 0.2f);
    EXPECT_FLOAT_EQ(grey(bytes{51, 255, 0}, 8, colourMode::lab), 0.2f);
    EXPECT_FLOAT_EQ(grey(bytes{255, 0, 0}, 8, colourMode::rgb), 0.299f);
    EXPECT_FLOAT_EQ(grey(std::vector<std::uint16_t>{0, 65535, 0}, 16, colourMode::rgb), 0.587f);
    EXPECT_FLOAT_EQ(grey(bytes{255, 0, 255, 0}, 8, colourMode::cmyk), 0.587f) << "cyan and yellow print green";
    EXPECT_FLOAT_EQ(grey(bytes{0, 0, 0, 255}, 8, colourMode::cmyk), 0.0f);
    constexpr float nan = std::numeric_limits<float>::quiet_NaN();
    EXPECT_FLOAT_EQ(grey(std::vector<float>{nan, 0.5f, 0.0f}, 32, colourMode::rgb), 0.2935f);
    EXPECT_FLOAT_EQ(grey(std::vector<float>{-std::numeric_limits<float>::infinity()}, 32, colourMode::grey), 0.0f);
    EXPECT_TRUE(std::isfinite(grey(std::vector<float>{3e38f, 3e38f, 3e38f}, 32, colourMode::rgb)));
}

} // namespace
