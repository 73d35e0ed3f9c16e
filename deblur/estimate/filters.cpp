#include "deblur/estimate/filters.h"

#include "deblur/estimate/arrayOps.h"
#include "platform/math/vectorOps.h"

#include <algorithm>
#include <vector>

namespace CorvaneDeblur
{

void gaussianFill(const floatArray &a, float sigmaRows, float sigmaCols)
{
    gaussianFill(a, sigmaRows, sigmaCols, static_cast<float>((a.cols - 1) / 2), static_cast<float>((a.rows - 1) / 2));
}

void gaussianFill(const floatArray &a, float sigmaRows, float sigmaCols, float centreX, float centreY)
{
    if (sigmaCols == 0.0f)
        sigmaCols = sigmaRows;
    for (int y = 0; y < a.rows; ++y)
    {
        float *row = a.row(y);
        const float dy = static_cast<float>(y) - centreY;
        for (int x = 0; x < a.cols; ++x)
        {
            const float dx = static_cast<float>(x) - centreX;
            row[x] = -(dy * dy) / (2.0f * sigmaRows * sigmaRows) - (dx * dx) / (2.0f * sigmaCols * sigmaCols);
        }
        vsExp(static_cast<std::size_t>(a.cols), row, row);
    }
    normaliseSum(a);
}

void forwardDiffX(const floatArray &a, const floatArray &out)
{
    for (int y = 0; y < a.rows; ++y)
    {
        vsSub(static_cast<std::size_t>(a.cols - 1), a.row(y) + 1, a.row(y), out.row(y));
        out.row(y)[a.cols - 1] = 0.0f;
    }
}

void forwardDiffY(const floatArray &a, const floatArray &out)
{
    for (int y = 0; y + 1 < a.rows; ++y)
        vsSub(static_cast<std::size_t>(a.cols), a.row(y + 1), a.row(y), out.row(y));
    std::fill_n(out.row(a.rows - 1), a.cols, 0.0f);
}

void circularDiffX(const floatArray &a, const floatArray &out)
{
    for (int y = 0; y < a.rows; ++y)
    {
        vsSub(static_cast<std::size_t>(a.cols - 1), a.row(y) + 1, a.row(y), out.row(y));
        out.row(y)[a.cols - 1] = a.row(y)[0] - a.row(y)[a.cols - 1];
    }
}

void circularDiffY(const floatArray &a, const floatArray &out)
{
    for (int y = 0; y < a.rows; ++y)
        vsSub(static_cast<std::size_t>(a.cols), a.row(y + 1 < a.rows ? y + 1 : 0), a.row(y), out.row(y));
}

void laplacian(const floatArray &a, const floatArray &out, laplacianEdge edge)
{
    for (int y = 0; y < a.rows; ++y)
        for (int x = 0; x < a.cols; ++x)
        {
            float neighbours = 0.0f;
            int inside = 0;
            const auto add = [&](int ny, int nx) {
                if (ny < 0 || nx < 0 || ny >= a.rows || nx >= a.cols)
                    return;
                neighbours += a.row(ny)[nx];
                ++inside;
            };
            add(y - 1, x);
            add(y + 1, x);
            add(y, x - 1);
            add(y, x + 1);
            const float n = edge == laplacianEdge::zero ? 4.0f : static_cast<float>(inside);
            out.row(y)[x] = n * a.row(y)[x] - neighbours;
        }
}

namespace
{

/// out[i] = sum of in[i - radius .. i + radius], for `lines` lines side by side: sample i of line c at i * stride + c.
void runningSum(const float *in, float *out, int length, int lines, std::ptrdiff_t inStride, std::ptrdiff_t outStride,
                int radius)
{
    std::vector<float> sum(static_cast<std::size_t>(lines), 0.0f);
    for (int i = -radius; i < length; ++i)
    {
        if (i + radius < length)
        {
            const float *entering = in + (i + radius) * inStride;
            for (int c = 0; c < lines; ++c)
                sum[static_cast<std::size_t>(c)] += entering[c];
        }
        if (i - radius - 1 >= 0)
        {
            const float *leaving = in + (i - radius - 1) * inStride;
            for (int c = 0; c < lines; ++c)
                sum[static_cast<std::size_t>(c)] -= leaving[c];
        }
        if (i >= 0)
            std::copy_n(sum.data(), lines, out + i * outStride);
    }
}

} // namespace

void boxSum(const floatArray &a, const floatArray &out, int radiusRows, int radiusCols)
{
    if (radiusCols < 0)
        radiusCols = radiusRows;
    const floatArray columns = floatArray::allocate(a.rows, a.cols);
    runningSum(a.data, columns.data, a.rows, a.cols, a.stride, columns.stride, radiusRows);
    for (int y = 0; y < a.rows; ++y)
        runningSum(columns.row(y), out.row(y), a.cols, 1, 1, 1, radiusCols);
}

} // namespace CorvaneDeblur
