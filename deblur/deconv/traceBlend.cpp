#include "deblur/deconv/traceBlend.h"

#include "platform/math/multiversion.h"

#include <algorithm>
#include <cmath>
#include <cstdint>

namespace CorvaneDeblur
{
namespace
{

struct centre
{
    double x, y;
};

/// In whole pixels, truncated towards zero.
centre centreOf(const latentKernel &trace)
{
    return {static_cast<double>((std::int64_t{trace.regionLeft} + trace.regionRight) / 2),
            static_cast<double>((std::int64_t{trace.regionTop} + trace.regionBottom) / 2)};
}

double distanceTo(const centre &c, int x, int y)
{
    const double dx = x - c.x, dy = y - c.y;
    return std::sqrt(dx * dx + dy * dy);
}

/// exp(-4 (r + 1/2)) / (exp(4 (r - 1/2)) + exp(-4 (r + 1/2))) with r = d / blendWidth, both divided by the numerator.
double weightOfDifference(double d)
{
    if (d < -blendWidth)
        return 1.0;
    if (d > blendWidth)
        return 0.0;
    return 1.0 / (1.0 + std::exp(8.0 * (d / blendWidth)));
}

/// out[i] = distance from (firstDx + i, dy) to the origin
STILLMARK_MULTIVERSION
void distancesInto(double firstDx, double dy, double *__restrict out, int count)
{
    for (int i = 0; i < count; ++i)
    {
        const double dx = firstDx + static_cast<double>(i);
        out[i] = std::sqrt(dx * dx + dy * dy);
    }
}

void applyPair(const double *distanceA, const double *distanceB, double *__restrict weightA, double *__restrict weightB,
               int count)
{
    for (int i = 0; i < count; ++i)
    {
        const double w = weightOfDifference(distanceA[i] - distanceB[i]);
        weightA[i] *= w;
        weightB[i] *= 1.0 - w;
    }
}

STILLMARK_MULTIVERSION
void addRow(const double *__restrict a, double *__restrict sum, int count)
{
    for (int i = 0; i < count; ++i)
        sum[i] += a[i];
}

/// tile += result * weight / sum; the share and the product in double.
STILLMARK_MULTIVERSION
void addShare(const double *__restrict weight, const double *__restrict sum, const float *__restrict result,
              float *__restrict tile, int count)
{
    for (int i = 0; i < count; ++i)
        tile[i] += static_cast<float>(weight[i] / sum[i] * static_cast<double>(result[i]));
}

/// Rows of doubles, one per trace.
class rowTable
{
public:
    rowTable(std::size_t rows, int cols) : width(static_cast<std::size_t>(cols)), values(rows * width) {}
    double *operator[](std::size_t row) { return values.data() + row * width; }
    void fill(double value) { std::fill(values.begin(), values.end(), value); }

private:
    std::size_t width;
    std::vector<double> values;
};

} // namespace

double pairWeight(int x, int y, const latentKernel &a, const latentKernel &b)
{
    return weightOfDifference(distanceTo(centreOf(a), x, y) - distanceTo(centreOf(b), x, y));
}

std::vector<int> selectActiveKernels(const std::vector<latentKernel> &kernels, int left, int top, int right, int bottom)
{
    if (kernels.size() < 2)
        return {0};
    const int cx = (left + right) / 2, cy = (top + bottom) / 2;
    const int samples[9][2] = {{left, top},
                               {right, top},
                               {right, bottom},
                               {left, bottom},
                               {cx, cy},
                               {cx, (cy + top) / 2},
                               {cx, (cy + bottom) / 2},
                               {(cx + left) / 2, cy},
                               {(cx + right) / 2, cy}};
    std::vector<bool> active(kernels.size(), false);
    std::vector<double> distances(kernels.size());
    for (const auto &[x, y] : samples)
    {
        for (std::size_t i = 0; i < kernels.size(); ++i)
            distances[i] = distanceTo(centreOf(kernels[i]), x, y);
        // A product of pair weights is above 0 if each of them is, and the nearest other trace gives the smallest.
        const double nearest = *std::min_element(distances.begin(), distances.end());
        for (std::size_t i = 0; i < kernels.size(); ++i)
            if (distances[i] - nearest <= blendWidth)
                active[i] = true;
    }
    std::vector<int> indices;
    for (std::size_t i = 0; i < kernels.size(); ++i)
        if (active[i])
            indices.push_back(static_cast<int>(i));
    return indices;
}

void blendResults(const floatArray &tile, const std::vector<latentKernel> &kernels,
                  const std::vector<int> &activeKernels, const std::vector<floatArray> &results, int originX,
                  int originY)
{
    const std::size_t traces = activeKernels.size();
    std::vector<centre> centres;
    for (const int index : activeKernels)
        centres.push_back(centreOf(kernels[static_cast<std::size_t>(index)]));

    rowTable distances(traces, tile.cols), weights(traces, tile.cols), sum(1, tile.cols);
    for (int y = 0; y < tile.rows; ++y)
    {
        for (std::size_t i = 0; i < traces; ++i)
            distancesInto(originX - centres[i].x, originY + y - centres[i].y, distances[i], tile.cols);
        weights.fill(1.0);
        for (std::size_t a = 0; a < traces; ++a)
            for (std::size_t b = a + 1; b < traces; ++b)
                applyPair(distances[a], distances[b], weights[a], weights[b], tile.cols);
        sum.fill(0.0);
        for (std::size_t i = 0; i < traces; ++i)
            addRow(weights[i], sum[0], tile.cols);
        std::fill_n(tile.row(y), tile.cols, 0.0f);
        for (std::size_t i = 0; i < traces; ++i)
            addShare(weights[i], sum[0], results[i].row(y), tile.row(y), tile.cols);
    }
}

} // namespace CorvaneDeblur
