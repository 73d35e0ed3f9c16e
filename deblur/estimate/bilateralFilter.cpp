#include "deblur/estimate/edgeFilters.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/filters.h"
#include "platform/math/fastExp.h"
#include "platform/math/multiversion.h"

#include <algorithm>
#include <cstdlib>

namespace CorvaneDeblur
{
namespace
{

/// weight[x] = spatial * exp(range * (a[x] - b[x])^2)
STILLMARK_MULTIVERSION
void pairWeights(const float *a, const float *b, float spatial, float range, float *weight, int count)
{
    for (int x = 0; x < count; ++x)
    {
        const float d = a[x] - b[x];
        weight[x] = spatial * fastExp(range * d * d);
    }
}

STILLMARK_MULTIVERSION
void accumulate(const float *weight, const float *neighbour, float *sum, float *weightSum, int count)
{
    for (int x = 0; x < count; ++x)
    {
        sum[x] += weight[x] * neighbour[x];
        weightSum[x] += weight[x];
    }
}

STILLMARK_MULTIVERSION
void quotient(const float *sum, const float *weightSum, float *out, int count)
{
    for (int x = 0; x < count; ++x)
        out[x] = sum[x] / weightSum[x];
}

/// Rows [begin, end) of the result. Each pair of pixels is visited once, from its upper (or left) pixel; the pairs
/// that reach into the rows from above are computed again here, so that pieces of rows are independent. A pixel's sum
/// runs in the order of the rows whatever the pieces are.
class rowBand
{
public:
    rowBand(const floatArray &source, const floatArray &spatialWeights, float rangeSigma, int begin, int end)
        : src(source), spatial(spatialWeights), radius(spatialWeights.rows / 2), first(std::max(0, begin - radius)),
          range(-0.5f / (rangeSigma * rangeSigma)), sums(floatArray::allocate(end + radius - first, source.cols)),
          weightSums(floatArray::allocate(end + radius - first, source.cols)),
          weight(floatArray::allocate(1, source.cols))
    {
        const float centre = spatial.at(radius, radius);
        fill(weightSums, centre);
        for (int y = first; y < std::min(end + radius, src.rows); ++y)
            scaleInto(src.rowView(y), sums.rowView(y - first), centre);
        for (int y = first; y < end; ++y)
            for (int dy = 0; dy <= radius && y + dy < src.rows; ++dy)
                for (int dx = dy == 0 ? 1 : -radius; dx <= radius; ++dx)
                    visit(y, dy, dx);
    }

    void writeRow(int y, float *out) const { quotient(sums.row(y - first), weightSums.row(y - first), out, src.cols); }

private:
    void visit(int y, int dy, int dx)
    {
        const int from = std::max(0, -dx), count = src.cols - std::abs(dx);
        if (count <= 0)
            return;
        const float *pixel = src.row(y) + from, *neighbour = src.row(y + dy) + from + dx;
        pairWeights(pixel, neighbour, spatial.at(radius + dy, radius + dx), range, weight.data, count);
        const int above = y - first, below = above + dy;
        accumulate(weight.data, neighbour, sums.row(above) + from, weightSums.row(above) + from, count);
        accumulate(weight.data, pixel, sums.row(below) + from + dx, weightSums.row(below) + from + dx, count);
    }

    const floatArray &src, &spatial;
    int radius, first;
    float range;
    floatArray sums, weightSums, weight;
};

} // namespace

void bilateralFilter(const floatArray &source, const floatArray &destination, float spatialSigma, float rangeSigma,
                     int radius, workers who)
{
    const floatArray spatial = floatArray::allocate(2 * radius + 1, 2 * radius + 1);
    gaussianFill(spatial, spatialSigma);
    inPieces(who, source.rows, 48, [&](int begin, int end) {
        const rowBand band(source, spatial, rangeSigma, begin, end);
        for (int y = begin; y < end; ++y)
            band.writeRow(y, destination.row(y));
    });
}

} // namespace CorvaneDeblur
