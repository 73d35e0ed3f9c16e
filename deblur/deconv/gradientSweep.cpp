#include "deblur/deconv/gradientSweep.h"

#include "deblur/deconv/shrinkageLookup.h"
#include "platform/math/multiversion.h"

#include <atomic>
#include <utility>

namespace CorvaneDeblur
{
namespace
{

constexpr int rowsPerPiece = 64; // even, so that pairs of rows do not depend on the pieces

/// sum = (h - h of the left neighbour) + (v - v of the row above); returns whether any sample is not 0.
STILLMARK_MULTIVERSION
bool adjointRow(const float *h, const float *v, const float *vAbove, float *__restrict sum, int count)
{
    sum[0] = (h[0] - h[count - 1]) + (v[0] - vAbove[0]);
    for (int i = 1; i < count; ++i)
        sum[i] = (h[i] - h[i - 1]) + (v[i] - vAbove[i]);
    int any = 0;
    for (int i = 0; i < count; ++i)
        any |= static_cast<int>(sum[i] != 0.0f);
    return any != 0;
}

/// The rows of one piece, on one thread.
class sweepPiece
{
public:
    sweepPiece(const floatArray &grid, const differenceShrinker &shrinkage)
        : x(grid), shrink(shrinkage), rows(floatArray::allocate(5, grid.cols)), h(rows.row(0)), v(rows.row(1)),
          vAbove(rows.row(2))
    {
    }

    void start(int y) { verticalInto(y == 0 ? x.rows - 1 : y - 1, vAbove); }

    /// The sum's row y into slot 0 or 1; rows come in order after start. Returns whether any sample is not 0.
    bool next(int y, int slot)
    {
        const float *here = x.row(y);
        shrink.run(here, here + 1, h, x.cols - 1);
        shrink.run(here + x.cols - 1, here, h + x.cols - 1, 1);
        verticalInto(y, v);
        const bool any = adjointRow(h, v, vAbove, sum(slot), x.cols);
        std::swap(v, vAbove);
        return any;
    }

    float *sum(int slot) const { return rows.row(3 + slot); }

private:
    void verticalInto(int y, float *out) const { shrink.run(x.row(y), x.row(y + 1 < x.rows ? y + 1 : 0), out, x.cols); }

    const floatArray &x;
    const differenceShrinker &shrink;
    floatArray rows;
    float *h, *v, *vAbove;
};

} // namespace

bool shrunkGradientRows(const realTransform2d &grid, const floatArray &x, const shrinkageTable &table,
                        complexSample *spectrum, workers who)
{
    const differenceShrinker shrink(table);
    std::atomic<bool> any = false;
    inPieces(who, x.rows, rowsPerPiece, [&](int begin, int end) {
        sweepPiece sweep(x, shrink);
        sweep.start(begin);
        for (int y = begin; y < end; y += 2)
        {
            const bool pair = y + 1 < end;
            const bool first = sweep.next(y, 0), second = pair && sweep.next(y + 1, 1);
            if (!first && !second)
            {
                grid.clearRows(y, pair ? 2 : 1, spectrum);
                continue;
            }
            any.store(true, std::memory_order_relaxed);
            grid.forwardPair(sweep.sum(0), pair ? sweep.sum(1) : nullptr, y, y + 1, spectrum);
        }
    });
    return any;
}

} // namespace CorvaneDeblur
