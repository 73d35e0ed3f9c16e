#include "stages/displayConversion.h"

#include "framework/pixels/toGrey.h"

#include <algorithm>
#include <cmath>
#include <vector>

namespace Project
{

using Sarnik::CMemoryPixmap;
using Sarnik::CPixelKind;
using Sarnik::CRect;

namespace
{

struct rgbBytes
{
    std::uint32_t r = 0, g = 0, b = 0;
};

std::uint32_t toByte(std::uint8_t v)
{
    return v;
}
/// The host's range: 32768 is full.
std::uint32_t toByte(std::uint16_t v)
{
    return (std::min<std::uint32_t>(v, 32768u) * 255u + 16384u) >> 15;
}
std::uint32_t toByte(float v)
{
    return v > 0.0f ? static_cast<std::uint32_t>(std::min(v, 1.0f) * 255.0f + 0.5f) : 0u; // no number is black
}

/// One channel of sRGB from linear light (IEC 61966-2-1).
std::uint32_t gammaByte(float linear)
{
    const float v = linear <= 0.0031308f ? 12.92f * linear : 1.055f * std::pow(linear, 1.0f / 2.4f) - 0.055f;
    return toByte(v);
}

/// CIE L*a*b* over the white of D50, a and b from -128 on as hosts store them, to sRGB by the matrix adapted to D50.
rgbBytes labToRgb(std::uint32_t lByte, std::uint32_t aByte, std::uint32_t bByte)
{
    const float fy = (static_cast<float>(lByte) * (100.0f / 255.0f) + 16.0f) / 116.0f;
    const float fx = fy + (static_cast<float>(aByte) - 128.0f) / 500.0f;
    const float fz = fy - (static_cast<float>(bByte) - 128.0f) / 200.0f;
    const auto cubed = [](float t) { return t > 6.0f / 29.0f ? t * t * t : (t - 4.0f / 29.0f) * (108.0f / 841.0f); };
    const float x = 0.9642f * cubed(fx), y = cubed(fy), z = 0.8249f * cubed(fz);
    return {gammaByte(3.1339f * x - 1.6169f * y - 0.4906f * z), gammaByte(-0.9788f * x + 1.9161f * y + 0.0335f * z),
            gammaByte(0.0719f * x - 0.2290f * y + 1.4052f * z)};
}

/// Samples that hold how much ink is missing, as hosts store them.
rgbBytes inksToRgb(std::uint32_t c, std::uint32_t m, std::uint32_t y, std::uint32_t k)
{
    return {c * k / 255u, m * k / 255u, y * k / 255u};
}

constexpr int squareLog = 3; ///< squares of 8 pixels
constexpr std::uint32_t lightSquare = 255, darkSquare = 204;

std::uint32_t overSquare(std::uint32_t pixel, std::uint32_t square, std::uint32_t alpha)
{
    const auto mixed = [=](int shift) {
        return ((pixel >> shift & 255u) * alpha + square * (255u - alpha) + 127u) / 255u << shift;
    };
    return 0xFF000000u | mixed(16) | mixed(8) | mixed(0);
}

/// Plain loops for what most pictures are; the rest pixel by pixel.
template <class Sample> class rowConverter
{
public:
    rowConverter(const PDisplayFormat &what, CMemoryPixmap &pixels) : about(what), from(pixels) {}

    void Convert(std::int32_t y, std::int32_t left, std::int32_t right, std::uint32_t *out)
    {
        const CRect all = from.Bounds();
        const int planes = about.format.planes;
        const auto n = static_cast<std::size_t>(right - left);
        for (std::size_t p = 0; p < 5 && static_cast<int>(p) < from.GetPlaneCount(); ++p)
            rows[p] = from.Plane(static_cast<int>(p)).template Row<const Sample>(y) + (left - all.left);
        if (planes < 3)
            Fill(n, out, [this](std::size_t i) {
                const std::uint32_t grey = toByte(rows[0][i]);
                return rgbBytes{grey, grey, grey};
            });
        else if (planes >= 4)
            FillFromInks(n, out);
        else if (about.format.kind == CPixelKind::lab)
            Fill(n, out, [this](std::size_t i) {
                return labToRgb(toByte(rows[0][i]), toByte(rows[1][i]), toByte(rows[2][i]));
            });
        else
            Fill(n, out, [this](std::size_t i) {
                return rgbBytes{toByte(rows[0][i]), toByte(rows[1][i]), toByte(rows[2][i])};
            });
        if (about.transparency)
            for (std::size_t i = 0; i < n; ++i)
            {
                const std::int32_t x = left + static_cast<std::int32_t>(i);
                const std::uint32_t square = (((x >> squareLog) + (y >> squareLog)) & 1) ? darkSquare : lightSquare;
                out[i] = overSquare(out[i], square, toByte(rows[planes][i]));
            }
    }

private:
    template <class Pixel> void Fill(std::size_t n, std::uint32_t *out, Pixel pixelAt)
    {
        for (std::size_t i = 0; i < n; ++i)
        {
            const rgbBytes pixel = pixelAt(i);
            out[i] = 0xFF000000u | pixel.r << 16 | pixel.g << 8 | pixel.b;
        }
    }

    void FillFromInks(std::size_t n, std::uint32_t *out)
    {
        if constexpr (!std::is_same_v<Sample, float>)
            if (about.converter != nullptr)
            {
                quads.resize(4 * n);
                for (std::size_t i = 0; i < n; ++i)
                    for (std::size_t p = 0; p < 4; ++p)
                        quads[4 * i + p] = rows[p][i];
                about.converter->CmykToRgb(quads.data(), n);
                return Fill(n, out, [this](std::size_t i) {
                    const Sample *q = quads.data() + 4 * i;
                    return rgbBytes{toByte(q[0]), toByte(q[1]), toByte(q[2])};
                });
            }
        Fill(n, out, [this](std::size_t i) {
            return inksToRgb(toByte(rows[0][i]), toByte(rows[1][i]), toByte(rows[2][i]), toByte(rows[3][i]));
        });
    }

    const PDisplayFormat &about;
    CMemoryPixmap &from;
    const Sample *rows[5] = {}; ///< of the current row, from its first wanted sample on
    std::vector<Sample> quads;
};

template <class Sample> void convertAll(const PDisplayFormat &about, CMemoryPixmap &from, CMemoryPixmap &to)
{
    rowConverter<Sample> rows(about, from);
    const CRect area = to.Bounds();
    for (std::int32_t y = area.top; y < area.bottom; ++y)
        rows.Convert(y, area.left, area.right, to.Plane(0).Row<std::uint32_t>(y));
}

} // namespace

void ConvertForDisplay(const PDisplayFormat &about, CMemoryPixmap &from, CMemoryPixmap &to)
{
    if (from.GetDepth() == 8)
        convertAll<std::uint8_t>(about, from, to);
    else if (from.GetDepth() == 16)
        convertAll<std::uint16_t>(about, from, to);
    else
        convertAll<float>(about, from, to);
}

} // namespace Project
