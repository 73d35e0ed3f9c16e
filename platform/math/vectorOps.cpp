#include "platform/math/vectorOps.h"

#include "platform/math/fastExp.h"
#include "platform/math/multiversion.h"

#include <cmath>

namespace CorvaneDeblur
{
namespace
{

constexpr std::size_t lanes = 8;

float sumOfLanes(const float *partial)
{
    float sum = 0.0f;
    for (std::size_t j = 0; j < lanes; ++j)
        sum += partial[j];
    return sum;
}

} // namespace

STILLMARK_MULTIVERSION
void vsAdd(std::size_t n, const float *a, const float *b, float *out)
{
    for (std::size_t i = 0; i < n; ++i)
        out[i] = a[i] + b[i];
}

STILLMARK_MULTIVERSION
void vsSub(std::size_t n, const float *a, const float *b, float *out)
{
    for (std::size_t i = 0; i < n; ++i)
        out[i] = a[i] - b[i];
}

STILLMARK_MULTIVERSION
void vsMul(std::size_t n, const float *a, const float *b, float *out)
{
    for (std::size_t i = 0; i < n; ++i)
        out[i] = a[i] * b[i];
}

STILLMARK_MULTIVERSION
void vsHypot(std::size_t n, const float *a, const float *b, float *out)
{
    for (std::size_t i = 0; i < n; ++i)
        out[i] = std::sqrt(a[i] * a[i] + b[i] * b[i]);
}

STILLMARK_MULTIVERSION
void vsExp(std::size_t n, const float *a, float *out)
{
    for (std::size_t i = 0; i < n; ++i)
        out[i] = fastExp(a[i]);
}

STILLMARK_MULTIVERSION
void sscal(std::size_t n, float factor, const float *a, float *out)
{
    for (std::size_t i = 0; i < n; ++i)
        out[i] = factor * a[i];
}

STILLMARK_MULTIVERSION
void saxpy(std::size_t n, float factor, const float *x, float *y)
{
    for (std::size_t i = 0; i < n; ++i)
        y[i] += factor * x[i];
}

STILLMARK_MULTIVERSION
void saxpby(std::size_t n, float alpha, const float *a, float beta, const float *b, float *out)
{
    for (std::size_t i = 0; i < n; ++i)
        out[i] = alpha * a[i] + beta * b[i];
}

STILLMARK_MULTIVERSION
float sdot(std::size_t n, const float *a, const float *b)
{
    float partial[lanes] = {};
    std::size_t i = 0;
    for (; i + lanes <= n; i += lanes)
        for (std::size_t j = 0; j < lanes; ++j)
            partial[j] += a[i + j] * b[i + j];
    for (; i < n; ++i)
        partial[i % lanes] += a[i] * b[i];
    return sumOfLanes(partial);
}

STILLMARK_MULTIVERSION
float sasum(std::size_t n, const float *a)
{
    float partial[lanes] = {};
    std::size_t i = 0;
    for (; i + lanes <= n; i += lanes)
        for (std::size_t j = 0; j < lanes; ++j)
            partial[j] += std::fabs(a[i + j]);
    for (; i < n; ++i)
        partial[i % lanes] += std::fabs(a[i]);
    return sumOfLanes(partial);
}

std::size_t isamax(std::size_t n, const float *a)
{
    std::size_t best = 0;
    for (std::size_t i = 1; i < n; ++i)
        if (std::fabs(a[i]) > std::fabs(a[best]))
            best = i;
    return best;
}

STILLMARK_MULTIVERSION
float smax(std::size_t n, const float *a, float least)
{
    float partial[lanes];
    for (float &p : partial)
        p = least;
    std::size_t i = 0;
    for (; i + lanes <= n; i += lanes)
        for (std::size_t j = 0; j < lanes; ++j)
            partial[j] = a[i + j] > partial[j] ? a[i + j] : partial[j];
    float most = least;
    for (; i < n; ++i)
        most = a[i] > most ? a[i] : most;
    for (float p : partial)
        most = p > most ? p : most;
    return most;
}

STILLMARK_MULTIVERSION
void vcMulByConj(std::size_t n, const complexSample *a, const complexSample *b, complexSample *out)
{
    for (std::size_t i = 0; i < n; ++i)
        out[i] = a[i] * conj(b[i]);
}

STILLMARK_MULTIVERSION
void vcMul(std::size_t n, const complexSample *a, const complexSample *b, complexSample scale, complexSample *out)
{
    for (std::size_t i = 0; i < n; ++i)
        out[i] = a[i] * b[i] * scale;
}

STILLMARK_MULTIVERSION
void vcMulByReal(std::size_t n, const complexSample *c, const float *r, complexSample *out)
{
    for (std::size_t i = 0; i < n; ++i)
        out[i] = c[i] * r[i];
}

} // namespace CorvaneDeblur
