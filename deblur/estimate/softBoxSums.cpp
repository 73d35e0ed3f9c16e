#include "deblur/estimate/softBoxSums.h"

#include "platform/math/workers.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstddef>

namespace CorvaneDeblur
{
namespace
{

constexpr int gaussianReach = 2; ///< samples on each side of the 5-tap Gaussian

/// One axis of the 5 x 5 Gaussian, summing to 1; the square is the product of two.
std::array<double, 2 * gaussianReach + 1> gaussianTaps()
{
    constexpr double sigma = 5.0 / 6.0;
    std::array<double, 2 * gaussianReach + 1> taps{};
    double sum = 0.0;
    for (int i = -gaussianReach; i <= gaussianReach; ++i)
        sum += taps[i + gaussianReach] = std::exp(-(i * i) / (2.0 * sigma * sigma));
    for (double &tap : taps)
        tap /= sum;
    return taps;
}

} // namespace

softBoxSums::softBoxSums(const floatArray &map, borderMode border, int largestRows, int largestCols)
    : rows(map.rows), cols(map.cols)
{
    // A smoothed map in zeros ends where the Gaussian does; one that goes on is held as far as a box can reach.
    const bool replicate = border == borderMode::replicate;
    marginRows = replicate ? largestRows / 2 + 1 : gaussianReach;
    marginCols = replicate ? largestCols / 2 + 1 : gaussianReach;
    tableRows = rows + 2 * marginRows + 1;
    tableCols = cols + 2 * marginCols + 1;
    table.assign(static_cast<std::size_t>(tableRows) * tableCols, 0.0);

    const auto taps = gaussianTaps();
    const int pad = marginCols + gaussianReach;
    std::vector<double> line(static_cast<std::size_t>(cols) + 2 * pad);
    for (int y = -marginRows; y < rows + marginRows; ++y)
    {
        // Smooth along the columns, ...
        std::fill(line.begin(), line.end(), 0.0);
        for (int i = -gaussianReach; i <= gaussianReach; ++i)
        {
            int sourceRow = y + i;
            if (replicate)
                sourceRow = std::clamp(sourceRow, 0, rows - 1);
            else if (sourceRow < 0 || sourceRow >= rows)
                continue;
            const float *source = map.row(sourceRow);
            const double tap = taps[i + gaussianReach];
            for (int x = 0; x < cols; ++x)
                line[pad + x] += tap * source[x];
        }
        if (replicate)
        {
            std::fill_n(line.begin(), pad, line[pad]);
            std::fill_n(line.end() - pad, pad, line[pad + cols - 1]);
        }
        // ... along the row, and add up.
        double *here = &table[static_cast<std::size_t>(y + marginRows + 1) * tableCols];
        const double *above = here - tableCols;
        double sum = 0.0;
        for (int x = 0; x + 1 < tableCols; ++x)
        {
            const double *l = &line[x];
            sum += taps[0] * (l[0] + l[4]) + taps[1] * (l[1] + l[3]) + taps[2] * l[2];
            here[x + 1] = above[x + 1] + sum;
        }
    }
}

void softBoxSums::sumInto(const floatArray &out, int boxRows, int boxCols, float factor) const
{
    // The window from half a box above a position on; outside the table nothing is added any more.
    const auto tableRow = [&](int y) { return std::clamp(y + marginRows, 0, tableRows - 1); };
    const auto tableCol = [&](int x) { return std::clamp(x + marginCols, 0, tableCols - 1); };
    inPieces(workers::all, rows, 32, [&](int first, int last) {
        for (int y = first; y < last; ++y)
        {
            const double *top = &table[static_cast<std::size_t>(tableRow(y - boxRows / 2)) * tableCols];
            const double *bottom = &table[static_cast<std::size_t>(tableRow(y - boxRows / 2 + boxRows)) * tableCols];
            float *sums = out.row(y);
            for (int x = 0; x < cols; ++x)
            {
                const int left = tableCol(x - boxCols / 2);
                const int right = tableCol(x - boxCols / 2 + boxCols);
                const double sum = (bottom[right] - bottom[left]) - (top[right] - top[left]);
                sums[x] = static_cast<float>(sum) * factor;
            }
        }
    });
}

} // namespace CorvaneDeblur
