#include "platform/canvas/canvas.h"

#include <gmock/gmock.h>

#include <cmath>
#include <limits>
#include <numbers>
#include <random>

using namespace Platform;

namespace
{

constexpr colour white{255, 255, 255}, red{255, 0, 0}, green{0, 255, 0};

/// Sum of the alphas, in pixels: the area that white ink covers.
double coverage(const raster &r)
{
    double sum = 0;
    for (int y = 0; y < r.height(); ++y)
        for (int x = 0; x < r.width(); ++x)
            sum += (r.row(y)[x] >> 24) / 255.0;
    return sum;
}

pixelRect inked(const raster &r)
{
    pixelRect box{r.width(), r.height(), 0, 0};
    for (int y = 0; y < r.height(); ++y)
        for (int x = 0; x < r.width(); ++x)
            if (r.row(y)[x] != 0)
                box = {std::min(box.left, x), std::min(box.top, y), std::max(box.right, x + 1),
                       std::max(box.bottom, y + 1)};
    return box;
}

struct onScale : testing::TestWithParam<double>
{
    double scale = GetParam();
    raster picture{static_cast<int>(120 * scale), static_cast<int>(100 * scale)};
    canvas draw{picture, scale};
    /// In view units.
    double area() const { return coverage(picture) / (scale * scale); }
};

INSTANTIATE_TEST_SUITE_P(canvas, onScale, testing::Values(1.0, 1.5, 2.0));

TEST_P(onScale, ShapesCoverTheirArea)
{
    const double pi = std::numbers::pi;
    const rectangle r{20.25, 15.5, 90.75, 70.25};
    const auto expectArea = [&](double expected, auto paint) {
        picture = raster(picture.width(), picture.height());
        canvas fresh(picture, scale);
        paint(fresh);
        EXPECT_NEAR(area(), expected, expected * 0.004 + 0.3);
    };
    expectArea(r.width() * r.height(), [&](canvas &c) { c.fillRectangle(r, white); });
    expectArea(pi * r.width() * r.height() / 4, [&](canvas &c) { c.fillEllipse(r, white); });
    expectArea(r.width() * r.height() - (4 - pi) * 64, [&](canvas &c) { c.fillRounded(r, 8, white); });
    // A radius beyond half the side is that half: two half discs and what is between them.
    expectArea(r.height() * (r.width() - r.height()) + pi * r.height() * r.height() / 4,
               [&](canvas &c) { c.fillRounded(r, 500, white); });
    expectArea(0.5 * 60 * 40, [&](canvas &c) { c.fillTriangle({10, 10}, {70, 10}, {33, 50}, white); });
    expectArea(3 * 50, [&](canvas &c) { c.drawLine({20, 20}, {50, 60}, {.ink = white, .width = 3}); });
    expectArea(2 * pi * 2 * 30, [&](canvas &c) { c.drawEllipse({20, 10, 80, 70}, {.ink = white, .width = 2}); });
    expectArea(2 * 2 * (60 + 40), [&](canvas &c) { c.drawRectangle({20, 20, 80, 60}, {.ink = white, .width = 2}); });
    expectArea(pi * 25 * 25 * 0.75, [&](canvas &c) {
        c.fill(path().addArc({50, 50}, 25, 0, 1.5 * pi).lineTo({50, 50}).close(), white);
    });
    // 4 on, 4 off over 80 units: half of the line; the same shifted by 4 is the other half, without overlap.
    const pen dashed{.ink = white, .width = 2, .dashes = {4, 4}};
    expectArea(80, [&](canvas &c) { c.drawLine({10, 40}, {90, 40}, dashed); });
    expectArea(160, [&](canvas &c) {
        pen other = dashed;
        other.dashOffset = 4;
        c.drawLine({10, 40}, {90, 40}, dashed);
        c.drawLine({10, 40}, {90, 40}, other);
    });
    // Where figures of one path lie over each other an even number of times there is a hole.
    expectArea(60 * 60 - 20 * 20, [&](canvas &c) {
        c.fill(path().addRectangle({10, 10, 70, 70}).addRectangle({30, 30, 50, 50}), white);
    });
}

TEST_P(onScale, ClipsEndAtWholePixelsAndNeighboursMeet)
{
    // A row of clips with fractional edges: every pixel is drawn once, half transparent ink tells.
    for (int i = 0; i < 12; ++i)
    {
        draw.save();
        draw.translate(i * 9.7, 0);
        draw.clip({0, 10.3, 9.7, 60.6});
        draw.fillRectangle({-50, -50, 500, 500}, {255, 255, 255, 128});
        draw.restore();
    }
    const pixelRect box = inked(picture);
    EXPECT_EQ(box.left, 0);
    EXPECT_EQ(box.right, std::lround(12 * 9.7 * scale));
    EXPECT_EQ(box.top, std::lround(10.3 * scale));
    EXPECT_EQ(box.bottom, std::lround(60.6 * scale));
    for (int x = box.left; x < box.right; ++x)
        ASSERT_EQ(picture.row(box.top)[x], packed({255, 255, 255, 128})) << x;

    // An empty clip lets nothing through; restoring brings the old one back, and once too often does no harm.
    const raster before = picture;
    draw.save();
    draw.clip({30, 30, 20, 40});
    EXPECT_TRUE(draw.clipBounds().empty());
    draw.fillRectangle({0, 0, 120, 100}, red);
    EXPECT_EQ(picture, before);
    draw.restore();
    draw.restore();
    draw.fillRectangle({0, 0, 120, 100}, red);
    EXPECT_NEAR(area(), 120 * 100, 1e-6);
}

TEST(canvas, PixelClipsAreUnions)
{
    raster picture(40, 40);
    canvas draw(picture, 2);
    const pixelRect parts[] = {{2, 2, 20, 20}, {10, 10, 30, 30}, {35, 35, 400, 400}, {50, 50, 40, 40}};
    draw.translate(1000, 1000);
    draw.clipPixels(parts);
    draw.fillRectangle({-2000, -2000, 2000, 2000}, white);
    EXPECT_DOUBLE_EQ(coverage(picture), 18 * 18 + 20 * 20 - 10 * 10 + 5 * 5);
}

TEST(canvas, PicturesAreScaledBlendedAndCopied)
{
    // A checkered picture with a red frame that must not shine into a drawn part.
    raster image(6, 6);
    for (int y = 0; y < 6; ++y)
        for (int x = 0; x < 6; ++x)
            image.row(y)[x] = packed(x == 0 || y == 0 || x == 5 || y == 5 ? red : colour{40, 200, 90});
    raster picture(64, 64);
    canvas draw(picture);
    draw.drawImage(image, {1, 1, 5, 5}, {8, 8, 40, 40}, sampling::smooth);
    EXPECT_EQ(inked(picture), (pixelRect{8, 8, 40, 40}));
    for (int y = 8; y < 40; ++y)
        for (int x = 8; x < 40; ++x)
            ASSERT_EQ(picture.row(y)[x], packed({40, 200, 90})) << x << ' ' << y;

    // A part that leaves the picture keeps its scale: only what exists is drawn.
    picture = raster(64, 64);
    canvas again(picture);
    again.drawImage(image, {-6, -6, 6, 6}, {0, 0, 48, 48}, sampling::nearest, 0.5);
    EXPECT_EQ(inked(picture), (pixelRect{24, 24, 48, 48}));
    EXPECT_NEAR(picture.row(30)[30] >> 24, 128, 1);

    // Made smaller, every pixel counts: the mean stays.
    raster fine(64, 64);
    for (int y = 0; y < 64; ++y)
        for (int x = 0; x < 64; ++x)
            fine.row(y)[x] = packed((x + y) % 2 ? white : colour{0, 0, 0});
    raster small(8, 8);
    canvas(small).drawImage(fine, fine.bounds(), {0, 0, 8, 8});
    EXPECT_NEAR(unpacked(small.row(4)[4]).red, 128, 6);

    raster target(10, 10);
    canvas copy(target);
    copy.fillRectangle({0, 0, 10, 10}, red);
    raster half(4, 4);
    half.row(1)[1] = packed({0, 255, 0, 100});
    copy.copyPixels(half, {-1, -1, 4, 4}, 2, 2);
    EXPECT_EQ(target.row(4)[4], packed({0, 255, 0, 100}));
    EXPECT_EQ(target.row(3)[3], 0u);
    EXPECT_EQ(target.row(2)[2], packed(red)) << "what the picture lacks stays";
}

TEST(canvas, OddValuesNeitherCrashNorSpoilWhatFollows)
{
    const double inf = std::numeric_limits<double>::infinity(), nan = std::numeric_limits<double>::quiet_NaN();
    const double odd[] = {inf, -inf, nan, 1e300, -1e300, 1e7, -1e7, 0, -5, 1e-300};
    std::mt19937 random(7);
    const auto pick = [&] { return odd[random() % std::size(odd)]; };
    raster picture(30, 30), image(3, 3);
    canvas draw(picture, 2);
    for (int i = 0; i < 400; ++i)
    {
        draw.save();
        const pen how{.ink = red, .width = pick(), .dashes = {pick(), pick()}, .dashOffset = pick()};
        const rectangle r{pick(), pick(), pick(), pick()};
        draw.drawLine({pick(), pick()}, {pick(), pick()}, how);
        draw.drawEllipse(r, how);
        draw.fillRounded(r, pick(), red);
        draw.drawImage(image, {0, 0, 3, 3}, r, sampling::smooth, pick());
        draw.drawText("odd", {.size = pick()}, {pick(), pick()}, red);
        draw.fillGradient(path().addRectangle(r), r, red, green);
        draw.translate(pick(), pick());
        draw.clip(r);
        draw.restore();
    }
    draw.fillRectangle({0, 0, 15, 15}, green);
    EXPECT_EQ(picture.row(29)[29], packed(green));
    // A rectangle far beyond all sides covers everything, instead of wrapping around.
    draw.fillRectangle({-1e9, -1e9, 1e9, 1e9}, red);
    EXPECT_EQ(picture.row(0)[0], packed(red));

    EXPECT_THROW(raster(-1, 5), std::length_error);
    EXPECT_THROW(raster(5, 40000), std::length_error);
    raster none;
    canvas(none).fillRectangle({0, 0, 5, 5}, red);
    for (unsigned a = 0; a < 256; a += 15)
        EXPECT_EQ(packed(unpacked(packed({200, 100, 3, static_cast<std::uint8_t>(a)}))),
                  packed({200, 100, 3, static_cast<std::uint8_t>(a)}));
}

} // namespace
