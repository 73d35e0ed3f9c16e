#include "tests/reference/direct.h"

#include <algorithm>
#include <cmath>
#include <numbers>

using namespace CorvaneDeblur;

namespace Reference
{
namespace
{

/// Sample (y, x) of a, also outside of it.
double sampleAt(const floatArray &a, int y, int x, borderMode border)
{
    if (border == borderMode::circular)
        return a.at((y % a.rows + a.rows) % a.rows, (x % a.cols + a.cols) % a.cols);
    if (border == borderMode::replicate)
        return a.at(std::clamp(y, 0, a.rows - 1), std::clamp(x, 0, a.cols - 1));
    return y < 0 || y >= a.rows || x < 0 || x >= a.cols ? 0.0 : a.at(y, x);
}

} // namespace

complexArray directDFT(const floatArray &a)
{
    const complexArray spectrum = complexArray::allocate(a.rows, halfSpectrumCols(a.cols));
    for (int v = 0; v < spectrum.rows; ++v)
        for (int u = 0; u < spectrum.cols; ++u)
        {
            double re = 0.0, im = 0.0;
            for (int y = 0; y < a.rows; ++y)
                for (int x = 0; x < a.cols; ++x)
                {
                    // Whole turns are taken off in integers, where they cost no precision.
                    const double turns =
                        static_cast<double>(v * y % a.rows) / a.rows + static_cast<double>(u * x % a.cols) / a.cols;
                    re += a.at(y, x) * std::cos(2.0 * std::numbers::pi * turns);
                    im -= a.at(y, x) * std::sin(2.0 * std::numbers::pi * turns);
                }
            spectrum.at(v, u) = {static_cast<float>(re), static_cast<float>(im)};
        }
    return spectrum;
}

floatArray directFilter(const floatArray &src, const floatArray &kernel, borderMode border, filterKind kind)
{
    const int sign = kind == filterKind::convolution ? -1 : 1;
    const floatArray out = floatArray::allocate(src.rows, src.cols);
    for (int y = 0; y < src.rows; ++y)
        for (int x = 0; x < src.cols; ++x)
        {
            double sum = 0.0;
            for (int r = 0; r < kernel.rows; ++r)
                for (int c = 0; c < kernel.cols; ++c)
                    sum +=
                        static_cast<double>(kernel.at(r, c)) * sampleAt(src, y + sign * (r - (kernel.rows - 1) / 2),
                                                                        x + sign * (c - (kernel.cols - 1) / 2), border);
            out.at(y, x) = static_cast<float>(sum);
        }
    return out;
}

floatArray directBoxSum(const floatArray &a, int radiusRows, int radiusCols)
{
    const floatArray out = floatArray::allocate(a.rows, a.cols);
    for (int y = 0; y < a.rows; ++y)
        for (int x = 0; x < a.cols; ++x)
        {
            double sum = 0.0;
            for (int r = -radiusRows; r <= radiusRows; ++r)
                for (int c = -radiusCols; c <= radiusCols; ++c)
                    sum += sampleAt(a, y + r, x + c, borderMode::constant);
            out.at(y, x) = static_cast<float>(sum);
        }
    return out;
}

} // namespace Reference
