#pragma once

#include "platform/math/alignedBuffer.h"
#include "platform/math/complexSample.h"
#include "platform/math/linePlans.h"
#include "platform/math/workers.h"

#include <cstddef>

namespace CorvaneDeblur
{

/// A half spectrum of a real rows x cols grid in column pieces: frequency (v, u), 0 <= u <= cols / 2, lies at
/// ((u / columnLanes) * rows + v) * columnLanes + u % columnLanes. The columns of a piece are contiguous, so a column
/// transform streams; lanes past the half spectrum's end are 0 after a forward transform of the rows.
using pieceSpectrum = alignedBuffer<complexSample>;

/// Two-dimensional transform of a real grid, taken apart into its row half and its column half so that work in between
/// costs no sweep of its own: an operation on the spectrum runs on a column piece while it lies in the cache, between
/// the piece's forward and inverse transforms; rows that are zero or that nobody wants are not transformed at all.
/// Forward and inverse are unnormalised: there and back multiplies by rows * cols.
///
/// Objects are light and immutable; use them from any thread. Grids and outputs may have any stride and alignment.
class realTransform2d
{
public:
    realTransform2d(int rows, int cols, workers who);

    int rows() const { return gridRows; }
    int cols() const { return gridCols; }
    /// Samples between two pieces of a spectrum, and number of pieces.
    std::ptrdiff_t pieceStride() const { return static_cast<std::ptrdiff_t>(gridRows) * columnLanes; }
    int pieces() const { return (gridCols / 2 + columnLanes) / columnLanes; }
    std::size_t spectrumCount() const
    {
        return static_cast<std::size_t>(pieces()) * static_cast<std::size_t>(pieceStride());
    }

    /// Row transforms of `count` rows starting at spectrum row `first`; row i comes from the inCols samples at
    /// in + i * stride, continued with zeros.
    void forwardRows(const float *in, std::ptrdiff_t stride, int inCols, int first, int count,
                     complexSample *spectrum) const;
    /// Sets spectrum rows to 0.
    void clearRows(int first, int count, complexSample *spectrum) const;
    /// One pair of whole rows on the calling thread: a goes to spectrum row `rowA`, b (may be null) to `rowB`.
    void forwardPair(const float *a, const float *b, int rowA, int rowB, complexSample *spectrum) const;
    /// Inverse row transforms of `count` rows from `first` on, times `scale`; the first outCols samples of each go to
    /// out + i * stride.
    void inverseRows(const complexSample *spectrum, int first, int count, float *out, std::ptrdiff_t stride,
                     int outCols, float scale) const;
    /// One pair: spectrum rows rowA and rowB to a and b (may be null), all columns.
    void inversePair(const complexSample *spectrum, int rowA, int rowB, float *a, float *b, float scale) const;

    /// Column transforms of one piece (columnLanes columns), from `in` to `out`, which do not overlap.
    void forwardColumns(const complexSample *in, complexSample *out) const { columnsForward->run(in, out); }
    void inverseColumns(const complexSample *in, complexSample *out) const { columnsInverse->run(in, out); }

    /// Calls body(piece, scratch) for every column piece; scratch(i), i < 4, is memory of the calling thread for one
    /// piece (pieceStride samples), its content undefined. The body must not start other parallel work.
    template <typename Body> void forPieces(const Body &body) const
    {
        inPieces(who, pieces(), pieceGrain(), [&](int first, int last) {
            const pieceScratch scratch(pieceStride());
            for (int piece = first; piece < last; ++piece)
                body(piece, scratch);
        });
    }

    /// Memory of one thread for a few pieces.
    class pieceScratch
    {
    public:
        explicit pieceScratch(std::ptrdiff_t pieceStride);
        complexSample *operator()(int i) const { return memory + i * stride; }

    private:
        complexSample *memory;
        std::ptrdiff_t stride;
    };

    /// The whole transform of a grid, and back (times scale); `spectrum` is overwritten by the inverse.
    void forward(const float *in, std::ptrdiff_t stride, complexSample *spectrum) const;
    void inverse(complexSample *spectrum, float *out, std::ptrdiff_t stride, float scale) const;

private:
    void forwardPartialPair(const float *a, const float *b, int inCols, int rowA, int rowB,
                            complexSample *spectrum) const;
    int pieceGrain() const;
    int rowGrain() const;

    int gridRows, gridCols;
    workers who;
    const linePlan *rowForward, *rowInverse, *columnsForward, *columnsInverse;
};

} // namespace CorvaneDeblur
