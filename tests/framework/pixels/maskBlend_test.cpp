#include "framework/pixels/maskBlend.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstring>
#include <random>

namespace
{

using namespace Sarnik;

template <class Sample> void expectBlend(int depth, double full)
{
    SCOPED_TRACE(depth);
    const CRect wide{-3, 5, 80, 40}, own{2, 9, 77, 33};
    CMemoryPixmap source(wide, depth, 3), result(own, depth, 2);
    std::mt19937 random(5);
    const auto sample = [&] {
        const double v = static_cast<double>(random() % 32769) / 32768;
        return static_cast<Sample>(depth == 32 ? v * 1.5 : v * full);
    };
    for (std::int32_t y = wide.top; y < wide.bottom; ++y)
        for (int i = 0; i < wide.Width(); ++i)
        {
            const auto m = random() % 4;
            source.Plane(0).template Row<Sample>(y)[i] = sample();
            source.Plane(1).template Row<Sample>(y)[i] = sample();
            source.Plane(2).template Row<Sample>(y)[i] =
                static_cast<Sample>(m == 0   ? 0
                                    : m == 1 ? full
                                             : full * static_cast<double>(random() % 256) / 255);
        }
    for (int p = 0; p < 2; ++p)
        for (std::int32_t y = own.top; y < own.bottom; ++y)
            for (int i = 0; i < own.Width(); ++i)
                result.Plane(p).template Row<Sample>(y)[i] = sample();
    CMemoryPixmap before(own, depth, 2);
    copyPlanes(before, 0, result, 0, 2, own);

    blendByMask(result, source, 2, 2);
    for (int p = 0; p < 2; ++p)
        for (std::int32_t y = own.top; y < own.bottom; ++y)
            for (int i = 0; i < own.Width(); ++i)
            {
                const Sample s = source.Plane(p).template Row<Sample>(y)[i + 5],
                             r = before.Plane(p).template Row<Sample>(y)[i];
                const double m = source.Plane(2).template Row<Sample>(y)[i + 5] / full;
                const Sample got = result.Plane(p).template Row<Sample>(y)[i];
                if (m == 0 || m == 1)
                    ASSERT_EQ(got, m == 0 ? s : r) << "bit for bit";
                else
                {
                    // Truncated in single precision: a value on the step may fall to either side.
                    const double mixed = (1 - m) * s + m * r;
                    ASSERT_LE(got, mixed + 1e-3);
                    ASSERT_GT(got, mixed - (depth == 32 ? 1e-5 : 1.01));
                }
            }
}

TEST(MaskBlend, KeepsBothEndsAndMixesBetween)
{
    expectBlend<std::uint8_t>(8, 255);
    expectBlend<std::uint16_t>(16, 32768);
    expectBlend<float>(32, 1);
    CMemoryPixmap a(4, 4, 64, 2), b(4, 4, 64, 2), c(4, 4, 8, 2);
    EXPECT_THROW(blendByMask(a, b, 1, 1), std::invalid_argument);
    EXPECT_THROW(blendByMask(a, c, 1, 1), std::invalid_argument);
}

} // namespace
