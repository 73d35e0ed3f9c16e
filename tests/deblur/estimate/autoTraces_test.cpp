#include "deblur/estimate/autoTraces.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/blurSize.h"
#include "deblur/estimate/reducedGrey.h"
#include "deblur/estimate/resample.h"
#include "tests/support/matchers.h"
#include "tests/support/synthetic.h"

#include <gtest/gtest.h>

#include <limits>

using namespace CorvaneDeblur;

namespace
{

/// A picture in memory that checks and remembers what is read of it.
class arraySource : public greySource
{
public:
    explicit arraySource(floatArray samples) : grey(std::move(samples)) {}

    int cols() const override { return grey.cols; }
    int rows() const override { return grey.rows; }
    void readGrey(const regionRect &rect, const floatArray &out) override
    {
        ASSERT_EQ(out.rows, rect.height);
        ASSERT_EQ(out.cols, rect.width);
        ASSERT_TRUE(rect.x >= 0 && rect.y >= 0 && rect.x + rect.width <= cols() && rect.y + rect.height <= rows());
        copyTo(grey.subRect(rect.y, rect.x, rect.height, rect.width), out);
        largestRead = std::max(largestRead, rect.width * rect.height);
        reads += 1;
        if (reads == stopAfter)
            stop = true;
    }

    floatArray grey;
    int largestRead = 0, reads = 0, stopAfter = -1;
    std::atomic<bool> stop = false;
};

/// A scene drawn small and enlarged.
floatArray largeScene(int rows, int cols, unsigned seed)
{
    const floatArray scene = floatArray::allocate(rows, cols);
    resize(TestSupport::edgeScene(rows / 4, cols / 4, seed), scene);
    return scene;
}

floatArray flatNoise(int rows, int cols)
{
    return TestSupport::noiseImage(rows, cols, 2, 0.49f, 0.51f);
}

} // namespace

TEST(ReducedGrey, StripsGiveWhatResizeOfTheWholeGives)
{
    const struct
    {
        int rows, cols, reducedRows, reducedCols;
    } cases[] = {{700, 300, 100, 43}, {300, 301, 100, 100}, {2000, 1, 100, 1}, {2, 1500, 1, 100}, {40, 100, 40, 100}};
    for (const auto &c : cases)
    {
        arraySource source(TestSupport::noiseImage(c.rows, c.cols, 4));
        const floatArray reduced = reducedGrey(source, 100);
        const floatArray expected = floatArray::allocate(c.reducedRows, c.reducedCols);
        resize(source.grey, expected);
        EXPECT_TRUE(TestSupport::arrayIdentical(reduced, expected)) << c.rows << "x" << c.cols;
        EXPECT_LE(source.largestRead, 256 * c.cols);
    }
}

TEST(ReducedGrey, BrokenSamplesBecomeBlackAndStayLocal)
{
    arraySource source(TestSupport::noiseImage(600, 300, 4));
    const floatArray zeroed = cloned(source.grey);
    source.grey.at(299, 150) = std::numeric_limits<float>::infinity();
    source.grey.at(599, 299) = std::numeric_limits<float>::quiet_NaN();
    zeroed.at(299, 150) = zeroed.at(599, 299) = 0.0f;
    arraySource clean(zeroed);
    EXPECT_TRUE(TestSupport::arrayIdentical(reducedGrey(source, 100), reducedGrey(clean, 100)));
}

TEST(AnalysedImage, SuggestsDistinctRegions)
{
    arraySource source(largeScene(1200, 1600, 5));
    const analysedImage image(source);
    const autoRegionList list = image.autoRegions(4, 45, noiseMode::automatic);
    ASSERT_EQ(list.regions.size(), 4u);
    EXPECT_EQ(list.size, 45);
    EXPECT_FALSE(list.smallSizeTried);
    const auto near = image.suggestRegionAt({1500, 100}, 45, noiseMode::automatic);
    ASSERT_TRUE(near);
    EXPECT_GT(near->centreX(), 800);
    EXPECT_LT(near->centreY(), 600);
}

TEST(AnalysedImage, TriesASmallBoxWhereTheLargeOneDoesNotFit)
{
    arraySource source(TestSupport::edgeScene(400, 500, 1));
    const analysedImage image(source);
    const autoRegionList list = image.autoRegions(2, 101, noiseMode::automatic);
    EXPECT_TRUE(list.smallSizeTried);
    EXPECT_EQ(list.size, 10);
    EXPECT_FALSE(list.regions.empty());
}

TEST(AnalysedImage, DefaultSizeComesFromTheMiddleWhereNoRegionIsFound)
{
    arraySource source(flatNoise(900, 1800));
    const analysedImage image(source);
    EXPECT_TRUE(image.autoRegions(3, 31, noiseMode::automatic).regions.empty());
    EXPECT_EQ(image.findDefaultSize(noiseMode::automatic),
              blurSizeOfWindow(source.grey.subRect(0, 150, 900, 1500), 1800, 900));

    for (const int side : {1, 30})
    {
        arraySource tiny(flatNoise(side, side));
        EXPECT_EQ(analysedImage(tiny).findDefaultSize(noiseMode::automatic), 31);
    }
}

TEST(AnalysedImage, StopsWhenAsked)
{
    for (const int reads : {1, 2, 5, 6})
    {
        arraySource source(largeScene(1000, 1200, 9));
        source.stopAfter = reads; // four strips, the noise patch, windows
        const analysedImage image(source, &source.stop);
        const int size = image.findDefaultSize(noiseMode::automatic);
        EXPECT_TRUE(image.stopped());
        EXPECT_EQ(source.reads, reads);
        EXPECT_TRUE(size == 0 || reads == 6);
        EXPECT_TRUE(image.autoRegions(3, 31, noiseMode::automatic).regions.empty());
        EXPECT_FALSE(image.suggestRegionAt({500, 500}, 31, noiseMode::automatic));
    }
}
