#include "platform/math/realTransform2d.h"

#include "platform/math/rowPairs.h"

#include <algorithm>
#include <cassert>

namespace CorvaneDeblur
{
namespace
{

/// Memory of the calling thread that grows as needed and is kept: transforms allocate nothing once it is warm.
complexSample *threadMemory(int slot, std::size_t count)
{
    thread_local alignedBuffer<complexSample> buffers[2];
    if (buffers[slot].count() < count)
        buffers[slot] = alignedBuffer<complexSample>(count);
    return buffers[slot].data();
}

/// Two lines, each starting on a cache line.
struct linePair
{
    explicit linePair(int cols)
    {
        const std::size_t line = (static_cast<std::size_t>(cols) + 7) / 8 * 8;
        in = threadMemory(0, 2 * line);
        out = in + line;
    }
    complexSample *in, *out;
};

} // namespace

realTransform2d::realTransform2d(int rows, int cols, workers executedBy)
    : gridRows(rows), gridCols(cols), who(executedBy), rowForward(&linePlan::row(cols, direction::forward)),
      rowInverse(&linePlan::row(cols, direction::inverse)),
      columnsForward(&linePlan::columns(rows, direction::forward)),
      columnsInverse(&linePlan::columns(rows, direction::inverse))
{
    assert(rows > 0 && cols > 0);
}

realTransform2d::pieceScratch::pieceScratch(std::ptrdiff_t pieceStride)
    : memory(threadMemory(1, static_cast<std::size_t>(4 * pieceStride))), stride(pieceStride)
{
}

// Pieces of work of about 50 microseconds: small enough to share, large enough not to notice the sharing.
int realTransform2d::pieceGrain() const
{
    return std::max(1, 1024 / gridRows);
}

int realTransform2d::rowGrain() const
{
    return 2 * std::max(1, 4096 / gridCols);
}

void realTransform2d::forwardPair(const float *a, const float *b, int rowA, int rowB, complexSample *spectrum) const
{
    forwardPartialPair(a, b, gridCols, rowA, rowB, spectrum);
}

void realTransform2d::forwardPartialPair(const float *a, const float *b, int inCols, int rowA, int rowB,
                                         complexSample *spectrum) const
{
    const linePair lines(gridCols);
    packRows(a, b, inCols, lines.in, gridCols);
    rowForward->run(lines.in, lines.out);
    splitSpectra(lines.out, gridCols, spectrum + static_cast<std::ptrdiff_t>(rowA) * columnLanes,
                 b ? spectrum + static_cast<std::ptrdiff_t>(rowB) * columnLanes : nullptr, pieceStride());
}

void realTransform2d::forwardRows(const float *in, std::ptrdiff_t stride, int inCols, int first, int count,
                                  complexSample *spectrum) const
{
    assert(inCols <= gridCols);
    inPieces(who, count, rowGrain(), [&](int begin, int end) {
        for (int i = begin; i < end; i += 2)
            forwardPartialPair(in + i * stride, i + 1 < end ? in + (i + 1) * stride : nullptr, inCols, first + i,
                               first + i + 1, spectrum);
    });
}

void realTransform2d::clearRows(int first, int count, complexSample *spectrum) const
{
    if (count <= 0)
        return;
    for (int piece = 0; piece < pieces(); ++piece)
        std::fill_n(spectrum + piece * pieceStride() + static_cast<std::ptrdiff_t>(first) * columnLanes,
                    static_cast<std::size_t>(count) * columnLanes, complexSample{0.0f, 0.0f});
}

void realTransform2d::inversePair(const complexSample *spectrum, int rowA, int rowB, float *a, float *b,
                                  float scale) const
{
    const linePair lines(gridCols);
    joinSpectra(spectrum + static_cast<std::ptrdiff_t>(rowA) * columnLanes,
                b ? spectrum + static_cast<std::ptrdiff_t>(rowB) * columnLanes : nullptr, pieceStride(), gridCols,
                lines.in);
    rowInverse->run(lines.in, lines.out);
    unpackRows(lines.out, a, b, gridCols, scale);
}

void realTransform2d::inverseRows(const complexSample *spectrum, int first, int count, float *out,
                                  std::ptrdiff_t stride, int outCols, float scale) const
{
    assert(outCols <= gridCols);
    inPieces(who, count, rowGrain(), [&](int begin, int end) {
        const linePair lines(gridCols);
        for (int i = begin; i < end; i += 2)
        {
            const bool both = i + 1 < end;
            const complexSample *half = spectrum + static_cast<std::ptrdiff_t>(first + i) * columnLanes;
            joinSpectra(half, both ? half + columnLanes : nullptr, pieceStride(), gridCols, lines.in);
            rowInverse->run(lines.in, lines.out);
            unpackRows(lines.out, out + i * stride, both ? out + (i + 1) * stride : nullptr, outCols, scale);
        }
    });
}

void realTransform2d::forward(const float *in, std::ptrdiff_t stride, complexSample *spectrum) const
{
    forwardRows(in, stride, gridCols, 0, gridRows, spectrum);
    forPieces([&](int piece, const pieceScratch &scratch) {
        complexSample *samples = spectrum + piece * pieceStride();
        forwardColumns(samples, scratch(0));
        std::copy_n(scratch(0), pieceStride(), samples);
    });
}

void realTransform2d::inverse(complexSample *spectrum, float *out, std::ptrdiff_t stride, float scale) const
{
    forPieces([&](int piece, const pieceScratch &scratch) {
        complexSample *samples = spectrum + piece * pieceStride();
        inverseColumns(samples, scratch(0));
        std::copy_n(scratch(0), pieceStride(), samples);
    });
    inverseRows(spectrum, 0, gridRows, out, stride, gridCols, scale);
}

} // namespace CorvaneDeblur
