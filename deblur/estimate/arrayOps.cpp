#include "deblur/estimate/arrayOps.h"

#include "platform/math/vectorOps.h"

#include <algorithm>
#include <cmath>

namespace CorvaneDeblur
{
namespace
{

constexpr float smallestNormal = 1.1754944e-38f;

template <typename Sample> bool compact(const sampleArray<Sample> &a)
{
    return a.stride == a.cols;
}

/// Calls body(n, row pointers...) for every row, or once for the whole when no array has gaps between its rows.
template <typename Body, typename First, typename... Others>
void forRows(const Body &body, const First &first, const Others &...others)
{
    assert((first.sameShape(others) && ...));
    if (compact(first) && (compact(others) && ...))
        body(static_cast<std::size_t>(first.rows) * static_cast<std::size_t>(first.cols), first.data, others.data...);
    else
        for (int y = 0; y < first.rows; ++y)
            body(static_cast<std::size_t>(first.cols), first.row(y), others.row(y)...);
}

} // namespace

void fill(const floatArray &a, float value)
{
    forRows([&](std::size_t n, float *p) { std::fill_n(p, n, value); }, a);
}

void fill(const complexArray &a, complexSample value)
{
    forRows([&](std::size_t n, complexSample *p) { std::fill_n(p, n, value); }, a);
}

void copyTo(const floatArray &src, const floatArray &dst)
{
    assert(dst.rows >= src.rows && dst.cols >= src.cols);
    for (int y = 0; y < src.rows; ++y)
        std::copy_n(src.row(y), src.cols, dst.row(y));
}

floatArray cloned(const floatArray &src)
{
    const floatArray dst = floatArray::allocate(src.rows, src.cols);
    copyTo(src, dst);
    return dst;
}

void scaleInto(const floatArray &a, const floatArray &dst, float factor)
{
    forRows([&](std::size_t n, const float *p, float *q) { sscal(n, factor, p, q); }, a, dst);
}

void combine(float alpha, const floatArray &a, float beta, const floatArray &b, const floatArray &out)
{
    forRows([&](std::size_t n, const float *p, const float *q, float *r) { saxpby(n, alpha, p, beta, q, r); }, a, b,
            out);
}

void multiplyInto(const floatArray &a, const floatArray &b, const floatArray &out, float factor)
{
    forRows([&](std::size_t n, const float *p, const float *q, float *r) { vsMul(n, p, q, r); }, a, b, out);
    if (factor != 1.0f)
        scaleInto(out, out, factor);
}

void subtractInto(const floatArray &a, const floatArray &b, const floatArray &out)
{
    forRows([](std::size_t n, const float *p, const float *q, float *r) { vsSub(n, p, q, r); }, a, b, out);
}

void addInto(const floatArray &a, const floatArray &b, const floatArray &out)
{
    forRows([](std::size_t n, const float *p, const float *q, float *r) { vsAdd(n, p, q, r); }, a, b, out);
}

// Sums go row by row whatever the stride, so that a view and its compact copy give the same value.
float dot(const floatArray &a, const floatArray &b)
{
    assert(a.sameShape(b));
    float sum = 0.0f;
    for (int y = 0; y < a.rows; ++y)
        sum += sdot(static_cast<std::size_t>(a.cols), a.row(y), b.row(y));
    return sum;
}

float sumAbs(const floatArray &a)
{
    float sum = 0.0f;
    for (int y = 0; y < a.rows; ++y)
        sum += sasum(static_cast<std::size_t>(a.cols), a.row(y));
    return sum;
}

float peak(const floatArray &a)
{
    float most = smallestNormal;
    for (int y = 0; y < a.rows; ++y)
        most = smax(static_cast<std::size_t>(a.cols), a.row(y), most);
    return most;
}

float peakAbs(const floatArray &a)
{
    float best = 0.0f;
    for (int y = 0; y < a.rows && a.cols > 0; ++y)
    {
        const float candidate = a.row(y)[isamax(static_cast<std::size_t>(a.cols), a.row(y))];
        if (std::fabs(candidate) > std::fabs(best))
            best = candidate;
    }
    return best;
}

void signInto(const floatArray &a, const floatArray &out)
{
    forRows(
        [](std::size_t n, const float *p, float *q) {
            for (std::size_t i = 0; i < n; ++i)
                q[i] = static_cast<float>((p[i] > 0.0f) - (p[i] < 0.0f));
        },
        a, out);
}

void normaliseSum(const floatArray &a)
{
    float sum = sumAbs(a);
    if (sum == 0.0f)
        sum = 1.0f;
    scaleInto(a, a, 1.0f / sum);
}

void thresholdInto(const floatArray &a, const floatArray &out, float t)
{
    forRows(
        [&](std::size_t n, const float *p, float *q) {
            for (std::size_t i = 0; i < n; ++i)
                q[i] = p[i] > t ? p[i] : 0.0f;
        },
        a, out);
}

void multiplySpectrumByReal(const complexArray &c, const floatArray &r, const complexArray &out)
{
    forRows([](std::size_t n, const complexSample *p, const float *q, complexSample *o) { vcMulByReal(n, p, q, o); }, c,
            r, out);
}

void multiplySpectra(const complexArray &a, const complexArray &b, const complexArray &out, complexSample scale)
{
    forRows([&](std::size_t n, const complexSample *p, const complexSample *q,
                complexSample *o) { vcMul(n, p, q, scale, o); },
            a, b, out);
}

void multiplySpectrumByConj(const complexArray &a, const complexArray &b, const complexArray &out)
{
    forRows([](std::size_t n, const complexSample *p, const complexSample *q,
               complexSample *o) { vcMulByConj(n, p, q, o); },
            a, b, out);
}

void realPartInto(const complexArray &c, const floatArray &out, complexPart part)
{
    for (int y = 0; y < c.rows; ++y)
        for (int x = 0; x < c.cols; ++x)
            out.row(y)[x] = part == complexPart::real ? c.row(y)[x].re : c.row(y)[x].im;
}

} // namespace CorvaneDeblur
