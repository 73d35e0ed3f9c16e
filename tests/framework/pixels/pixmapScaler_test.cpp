#include "framework/pixels/pixmapScaler.h"

#include <gtest/gtest.h>

#include <bit>
#include <cmath>
#include <random>

using namespace Sarnik;

namespace
{

/// Share of [start, end) in sample k.
double overlap(double start, double end, int k)
{
    return std::max(0.0, std::min(end, k + 1.0) - std::max(start, static_cast<double>(k)));
}

/// One pixel by the definition, in double precision.
double definition(const CMemoryPixmap &from, int plane, double x0, double x1, double y0, double y1)
{
    const auto sample = [&](int y, int x) {
        const CRect r = from.Bounds();
        y = r.top + std::clamp<int>(y, 0, static_cast<int>(r.Height()) - 1);
        x = std::clamp<int>(x, 0, static_cast<int>(r.Width()) - 1);
        return from.GetDepth() == 8    ? from.Plane(plane).Row<std::uint8_t>(y)[x]
               : from.GetDepth() == 16 ? from.Plane(plane).Row<std::uint16_t>(y)[x]
                                       : static_cast<double>(from.Plane(plane).Row<float>(y)[x]);
    };
    // An interval below one sample interpolates: it is the mean over one sample's width around its middle.
    const auto widened = [](double &a, double &b) {
        if (b - a < 1.0)
        {
            const double middle = (a + b) / 2;
            a = middle - 0.5;
            b = middle + 0.5;
        }
    };
    widened(x0, x1);
    widened(y0, y1);
    double sum = 0.0;
    for (int y = static_cast<int>(std::floor(y0)); y < y1; ++y)
        for (int x = static_cast<int>(std::floor(x0)); x < x1; ++x)
            sum += sample(y, x) * overlap(x0, x1, x) * overlap(y0, y1, y);
    return sum / ((x1 - x0) * (y1 - y0));
}

TEST(PixmapScaler, IsTheDirectAverageWhateverTheParts)
{
    std::mt19937 random(5);
    for (const double reduction : {0.3, 0.77, 1.0, 1.01, 1.5, 2.0, 4.99, 17.3, 65.5, 100.0})
        for (const int depth : {8, 16, 32})
        {
            const int width = 101 + static_cast<int>(random() % 213), height = 97 + static_cast<int>(random() % 151);
            const CRect larger{-7, 3, -7 + width, 3 + height};
            const CRect own{11, -5, 11 + std::max(1, static_cast<int>(width / reduction)),
                            -5 + std::max(1, static_cast<int>(height / reduction))};
            CMemoryPixmap from(larger, depth, 2);
            for (int p = 0; p < 2; ++p)
                for (std::int32_t y = larger.top; y < larger.bottom; ++y)
                    for (int x = 0; x < width; ++x)
                        if (depth == 8)
                            from.Plane(p).Row<std::uint8_t>(y)[x] = static_cast<std::uint8_t>(random());
                        else if (depth == 16)
                            from.Plane(p).Row<std::uint16_t>(y)[x] = static_cast<std::uint16_t>(random() % 32769);
                        else
                            from.Plane(p).Row<float>(y)[x] = static_cast<float>(random() % 1000) / 999.0f;

            // In the parts of cells, each from no more than it asks for.
            const CPixScaler scaler(larger, own);
            EXPECT_EQ(scaler.FactorX(),
                      reduction <= 1.0
                          ? 1u
                          : std::min(128u, std::bit_ceil(static_cast<unsigned>(std::ceil(scaler.X().Factor())))));
            const std::int32_t side = 40;
            double worst = 0.0;
            std::int64_t pixels = 0;
            for (std::int32_t top = own.top; top < own.bottom; top += side)
                for (std::int32_t left = own.left; left < own.right; left += side)
                    for (std::uint32_t step = 0; step < scaler.Steps(); ++step)
                    {
                        const CRect cell = CRect{left, top, left + side, top + side}.Intersected(own);
                        const CRect part = scaler.Part(cell, side, step);
                        if (part.Empty())
                            continue;
                        const CRect area = scaler.SourceOf(part);
                        ASSERT_TRUE(larger.Contains(area));
                        EXPECT_TRUE(scaler.AreaOf(area).Contains(part));
                        CMemoryPixmap piece(area, depth, 3), to(part, depth, 2);
                        copyPlanes(piece, 1, from, 0, 2, area);
                        scaler.Scale(piece, 1, to, 0, 2);
                        pixels += part.Width() * part.Height();
                        const double fx = scaler.X().Factor(), fy = scaler.Y().Factor();
                        for (std::int32_t y = part.top; y < part.bottom; ++y)
                            for (std::int32_t x = part.left; x < part.right; ++x)
                            {
                                const double expected =
                                    definition(from, 1, (x - own.left) * fx, (x + 1 - own.left) * fx,
                                               (y - own.top) * fy, (y + 1 - own.top) * fy);
                                const CPixelArea plane = to.Plane(1);
                                const double got = depth == 8 ? plane.Row<std::uint8_t>(y)[x - part.left]
                                                   : depth == 16
                                                       ? plane.Row<std::uint16_t>(y)[x - part.left]
                                                       : static_cast<double>(plane.Row<float>(y)[x - part.left]);
                                worst = std::max(worst, std::abs(got - expected));
                            }
                    }
            EXPECT_EQ(pixels, own.Width() * own.Height()) << "every pixel once";
            EXPECT_LE(worst, depth == 8 ? 0.501 : depth == 16 ? 0.52 : 2e-6) << reduction << " at " << depth;
        }
}

TEST(PixmapScaler, AChangedSampleTouchesTheAreaThatIsTold)
{
    for (const std::int64_t to : {1, 3, 7, 20, 21, 33, 90})
    {
        const CScaleAxis axis(21, to);
        std::vector<float> weights(axis.MostWeights());
        for (std::int64_t i = 0; i < to; ++i)
        {
            const auto needed = axis.Needed({i, i + 1});
            const int count = axis.Weights(i, weights.data());
            float sum = 0.0f;
            for (int k = 0; k < count; ++k)
            {
                sum += weights[static_cast<std::size_t>(k)];
                const auto touched = axis.Touched({needed.first + k, needed.first + k + 1});
                EXPECT_TRUE(weights[static_cast<std::size_t>(k)] == 0.0f || (touched.first <= i && i < touched.end))
                    << to << ": " << i << " from " << needed.first + k;
            }
            EXPECT_NEAR(sum, 1.0f, 1e-6f);
        }
    }
}

} // namespace
