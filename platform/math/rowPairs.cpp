#include "platform/math/rowPairs.h"

#include "platform/math/linePlans.h"
#include "platform/math/multiversion.h"

#include <algorithm>

namespace CorvaneDeblur
{

STILLMARK_MULTIVERSION
void packRows(const float *a, const float *b, int count, complexSample *line, int cols)
{
    if (b)
        for (int k = 0; k < count; ++k)
            line[k] = {a[k], b[k]};
    else
        for (int k = 0; k < count; ++k)
            line[k] = {a[k], 0.0f};
    for (int k = count; k < cols; ++k)
        line[k] = {0.0f, 0.0f};
}

STILLMARK_MULTIVERSION
void unpackRows(const complexSample *line, float *a, float *b, int count, float scale)
{
    if (b)
        for (int k = 0; k < count; ++k)
        {
            a[k] = line[k].re * scale;
            b[k] = line[k].im * scale;
        }
    else
        for (int k = 0; k < count; ++k)
            a[k] = line[k].re * scale;
}

// With Z the transform of a + ib, and M = Z at the mirrored frequency: A = (Z + conj M) / 2, B = (Z - conj M) / 2i.
static inline void splitPiece(const complexSample *__restrict z, const complexSample *__restrict mirror,
                              complexSample *__restrict a, complexSample *__restrict b)
{
    for (int j = 0; j < columnLanes; ++j)
    {
        const float zr = z[j].re, zi = z[j].im, mr = mirror[-j].re, mi = mirror[-j].im;
        a[j] = {0.5f * (zr + mr), 0.5f * (zi - mi)};
        b[j] = {0.5f * (zi + mi), 0.5f * (mr - zr)};
    }
}

STILLMARK_MULTIVERSION
void splitSpectra(const complexSample *line, int cols, complexSample *halfA, complexSample *halfB,
                  std::ptrdiff_t pieceStride)
{
    complexSample unused[columnLanes];
    const int half = cols / 2 + 1;
    const auto one = [&](int k, complexSample *a, complexSample *b) {
        const complexSample z = line[k], m = line[k == 0 ? 0 : cols - k];
        *a = {0.5f * (z.re + m.re), 0.5f * (z.im - m.im)};
        *b = {0.5f * (z.im + m.im), 0.5f * (m.re - z.re)};
    };
    for (int first = 0; first < half; first += columnLanes)
    {
        complexSample *a = halfA + first / columnLanes * pieceStride;
        complexSample *b = halfB ? halfB + first / columnLanes * pieceStride : unused;
        if (first > 0 && first + columnLanes <= half)
        {
            splitPiece(line + first, line + cols - first, a, b);
            continue;
        }
        const int count = std::min(columnLanes, half - first);
        for (int j = 0; j < count; ++j)
            one(first + j, a + j, b + j);
        for (int j = count; j < columnLanes; ++j)
            a[j] = b[j] = {0.0f, 0.0f};
    }
}

static inline void joinPiece(const complexSample *__restrict a, const complexSample *__restrict b,
                             complexSample *__restrict z, complexSample *__restrict mirror)
{
    for (int j = 0; j < columnLanes; ++j)
    {
        const float ar = a[j].re, ai = a[j].im, br = b[j].re, bi = b[j].im;
        z[j] = {ar - bi, ai + br};
        mirror[-j] = {ar + bi, br - ai};
    }
}

STILLMARK_MULTIVERSION
void joinSpectra(const complexSample *halfA, const complexSample *halfB, std::ptrdiff_t pieceStride, int cols,
                 complexSample *line)
{
    static constexpr complexSample zeros[columnLanes] = {};
    const int half = cols / 2 + 1;
    for (int first = 0; first < half; first += columnLanes)
    {
        const complexSample *a = halfA + first / columnLanes * pieceStride;
        const complexSample *b = halfB ? halfB + first / columnLanes * pieceStride : zeros;
        // A whole piece whose mirror images lie strictly behind it.
        if (first > 0 && 2 * (first + columnLanes - 1) < cols)
        {
            joinPiece(a, b, line + first, line + cols - first);
            continue;
        }
        const int count = std::min(columnLanes, half - first);
        for (int j = 0; j < count; ++j)
        {
            const int k = first + j;
            if (k == 0 || 2 * k == cols)
            {
                line[k] = {a[j].re, b[j].re};
                continue;
            }
            line[k] = {a[j].re - b[j].im, a[j].im + b[j].re};
            line[cols - k] = {a[j].re + b[j].im, b[j].re - a[j].im};
        }
    }
}

} // namespace CorvaneDeblur
