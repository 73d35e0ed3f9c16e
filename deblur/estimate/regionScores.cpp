#include "deblur/estimate/regionScores.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/filters.h"
#include "platform/math/workers.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <numbers>

namespace CorvaneDeblur
{
namespace
{

/// How well a grey value is exposed: 1 within 10/255..220/255, falling off towards black and beyond white.
float exposureOf(float value)
{
    constexpr float dark = 10.0f / 255.0f, bright = 220.0f / 255.0f, width = 40.0f / 255.0f;
    if (value >= dark && value <= bright)
        return 1.0f;
    const float outside = (value - (value > bright ? bright : dark)) / width;
    return std::exp(-outside * outside);
}

} // namespace

edgeMaps edgesOf(const floatArray &small, int angleBins)
{
    constexpr float pi = std::numbers::pi_v<float>;
    constexpr float weakestEdge = 0.05f;
    std::vector<float> bound(angleBins + 1);
    for (int a = 0; a <= angleBins; ++a)
        bound[a] = static_cast<float>(a) * pi / static_cast<float>(angleBins);

    const floatArray gx = floatArray::allocate(small.rows, small.cols);
    const floatArray gy = floatArray::allocate(small.rows, small.cols);
    forwardDiffX(small, gx);
    forwardDiffY(small, gy);
    edgeMaps edges{floatArray::allocate(small.rows, small.cols), intArray::allocate(small.rows, small.cols)};
    for (int y = 0; y < small.rows; ++y)
    {
        const float *dx = gx.row(y);
        const float *dy = gy.row(y);
        float *magnitude = edges.magnitude.row(y);
        std::int32_t *bin = edges.angleBin.row(y);
        for (int x = 0; x < small.cols; ++x)
        {
            magnitude[x] = std::sqrt(dx[x] * dx[x] + dy[x] * dy[x]);
            bin[x] = -1;
            if (!(magnitude[x] > weakestEdge))
                continue;
            float angle = std::atan2(dy[x], dx[x]);
            if (angle < 0.0f)
                angle += pi;
            // Bins hold their lower bound; an angle of exactly pi is in none.
            const auto above = std::upper_bound(bound.begin(), bound.end(), angle);
            if (above != bound.end())
                bin[x] = static_cast<std::int32_t>(above - bound.begin()) - 1;
        }
    }
    return edges;
}

regionScores::regionScores(const floatArray &small, const edgeMaps &edges, int angleBins, int extent,
                           int largestBoxRows, int largestBoxCols)
    : kernelExtent(extent), scratch(floatArray::allocate(small.rows, small.cols))
{
    strength = std::make_unique<softBoxSums>(edges.magnitude, borderMode::constant);
    for (int y = 0; y < small.rows; ++y)
        std::transform(small.row(y), small.row(y) + small.cols, scratch.row(y), exposureOf);
    exposure = std::make_unique<softBoxSums>(scratch, borderMode::replicate, largestBoxRows, largestBoxCols);
    countDirections(edges, angleBins);
}

/// One table for each direction that occurs.
void regionScores::countDirections(const edgeMaps &edges, int angleBins)
{
    std::vector<char> occurs(angleBins, 0);
    for (int y = 0; y < edges.angleBin.rows; ++y)
        for (int x = 0; x < edges.angleBin.cols; ++x)
            if (const int bin = edges.angleBin.at(y, x); bin >= 0)
                occurs[bin] = 1;
    std::vector<int> bins;
    for (int bin = 0; bin < angleBins; ++bin)
        if (occurs[bin])
            bins.push_back(bin);

    directions.resize(bins.size());
    inPieces(workers::all, static_cast<int>(bins.size()), 1, [&](int first, int last) {
        for (int i = first; i < last; ++i)
        {
            const floatArray inBin = floatArray::allocate(edges.angleBin.rows, edges.angleBin.cols);
            for (int y = 0; y < inBin.rows; ++y)
                std::transform(edges.angleBin.row(y), edges.angleBin.row(y) + inBin.cols, inBin.row(y),
                               [&](std::int32_t bin) { return bin == bins[i] ? 1.0f : 0.0f; });
            directions[i] = std::make_unique<softBoxSums>(inBin, borderMode::constant);
        }
    });
}

floatArray regionScores::scores(int boxRows, int boxCols)
{
    const float mean = 1.0f / (static_cast<float>(boxCols) * static_cast<float>(boxRows));
    const floatArray coverage = floatArray::allocate(scratch.rows, scratch.cols);
    fill(coverage, 0.0f);
    for (const auto &direction : directions)
    {
        direction->sumInto(scratch, boxRows, boxCols);
        inPieces(workers::all, scratch.rows, 32, [&](int first, int last) {
            for (int y = first; y < last; ++y)
            {
                const float *length = scratch.row(y);
                float *count = coverage.row(y);
                for (int x = 0; x < scratch.cols; ++x)
                    count[x] += length[x] > static_cast<float>(kernelExtent) ? 1.0f : 0.0f;
            }
        });
    }
    strength->sumInto(scratch, boxRows, boxCols);
    combine(1.0f, coverage, 10.0f * mean, scratch, coverage);
    exposure->sumInto(scratch, boxRows, boxCols, mean);
    multiplyInto(coverage, scratch, coverage);
    return coverage;
}

} // namespace CorvaneDeblur
