#include "deblur/deconv/shrinkageTable.h"

#include <tbb/blocked_range.h>
#include <tbb/parallel_for.h>
#include <tbb/task_arena.h>

#include <cmath>

/// The minimum over w of |w|^alpha + (beta / 2) (w - v)^2 for v >= 0. Where it is not 0 it lies in (0, v] and is the
/// larger zero of the derivative,
///     alpha w^(alpha - 1) + beta (w - v) = 0,
/// taken only above 2 (1 - alpha) / (2 - alpha) v, the point where it becomes a better choice than 0. (D. Krishnan and
/// R. Fergus, "Fast image deconvolution using hyper-Laplacian priors", NIPS 2009.)
///
/// For alpha = 2/3 and 1/2 the derivative is a polynomial in the root s = w^(1/3) or w^(1/2). It is convex, so Newton's
/// method started at w = v runs down to the larger zero without overshooting; the zero is simple all the way to the
/// threshold, and rootSteps steps reach the last bit of a double. That is the same value as the closed solutions of the
/// quartic and the cubic, without their cancellations.
namespace CorvaneDeblur
{
namespace
{

constexpr int rootSteps = 9;
constexpr int middle = shrinkageTableEntries / 2;

bool sameExponent(float a, float b)
{
    return std::fabs(a - b) < 1.1920929e-07f;
}

double softThreshold(double v, double beta)
{
    const double w = v - 1.0 / beta;
    return w > 0.0 ? w : 0.0;
}

/// s^4 - v s + 2 / (3 beta) = 0 with w = s^3, for w > v / 2.
double minimumFor23(double v, double beta)
{
    const double c = 2.0 / (3.0 * beta);
    // At w = v / 2 the derivative must be negative, or there is no zero beyond.
    if (v * v * v * v <= 16.0 * c * c * c)
        return 0.0;
    double s = std::cbrt(v);
    for (int i = 0; i < rootSteps; ++i)
        s -= ((s * s * s - v) * s + c) / (4.0 * s * s * s - v);
    return s * s * s;
}

/// s^3 - v s + 1 / (2 beta) = 0 with w = s^2, for w > 2 v / 3.
double minimumFor12(double v, double beta)
{
    const double c = 1.0 / (2.0 * beta);
    if (2.0 * v * v * v <= 27.0 * c * c)
        return 0.0;
    double s = std::sqrt(v);
    for (int i = 0; i < rootSteps; ++i)
        s -= ((s * s - v) * s + c) / (3.0 * s * s - v);
    return s * s;
}

double newtonMinimum(double v, double beta, double a)
{
    double w = v;
    for (int i = 0; i < 4; ++i)
    {
        const double m = std::fabs(w), sign = w < 0.0 ? -1.0 : 1.0;
        w -= (sign * a * std::pow(m, a - 1.0) + beta * (w - v)) / ((a - 1.0) * a * std::pow(m, a - 2.0) + beta);
    }
    if (std::isnan(w))
        return 0.0;
    const bool beatsZero = 0.5 * beta * v * v > std::pow(std::fabs(w), a) + 0.5 * beta * (w - v) * (w - v);
    return beatsZero ? w : 0.0;
}

/// Both halves of a table from a solver for v >= 0.
template <typename Solver> shrinkageTable fillOdd(const Solver &solver)
{
    shrinkageTable table(shrinkageTableEntries);
    const auto fillRange = [&](const tbb::blocked_range<int> &range) {
        const Solver solve = solver;
        float *const centre = table.data() + middle;
        for (int i = range.begin(), end = range.end(); i < end; ++i)
        {
            const float v = static_cast<float>(i) / 100000.0f * 10.0f;
            const float w = static_cast<float>(solve(static_cast<double>(v)));
            centre[i] = w;
            centre[-i] = 0.0f - w;
        }
    };
    tbb::this_task_arena::isolate([&] { tbb::parallel_for(tbb::blocked_range<int>(0, middle + 1, 2048), fillRange); });
    return table;
}

} // namespace

shrinkageTable buildShrinkageTable(float beta, float alpha)
{
    const double b = static_cast<double>(beta);
    if (sameExponent(alpha, 1.0f))
        return fillOdd([b](double v) { return softThreshold(v, b); });
    if (sameExponent(alpha, 2.0f / 3.0f))
        return fillOdd([b](double v) { return minimumFor23(v, b); });
    if (sameExponent(alpha, 0.5f))
        return fillOdd([b](double v) { return minimumFor12(v, b); });
    const double a = static_cast<double>(alpha);
    return fillOdd([a, b](double v) { return newtonMinimum(v, b, a); });
}

} // namespace CorvaneDeblur
