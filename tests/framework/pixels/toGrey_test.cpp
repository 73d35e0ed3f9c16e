#include "framework/pixels/sixteenBit.h"
#include "framework/pixels/toGrey.h"
#include "framework/pixels/virtualPixmap.h"
#include "tests/framework/pixels/memoryPages.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <random>

namespace
{

using namespace Sarnik;

TEST(SixteenBit, EveryHostCodeComesBack)
{
    std::vector<std::uint16_t> samples(65536);
    for (std::size_t s = 0; s < samples.size(); ++s)
        samples[s] = static_cast<std::uint16_t>(s);
    expandSamples(samples.data(), samples.size());
    for (unsigned s = 0; s < 65536; ++s)
        ASSERT_EQ(samples[s], s < 32768 ? 2 * s : 65535u);
    compressSamples(samples.data(), samples.size());
    for (unsigned s = 0; s < 65536; ++s)
        ASSERT_EQ(samples[s], std::min(s, 32768u));

    for (unsigned s = 0; s < 65536; ++s)
        samples[s] = static_cast<std::uint16_t>(s);
    compressSamples(samples.data(), samples.size());
    for (unsigned s = 0; s < 65536; ++s)
        ASSERT_EQ(samples[s], s == 65535 ? 32768u : s / 2);
}

TEST(SixteenBit, ActsOnThePicturesPlanesAlone)
{
    for (const int imagePlanes : {0, 1, 2, 3, 4, 5})
        for (const int depth : {8, 16, 32})
        {
            CMemoryPixmap pixmap({3, 3, 40, 9}, depth, 5);
            for (int p = 0; p < 5; ++p)
                for (std::int32_t y = 3; y < 9; ++y)
                    std::fill_n(pixmap.Plane(p).Row<std::uint8_t>(y), 37 * depth / 8, std::uint8_t{0x11});
            expandSixteenBit(pixmap, imagePlanes);
            const bool acts = depth == 16 && (imagePlanes == 1 || imagePlanes == 3 || imagePlanes == 4);
            for (int p = 0; p < 5; ++p)
                for (std::int32_t y = 3; y < 9; ++y)
                    EXPECT_EQ(pixmap.Plane(p).Row<std::uint8_t>(y)[37 * depth / 8 - 1],
                              acts && p < imagePlanes ? 0x22 : 0x11);
            compressSixteenBit(pixmap, imagePlanes);
            EXPECT_EQ(*pixmap.Plane(0).Row<std::uint8_t>(8), 0x11);
        }
}

/// Gives R = 3/4 C + 1/4 K and so on, in whole numbers: needs all four samples in their order.
class mixingConverter final : public CQuadConverter
{
public:
    void CmykToRgb(std::uint8_t *quads, std::size_t pixels) override { Mix(quads, pixels); }
    void CmykToRgb(std::uint16_t *quads, std::size_t pixels) override { Mix(quads, pixels); }

private:
    template <class Sample> void Mix(Sample *quads, std::size_t pixels)
    {
        for (std::size_t i = 0; i < pixels; ++i, quads += 4)
            for (int c = 0; c < 3; ++c)
                quads[c] = static_cast<Sample>((3 * quads[c] + quads[3]) / 4);
    }
};

struct greyCase
{
    CPixelKind kind;
    int colours; ///< without transparency and selection
    int depth;
    bool hasMask, converter;
};

/// The definition, one sample at a time.
template <class Sample>
void direct(const greyCase &c, const CMaskLimits &limits, CMemoryPixmap &source, std::int32_t x, std::int32_t y,
            double &grey, int &mask)
{
    double raw[4] = {};
    for (int p = 0; p < c.colours; ++p)
        raw[p] = source.Plane(p).Row<Sample>(y)[x - source.Bounds().left];
    const bool cmyk = c.colours == 4;
    if (cmyk && c.converter)
        for (int p = 0; p < 3; ++p)
            raw[p] = std::floor((3 * raw[p] + raw[3]) / 4);
    const double limit = c.depth == 8 ? limits.byte : c.depth == 16 ? limits.word : limits.real;
    const double range = c.depth == 8 ? 255 : c.depth == 16 ? 65535 : 1;
    const bool three = cmyk || c.kind == CPixelKind::rgb;
    mask = 0;
    double v[3];
    for (int p = 0; p < (three ? 3 : 1); ++p)
    {
        mask |= raw[p] > limit;
        v[p] = c.depth == 16 ? (raw[p] >= 32768 ? 65535 : 2 * raw[p]) : raw[p];
    }
    grey = three ? (v[0] * double{0.299f} + v[1] * double{0.587f} + v[2] * double{0.114f}) / range : v[0] / range;
}

void expectGrey(const greyCase &c, std::uint8_t threshold)
{
    SCOPED_TRACE(testing::Message() << "kind " << static_cast<int>(c.kind) << ", " << c.colours << " colours, "
                                    << c.depth << " bits, mask " << c.hasMask << ", threshold " << int{threshold});
    const CRect bounds{-13, 40, 58, 79};
    const int planes = c.colours + 1 + c.hasMask;
    CMemoryPixmap source(bounds, c.depth, planes);
    std::mt19937 random(threshold + c.depth);
    for (int p = 0; p < planes; ++p)
        for (std::int32_t y = bounds.top; y < bounds.bottom; ++y)
            for (int i = 0; i < bounds.Width(); ++i)
                if (c.depth == 8)
                    source.Plane(p).Row<std::uint8_t>(y)[i] = static_cast<std::uint8_t>(random());
                else if (c.depth == 16)
                    source.Plane(p).Row<std::uint16_t>(y)[i] =
                        static_cast<std::uint16_t>(random() % 5 == 0 ? 32768 : random() % 32769);
                else
                    source.Plane(p).Row<float>(y)[i] =
                        random() % 50 == 0 ? 1.5f : static_cast<float>(random() % 1001) / 1000.0f;

    TestSupport::memoryPages pages;
    CVirtualPixmap paged(pages, c.depth == 8 ? 3 : c.depth == 16 ? 4 : 5, 71, 39, planes, 2, true, false);
    paged.SetOrigin(-13, 40);
    copyPlanes(paged, 0, source, 0, planes, bounds);

    mixingConverter converter;
    const CMaskLimits limits = CMaskLimits::of(threshold);
    const CGreySource about{c.kind, c.hasMask, c.converter ? &converter : nullptr, limits};
    const CRect area{-5, 30, 50, 77}, seen{-5, 40, 50, 77};
    CMemoryPixmap grey(area, 64, 1), mask(area, 8, 1), whole(bounds, 64, 1);
    ASSERT_TRUE(ToGrey(paged, area, about, grey, &mask));
    ASSERT_TRUE(ToGrey(source, bounds, about, whole));
    for (std::int32_t y = seen.top; y < seen.bottom; ++y)
        for (std::int32_t x = seen.left; x < seen.right; ++x)
        {
            double wanted = 0;
            int marked = 0;
            c.depth == 8    ? direct<std::uint8_t>(c, limits, source, x, y, wanted, marked)
            : c.depth == 16 ? direct<std::uint16_t>(c, limits, source, x, y, wanted, marked)
                            : direct<float>(c, limits, source, x, y, wanted, marked);
            ASSERT_EQ(grey.Plane(0).Row<double>(y)[x + 5], wanted) << x << ", " << y;
            ASSERT_EQ(whole.Plane(0).Row<double>(y)[x + 13], wanted);
            ASSERT_EQ(mask.Plane(0).Row<std::uint8_t>(y)[x + 5], marked) << x << ", " << y;
        }
    EXPECT_EQ(*grey.Plane(0).Row<double>(30), 0.0) << "outside of the source";
}

TEST(ToGrey, EqualsTheFormulaInEveryModeAndDepth)
{
    for (const bool hasMask : {false, true})
        for (const std::uint8_t threshold : {std::uint8_t{0}, std::uint8_t{100}, std::uint8_t{255}})
        {
            for (const int depth : {8, 16, 32})
            {
                expectGrey({CPixelKind::rgb, 3, depth, hasMask, false}, threshold);
                expectGrey({CPixelKind::grey, 1, depth, hasMask, false}, threshold);
            }
            for (const int depth : {8, 16})
            {
                expectGrey({CPixelKind::lab, 3, depth, hasMask, false}, threshold);
                expectGrey({CPixelKind::cmyk, 4, depth, hasMask, true}, threshold);
                expectGrey({CPixelKind::cmyk, 4, depth, hasMask, false}, threshold);
            }
        }
}

TEST(ToGrey, RefusesOtherCombinationsAndDoesNothing)
{
    const auto refuses = [](CPixelKind kind, int planes, int depth, bool hasMask) {
        CMemoryPixmap source(8, 8, depth, planes), grey(8, 8, 64, 1);
        *grey.Plane(0).Row<double>(0) = 7.0;
        return !ToGrey(source, source.Bounds(), {kind, hasMask, nullptr, {}}, grey) &&
               *grey.Plane(0).Row<double>(0) == 7.0;
    };
    EXPECT_TRUE(refuses(CPixelKind::rgb, 3, 8, false));
    EXPECT_TRUE(refuses(CPixelKind::rgb, 4, 8, true));
    EXPECT_TRUE(refuses(CPixelKind::rgb, 5, 16, false));
    EXPECT_TRUE(refuses(CPixelKind::rgb, 4, 64, false));
    EXPECT_TRUE(refuses(CPixelKind::lab, 4, 32, false));
    EXPECT_TRUE(refuses(CPixelKind::cmyk, 5, 32, false));
    EXPECT_TRUE(refuses(CPixelKind::grey, 1, 8, false));
    CMemoryPixmap source(8, 8, 8, 4), notDouble(8, 8, 32, 1);
    EXPECT_FALSE(ToGrey(source, source.Bounds(), {}, notDouble));
}

TEST(ToGrey, NotANumberIsNotClipped)
{
    CMemoryPixmap source(3, 1, 32, 2), grey(3, 1, 64, 1), mask(3, 1, 8, 1);
    float *row = source.Plane(0).Row<float>(0);
    row[0] = std::numeric_limits<float>::quiet_NaN();
    row[1] = std::numeric_limits<float>::infinity();
    row[2] = -1;
    ASSERT_TRUE(ToGrey(source, source.Bounds(), {CPixelKind::grey, false, nullptr, {}}, grey, &mask));
    EXPECT_TRUE(std::isnan(grey.Plane(0).Row<double>(0)[0]));
    EXPECT_EQ(mask.Plane(0).Row<std::uint8_t>(0)[0], 0);
    EXPECT_EQ(mask.Plane(0).Row<std::uint8_t>(0)[1], 1);
    EXPECT_EQ(mask.Plane(0).Row<std::uint8_t>(0)[2], 0);
}

} // namespace
