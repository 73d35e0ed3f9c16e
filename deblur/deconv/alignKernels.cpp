#include "deblur/deconv/alignKernels.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/fourier.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>

namespace CorvaneDeblur
{
namespace
{

struct place
{
    float row = 0.0f, col = 0.0f;
};

struct wholeShift
{
    int row = 0, col = 0;
};

bool canBeAligned(const latentKernel &trace)
{
    return !trace.kernel.empty() && std::isfinite(sumAbs(trace.kernel));
}

std::size_t nearestToTheMiddle(const std::vector<latentKernel> &kernels)
{
    int left = kernels[0].regionLeft, top = kernels[0].regionTop;
    int right = kernels[0].regionRight, bottom = kernels[0].regionBottom;
    for (const latentKernel &trace : kernels)
    {
        left = std::min(left, trace.regionLeft);
        top = std::min(top, trace.regionTop);
        right = std::max(right, trace.regionRight);
        bottom = std::max(bottom, trace.regionBottom);
    }
    const auto middle = [](int a, int b) { return (static_cast<float>(a) + static_cast<float>(b)) / 2.0f; };
    const auto squaredDistance = [&](const latentKernel &trace) {
        const float dx = middle(trace.regionLeft, trace.regionRight) - middle(left, right);
        const float dy = middle(trace.regionTop, trace.regionBottom) - middle(top, bottom);
        return dx * dx + dy * dy;
    };
    const auto nearest = std::min_element(kernels.begin(), kernels.end(), [&](const auto &a, const auto &b) {
        return squaredDistance(a) < squaredDistance(b);
    });
    return static_cast<std::size_t>(nearest - kernels.begin());
}

/// First moments, not divided by the sum: the kernels sum to about 1.
place centroid(const floatArray &kernel)
{
    place sum;
    for (int y = 0; y < kernel.rows; ++y)
        for (int x = 0; x < kernel.cols; ++x)
        {
            sum.row += kernel.at(y, x) * static_cast<float>(y);
            sum.col += kernel.at(y, x) * static_cast<float>(x);
        }
    return sum;
}

/// Kernels come out of files, too: one that sums to a million must not be moved by as much.
int limitedOffset(int shift, float total, std::size_t count, int size)
{
    const float whole = std::trunc(0.5f - total / static_cast<float>(count));
    const float limit = static_cast<float>(size);
    return std::clamp(shift + static_cast<int>(std::clamp(whole, -limit, limit)), -size, size);
}

floatArray moved(const floatArray &kernel, int rowOffset, int colOffset)
{
    const int pad = std::max(std::abs(rowOffset), std::abs(colOffset));
    const floatArray larger = floatArray::allocate(kernel.rows + 2 * pad, kernel.cols + 2 * pad);
    fill(larger, 0.0f);
    copyTo(kernel, larger.subRect(pad + rowOffset, pad + colOffset, kernel.rows, kernel.cols));
    return larger;
}

} // namespace

void kernelShift(const floatArray &a, const floatArray &b, int &rowShift, int &colShift)
{
    const bool swapped = a.cols <= b.cols;
    const floatArray &larger = swapped ? b : a, &smaller = swapped ? a : b;
    const int padRows = larger.rows / 2, padCols = larger.cols / 2;
    const floatArray padded = padArray(larger, padRows, padRows, padCols, padCols, borderMode::constant);
    const int rows = padded.rows - smaller.rows + 1, cols = padded.cols - smaller.cols + 1;

    int row = a.cols < b.cols, col = row;
    if (rows > 0 && cols > 0)
    {
        const floatArray all = floatArray::allocate(padded.rows, padded.cols);
        correlateFFT(padded, all, smaller, borderMode::constant);
        const floatArray valid = all.subRect((smaller.rows - 1) / 2, (smaller.cols - 1) / 2, rows, cols);
        float best = 0.0f;
        for (int y = 0; y < rows; ++y)
            for (int x = 0; x < cols; ++x)
                if (valid.at(y, x) > best)
                {
                    best = valid.at(y, x);
                    row = y;
                    col = x;
                }
    }
    const int sign = swapped ? -1 : 1;
    rowShift = sign * (row - rows / 2);
    colShift = sign * (col - cols / 2);
}

void alignKernels(std::vector<latentKernel> &kernels)
{
    if (kernels.empty() || !std::all_of(kernels.begin(), kernels.end(), canBeAligned))
        return;
    const std::size_t reference = nearestToTheMiddle(kernels);
    std::vector<wholeShift> shifts(kernels.size());
    place total;
    for (std::size_t i = 0; i < kernels.size(); ++i)
    {
        const floatArray &kernel = kernels[i].kernel;
        if (i != reference)
            kernelShift(kernels[reference].kernel, kernel, shifts[i].row, shifts[i].col);
        const place centre = centroid(kernel);
        total.row += static_cast<float>(shifts[i].row) + centre.row - static_cast<float>(kernel.rows / 2);
        total.col += static_cast<float>(shifts[i].col) + centre.col - static_cast<float>(kernel.cols / 2);
    }
    for (std::size_t i = 0; i < kernels.size(); ++i)
    {
        floatArray &kernel = kernels[i].kernel;
        kernel = moved(kernel, limitedOffset(shifts[i].row, total.row, kernels.size(), kernel.rows),
                       limitedOffset(shifts[i].col, total.col, kernels.size(), kernel.cols));
    }
}

} // namespace CorvaneDeblur
