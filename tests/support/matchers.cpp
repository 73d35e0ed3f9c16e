#include "tests/support/matchers.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <cstdint>
#include <limits>
#include <vector>

using CorvaneDeblur::floatArray;

namespace TestSupport
{
namespace
{

double distance(float a, float b)
{
    if (a == b)
        return 0.0;
    const double d = std::abs(static_cast<double>(a) - static_cast<double>(b));
    return std::isfinite(d) ? d : std::numeric_limits<double>::infinity();
}

testing::AssertionResult sameShape(const floatArray &actual, const floatArray &expected)
{
    if (actual.sameShape(expected))
        return testing::AssertionSuccess();
    return testing::AssertionFailure() << "shape " << actual.rows << " x " << actual.cols << ", expected "
                                       << expected.rows << " x " << expected.cols;
}

testing::AssertionResult describe(const arrayDifference &d, const floatArray &actual, const floatArray &expected)
{
    return testing::AssertionFailure() << "worst at row " << d.worstRow << ", column " << d.worstCol << " of "
                                       << actual.rows << " x " << actual.cols << ": "
                                       << actual.at(d.worstRow, d.worstCol) << ", expected "
                                       << expected.at(d.worstRow, d.worstCol) << " (off by " << d.max << "); rms "
                                       << d.rms << ", 99.9 % within " << d.percentile999 << ", share outside "
                                       << d.shareOutside;
}

} // namespace

arrayDifference differenceOf(const floatArray &actual, const floatArray &expected, double limit)
{
    arrayDifference d;
    std::vector<double> distances;
    double squares = 0.0;
    std::size_t outside = 0;
    for (int y = 0; y < actual.rows; ++y)
        for (int x = 0; x < actual.cols; ++x)
        {
            const double off = distance(actual.at(y, x), expected.at(y, x));
            if (off > d.max)
            {
                d.max = off;
                d.worstRow = y;
                d.worstCol = x;
            }
            squares += off * off;
            outside += off > limit;
            distances.push_back(off);
        }
    if (distances.empty())
        return d;
    const auto count = static_cast<double>(distances.size());
    d.rms = std::sqrt(squares / count);
    d.shareOutside = static_cast<double>(outside) / count;
    const auto nth = distances.begin() + static_cast<std::ptrdiff_t>(0.999 * (count - 1.0));
    std::nth_element(distances.begin(), nth, distances.end());
    d.percentile999 = *nth;
    return d;
}

testing::AssertionResult arrayNear(const floatArray &actual, const floatArray &expected, double max,
                                   double shareOutside)
{
    if (const auto shape = sameShape(actual, expected); !shape)
        return shape;
    const arrayDifference d = differenceOf(actual, expected, max);
    if (d.shareOutside <= shareOutside)
        return testing::AssertionSuccess();
    return describe(d, actual, expected) << "; allowed " << max << ", share " << shareOutside;
}

testing::AssertionResult arrayWithin(const floatArray &actual, const floatArray &expected, double max, double rms,
                                     double percentile999)
{
    if (const auto shape = sameShape(actual, expected); !shape)
        return shape;
    const arrayDifference d = differenceOf(actual, expected, max);
    const auto kept = [](double value, double bound) { return bound == 0.0 || value <= bound; };
    if (kept(d.max, max) && kept(d.rms, rms) && kept(d.percentile999, percentile999))
        return testing::AssertionSuccess();
    return describe(d, actual, expected) << "; allowed " << max << ", rms " << rms << ", 99.9 % " << percentile999;
}

testing::AssertionResult arrayIdentical(const floatArray &actual, const floatArray &expected)
{
    if (const auto shape = sameShape(actual, expected); !shape)
        return shape;
    for (int y = 0; y < actual.rows; ++y)
        for (int x = 0; x < actual.cols; ++x)
            if (std::bit_cast<std::uint32_t>(actual.at(y, x)) != std::bit_cast<std::uint32_t>(expected.at(y, x)))
                return describe(differenceOf(actual, expected, 0.0), actual, expected)
                       << "; first different bits at row " << y << ", column " << x;
    return testing::AssertionSuccess();
}

double kernelCorrelation(const floatArray &a, const floatArray &b, int largestShift)
{
    const auto energy = [](const floatArray &kernel) {
        double sum = 0.0;
        for (int y = 0; y < kernel.rows; ++y)
            for (int x = 0; x < kernel.cols; ++x)
                sum += static_cast<double>(kernel.at(y, x)) * kernel.at(y, x);
        return sum;
    };
    const double aa = energy(a), bb = energy(b);
    if (aa == 0.0 || bb == 0.0)
        return 0.0;

    double best = -std::numeric_limits<double>::infinity();
    for (int dy = -largestShift; dy <= largestShift; ++dy)
        for (int dx = -largestShift; dx <= largestShift; ++dx)
        {
            const int top = (b.rows - 1) / 2 - (a.rows - 1) / 2 + dy; // row of b under row 0 of a
            const int left = (b.cols - 1) / 2 - (a.cols - 1) / 2 + dx;
            double ab = 0.0;
            for (int y = std::max(0, -top); y < std::min(a.rows, b.rows - top); ++y)
                for (int x = std::max(0, -left); x < std::min(a.cols, b.cols - left); ++x)
                    ab += static_cast<double>(a.at(y, x)) * b.at(y + top, x + left);
            best = std::max(best, ab / std::sqrt(aa * bb));
        }
    return best;
}

} // namespace TestSupport
