#include "framework/pixels/greyRows.h"

#include "framework/pixels/sixteenBit.h"
#include "platform/math/multiversion.h"

// The bodies are templates that are inlined into one function a type, since what is marked below is compiled for
// several processors and what it calls is not.
#define ROW_BODY [[gnu::always_inline]] inline void

namespace Sarnik
{
namespace
{

constexpr double redWeight = 0.299f, greenWeight = 0.587f, blueWeight = 0.114f;

constexpr double rangeOf(std::uint8_t)
{
    return 255.0;
}
constexpr double rangeOf(std::uint16_t)
{
    return 65535.0;
}
constexpr double rangeOf(float)
{
    return 1.0;
}

[[gnu::always_inline]] inline double valueOf(std::uint8_t s)
{
    return s;
}
[[gnu::always_inline]] inline double valueOf(std::uint16_t s)
{
    return static_cast<int>(expandSample(s));
}
[[gnu::always_inline]] inline double valueOf(float s)
{
    return s;
}

template <int stride, class Sample>
ROW_BODY rgbBody(std::size_t n, const Sample *__restrict r, const Sample *__restrict g, const Sample *__restrict b,
                 double *__restrict grey)
{
    for (std::size_t i = 0; i < n; ++i)
        grey[i] = (valueOf(r[i * stride]) * redWeight + valueOf(g[i * stride]) * greenWeight +
                   valueOf(b[i * stride]) * blueWeight) /
                  rangeOf(Sample());
}

template <class Sample> ROW_BODY planeBody(std::size_t n, const Sample *__restrict plane, double *__restrict grey)
{
    for (std::size_t i = 0; i < n; ++i)
        grey[i] = valueOf(plane[i]) / rangeOf(Sample());
}

template <class Sample>
ROW_BODY markBody(std::size_t n, const Sample *__restrict plane, Sample limit, std::uint8_t *__restrict mask)
{
    for (std::size_t i = 0; i < n; ++i)
        mask[i] = static_cast<std::uint8_t>(mask[i] | (plane[i] > limit ? 1 : 0));
}

template <class Sample>
ROW_BODY markQuadsBody(std::size_t n, const Sample *__restrict quads, Sample limit, std::uint8_t *__restrict mask)
{
    for (std::size_t i = 0; i < n; ++i)
    {
        const Sample *q = quads + 4 * i;
        mask[i] = static_cast<std::uint8_t>(mask[i] | (q[0] > limit ? 1 : 0) | (q[1] > limit ? 1 : 0) |
                                            (q[2] > limit ? 1 : 0));
    }
}

template <class Sample>
ROW_BODY interleaveBody(std::size_t n, const Sample *__restrict a, const Sample *__restrict b,
                        const Sample *__restrict c, const Sample *__restrict d, Sample *__restrict quads)
{
    for (std::size_t i = 0; i < n; ++i)
    {
        quads[4 * i] = a[i];
        quads[4 * i + 1] = b[i];
        quads[4 * i + 2] = c[i];
        quads[4 * i + 3] = d[i];
    }
}

} // namespace

#undef ROW_BODY

STILLMARK_MULTIVERSION
void greyOfRgb(std::size_t n, const std::uint8_t *r, const std::uint8_t *g, const std::uint8_t *b, double *grey)
{
    rgbBody<1>(n, r, g, b, grey);
}

STILLMARK_MULTIVERSION
void greyOfRgb(std::size_t n, const std::uint16_t *r, const std::uint16_t *g, const std::uint16_t *b, double *grey)
{
    rgbBody<1>(n, r, g, b, grey);
}

STILLMARK_MULTIVERSION
void greyOfRgb(std::size_t n, const float *r, const float *g, const float *b, double *grey)
{
    rgbBody<1>(n, r, g, b, grey);
}

STILLMARK_MULTIVERSION
void greyOfRgbQuads(std::size_t n, const std::uint8_t *quads, double *grey)
{
    rgbBody<4>(n, quads, quads + 1, quads + 2, grey);
}

STILLMARK_MULTIVERSION
void greyOfRgbQuads(std::size_t n, const std::uint16_t *quads, double *grey)
{
    rgbBody<4>(n, quads, quads + 1, quads + 2, grey);
}

STILLMARK_MULTIVERSION
void greyOfPlane(std::size_t n, const std::uint8_t *plane, double *grey)
{
    planeBody(n, plane, grey);
}

STILLMARK_MULTIVERSION
void greyOfPlane(std::size_t n, const std::uint16_t *plane, double *grey)
{
    planeBody(n, plane, grey);
}

STILLMARK_MULTIVERSION
void greyOfPlane(std::size_t n, const float *plane, double *grey)
{
    planeBody(n, plane, grey);
}

STILLMARK_MULTIVERSION
void markAbove(std::size_t n, const std::uint8_t *plane, std::uint8_t limit, std::uint8_t *mask)
{
    markBody(n, plane, limit, mask);
}

STILLMARK_MULTIVERSION
void markAbove(std::size_t n, const std::uint16_t *plane, std::uint16_t limit, std::uint8_t *mask)
{
    markBody(n, plane, limit, mask);
}

STILLMARK_MULTIVERSION
void markAbove(std::size_t n, const float *plane, float limit, std::uint8_t *mask)
{
    markBody(n, plane, limit, mask);
}

STILLMARK_MULTIVERSION
void markAboveQuads(std::size_t n, const std::uint8_t *quads, std::uint8_t limit, std::uint8_t *mask)
{
    markQuadsBody(n, quads, limit, mask);
}

STILLMARK_MULTIVERSION
void markAboveQuads(std::size_t n, const std::uint16_t *quads, std::uint16_t limit, std::uint8_t *mask)
{
    markQuadsBody(n, quads, limit, mask);
}

STILLMARK_MULTIVERSION
void interleave(std::size_t n, const std::uint8_t *const planes[4], std::uint8_t *quads)
{
    interleaveBody(n, planes[0], planes[1], planes[2], planes[3], quads);
}

STILLMARK_MULTIVERSION
void interleave(std::size_t n, const std::uint16_t *const planes[4], std::uint16_t *quads)
{
    interleaveBody(n, planes[0], planes[1], planes[2], planes[3], quads);
}

} // namespace Sarnik
