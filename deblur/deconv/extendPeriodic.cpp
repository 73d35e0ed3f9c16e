#include "deblur/deconv/extendPeriodic.h"

#include "deblur/estimate/arrayOps.h"
#include "platform/math/sineTransform.h"

#include <algorithm>
#include <cmath>
#include <numbers>
#include <vector>

namespace CorvaneDeblur
{
namespace
{

floatArray transposed(const floatArray &a)
{
    const floatArray out = floatArray::allocate(a.cols, a.rows);
    for (int y = 0; y < a.rows; ++y)
        for (int x = 0; x < a.cols; ++x)
            out.row(x)[y] = a.row(y)[x];
    return out;
}

/// Number of modes that the line solver advances together: independent chains hide each other's latency.
constexpr int modeLanes = 8;

/// Solves u[j - 1] + u[j + 1] - (2 + lambda) u[j] = f[j], u zero beyond both ends, in place for `lanes` rows of
/// `length` samples: elimination without pivoting (the system is diagonally dominant), in double.
void solveLines(float *const *rows, const double *lambda, int lanes, int length, std::vector<double> &work)
{
    work.resize(static_cast<std::size_t>(2 * length * modeLanes));
    double *pivot = work.data(), *value = pivot + length * modeLanes;
    double lastPivot[modeLanes] = {}, lastValue[modeLanes] = {}, diagonal[modeLanes];
    for (int m = 0; m < modeLanes; ++m)
        diagonal[m] = 2.0 + lambda[std::min(m, lanes - 1)];
    for (int j = 0; j < length; ++j)
    {
        double f[modeLanes] = {};
        for (int m = 0; m < lanes; ++m)
            f[m] = static_cast<double>(rows[m][j]);
        for (int m = 0; m < modeLanes; ++m)
        {
            lastPivot[m] = 1.0 / (diagonal[m] - lastPivot[m]);
            lastValue[m] = (lastValue[m] - f[m]) * lastPivot[m];
            pivot[j * modeLanes + m] = lastPivot[m];
            value[j * modeLanes + m] = lastValue[m];
        }
    }
    double u[modeLanes] = {};
    for (int j = length - 1; j >= 0; --j)
    {
        for (int m = 0; m < modeLanes; ++m)
            u[m] = value[j * modeLanes + m] + pivot[j * modeLanes + m] * u[m];
        for (int m = 0; m < lanes; ++m)
            rows[m][j] = static_cast<float>(u[m]);
    }
}

/// solveLaplace for a grid with at least as many columns as rows: a sine transform along the short axis takes the
/// equation apart into one tridiagonal system a row. (A sine transform along the long axis would do as well, but its
/// length, the picture's, is often twice a prime.)
void solveWide(const floatArray &grid)
{
    const int m = grid.rows - 2, n = grid.cols - 2;
    const floatArray inside = floatArray::allocate(m, n);
    fill(inside, 0.0f);
    subtractInto(inside.rowView(0), grid.subRect(0, 1, 1, n), inside.rowView(0));
    subtractInto(inside.rowView(m - 1), grid.subRect(m + 1, 1, 1, n), inside.rowView(m - 1));
    for (int y = 0; y < m; ++y)
    {
        inside.row(y)[0] -= grid.row(y + 1)[0];
        inside.row(y)[n - 1] -= grid.row(y + 1)[n + 1];
    }

    const sineTransform transform(m);
    transform.run(inside.data, inside.stride, n, 1.0f);
    std::vector<double> work;
    for (int first = 0; first < m; first += modeLanes)
    {
        float *rows[modeLanes];
        double lambda[modeLanes];
        const int lanes = std::min(modeLanes, m - first);
        for (int i = 0; i < lanes; ++i)
        {
            rows[i] = inside.row(first + i);
            lambda[i] = 2.0 - 2.0 * std::cos(std::numbers::pi * (first + i + 1) / (m + 1));
        }
        solveLines(rows, lambda, lanes, n, work);
    }
    transform.run(inside.data, inside.stride, n, 2.0f / static_cast<float>(m + 1));
    copyTo(inside, grid.subRect(1, 1, m, n));
}

/// A strip that carries the tile's last row (row 0 of the strip) over `added` rows to the tile's first row. Its side
/// columns are interpolated with the strip's number of rows as the divisor, which stops just short of the last row.
floatArray joiningStrip(const float *lastRow, const float *firstRow, int cols, int added)
{
    const int n = added + 2;
    const floatArray strip = floatArray::allocate(n, cols);
    std::copy_n(lastRow, cols, strip.row(0));
    std::copy_n(firstRow, cols, strip.row(n - 1));
    for (const int c : {0, cols - 1})
        for (int r = 1; r <= added; ++r)
        {
            const float t = static_cast<float>(n - r) / static_cast<float>(n);
            strip.row(r)[c] = (1.0f - t) * strip.row(n - 1)[c] + t * strip.row(0)[c];
        }
    solveLaplace(strip);
    return strip;
}

} // namespace

void solveLaplace(const floatArray &grid)
{
    if (grid.rows < 3 || grid.cols < 3)
        return;
    if (grid.rows <= grid.cols)
    {
        solveWide(grid);
        return;
    }
    const floatArray wide = transposed(grid);
    solveWide(wide);
    copyTo(transposed(wide), grid);
}

void extendPeriodic(const floatArray &tile, const floatArray &extended)
{
    const int h = tile.rows, w = tile.cols;
    const int dh = extended.rows - h, dw = extended.cols - w;
    assert(h > 0 && w > 0 && dh >= 0 && dw >= 0);

    const floatArray bottom = joiningStrip(tile.row(h - 1), tile.row(0), w, dh);
    // The right strip is the same construction on columns: built lying down, stood up when it is copied.
    const floatArray lastColumn = transposed(tile.colView(w - 1)), firstColumn = transposed(tile.colView(0));
    const floatArray right = transposed(joiningStrip(lastColumn.data, firstColumn.data, h, dw));

    const floatArray corner = floatArray::allocate(dh + 2, dw + 2);
    fill(corner, 0.0f);
    copyTo(right.rowView(0), corner.rowView(dh + 1));
    copyTo(right.rowView(h - 1), corner.rowView(0));
    for (int y = 0; y < dh + 2; ++y)
    {
        corner.row(y)[0] = bottom.row(y)[w - 1];
        corner.row(y)[dw + 1] = bottom.row(y)[0];
    }
    solveLaplace(corner);

    copyTo(tile, extended.subRect(0, 0, h, w));
    copyTo(bottom.subRect(1, 0, dh, w), extended.subRect(h, 0, dh, w));
    copyTo(right.subRect(0, 1, h, dw), extended.subRect(0, w, h, dw));
    copyTo(corner.subRect(1, 1, dh, dw), extended.subRect(h, w, dh, dw));
}

} // namespace CorvaneDeblur
