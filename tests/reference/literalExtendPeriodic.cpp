#include "tests/reference/literalExtendPeriodic.h"

#include "deblur/estimate/arrayOps.h"

#include <cmath>
#include <numbers>
#include <vector>

using namespace CorvaneDeblur;

namespace Reference
{
namespace
{

struct doubleGrid
{
    int rows, cols;
    std::vector<double> values;

    doubleGrid(int gridRows, int gridCols) : rows(gridRows), cols(gridCols), values(std::size_t(rows) * cols) {}
    double &at(int y, int x) { return values[std::size_t(y) * cols + x]; }
    double at(int y, int x) const { return values[std::size_t(y) * cols + x]; }
};

double basis(int i, int j, int n)
{
    return std::sin(std::numbers::pi * ((i + 1) * (j + 1) % (2 * (n + 1))) / (n + 1));
}

/// Along the columns, then along the rows: sum over j of e(j) sin(pi i j / (n + 1)), i and j counted from 1.
doubleGrid sineTransform(const doubleGrid &e)
{
    doubleGrid columns(e.rows, e.cols), out(e.rows, e.cols);
    for (int i = 0; i < e.rows; ++i)
        for (int x = 0; x < e.cols; ++x)
            for (int y = 0; y < e.rows; ++y)
                columns.at(i, x) += e.at(y, x) * basis(i, y, e.rows);
    for (int i = 0; i < e.rows; ++i)
        for (int j = 0; j < e.cols; ++j)
            for (int x = 0; x < e.cols; ++x)
                out.at(i, j) += columns.at(i, x) * basis(j, x, e.cols);
    return out;
}

/// `t` of the last value and 1 - t of the first, in a strip of n values whose ends are given.
float between(float first, float last, int i, int n)
{
    const float t = static_cast<float>(n - i) / static_cast<float>(n);
    return (1.0f - t) * last + t * first;
}

} // namespace

void literalSolveLaplace(const floatArray &grid)
{
    const int m = grid.rows - 2, n = grid.cols - 2;
    if (m < 1 || n < 1)
        return;

    doubleGrid rhs(m, n);
    for (int x = 0; x < n; ++x)
    {
        rhs.at(0, x) -= grid.at(0, x + 1);
        rhs.at(m - 1, x) -= grid.at(grid.rows - 1, x + 1);
    }
    for (int y = 0; y < m; ++y)
    {
        rhs.at(y, 0) -= grid.at(y + 1, 0);
        rhs.at(y, n - 1) -= grid.at(y + 1, grid.cols - 1);
    }

    doubleGrid spectrum = sineTransform(rhs);
    for (int i = 1; i <= m; ++i)
        for (int j = 1; j <= n; ++j)
            spectrum.at(i - 1, j - 1) /=
                2.0 * (std::cos(std::numbers::pi * i / (m + 1)) + std::cos(std::numbers::pi * j / (n + 1))) - 4.0;

    const doubleGrid solution = sineTransform(spectrum); // its own inverse but for the factor
    const double factor = 2.0 / (m + 1) * 2.0 / (n + 1);
    for (int y = 0; y < m; ++y)
        for (int x = 0; x < n; ++x)
            grid.at(y + 1, x + 1) = static_cast<float>(factor * solution.at(y, x));
}

void literalExtendPeriodic(const floatArray &tile, const floatArray &extended)
{
    const int h = tile.rows, w = tile.cols;
    const int dh = extended.rows - h, dw = extended.cols - w;

    // Below the tile: from its last row to its first.
    const floatArray a = floatArray::allocate(dh + 2, w);
    copyTo(tile.rowView(h - 1), a.rowView(0));
    copyTo(tile.rowView(0), a.rowView(dh + 1));
    for (int r = 1; r <= dh; ++r)
        for (const int c : {0, w - 1})
            a.at(r, c) = between(a.at(0, c), a.at(dh + 1, c), r, dh + 2);
    literalSolveLaplace(a);

    // Right of the tile: from its last column to its first.
    const floatArray b = floatArray::allocate(h, dw + 2);
    copyTo(tile.colView(w - 1), b.colView(0));
    copyTo(tile.colView(0), b.colView(dw + 1));
    for (int c = 1; c <= dw; ++c)
        for (const int r : {0, h - 1})
            b.at(r, c) = between(b.at(r, 0), b.at(r, dw + 1), c, dw + 2);
    literalSolveLaplace(b);

    // The corner joins the two strips, across the grid's border.
    const floatArray corner = floatArray::allocate(dh + 2, dw + 2);
    copyTo(a.colView(0), corner.colView(dw + 1));
    copyTo(a.colView(w - 1), corner.colView(0));
    copyTo(b.rowView(0), corner.rowView(dh + 1));
    copyTo(b.rowView(h - 1), corner.rowView(0));
    literalSolveLaplace(corner);

    copyTo(tile, extended.subRect(0, 0, h, w));
    copyTo(a.subRect(1, 0, dh, w), extended.subRect(h, 0, dh, w));
    copyTo(b.subRect(0, 1, h, dw), extended.subRect(0, w, h, dw));
    copyTo(corner.subRect(1, 1, dh, dw), extended.subRect(h, w, dh, dw));
}

} // namespace Reference
