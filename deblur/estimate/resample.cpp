#include "deblur/estimate/resample.h"

#include "deblur/estimate/arrayOps.h"
#include "platform/math/multiversion.h"
#include "platform/math/vectorOps.h"
#include "platform/math/workers.h"

#include <algorithm>
#include <cmath>
#include <vector>

namespace CorvaneDeblur
{
namespace
{

/// Where one source sample goes when an axis shrinks: `first` of it into destination `lo`, the rest into `hi`.
struct areaShare
{
    int lo, hi;
    float first, rest;
};

/// The shares of an axis that shrinks from `from` to `to` samples. The last source sample goes wholly into the last
/// destination sample.
std::vector<areaShare> areaShares(int from, int to)
{
    const float ratio = static_cast<float>(to) / static_cast<float>(from);
    std::vector<areaShare> shares(static_cast<std::size_t>(from));
    for (int i = 0; i + 1 < from; ++i)
    {
        const float a = static_cast<float>(i) * ratio, b = static_cast<float>(i + 1) * ratio;
        const int lo = std::min(static_cast<int>(a), to - 1), hi = std::min(static_cast<int>(b), to - 1);
        const float first = lo == hi ? ratio : static_cast<float>(hi) - a;
        shares[static_cast<std::size_t>(i)] = {lo, hi, first, ratio - first};
    }
    shares.back() = {to - 1, to - 1, ratio, 0.0f};
    return shares;
}

void shrinkCols(const floatArray &src, const floatArray &dst)
{
    const std::vector<areaShare> shares = areaShares(src.cols, dst.cols);
    inPieces(workers::all, src.rows, 64, [&](int begin, int end) {
        for (int y = begin; y < end; ++y)
        {
            const float *in = src.row(y);
            float *out = dst.row(y);
            std::fill_n(out, dst.cols, 0.0f);
            for (int i = 0; i < src.cols; ++i)
            {
                const areaShare &s = shares[static_cast<std::size_t>(i)];
                out[s.lo] += s.first * in[i];
                out[s.hi] += s.rest * in[i];
            }
        }
    });
}

void shrinkRows(const floatArray &src, const floatArray &dst)
{
    const std::vector<areaShare> shares = areaShares(src.rows, dst.rows);
    fill(dst, 0.0f);
    // By strips of columns, so that a strip's destination rows stay in the cache and strips are independent.
    inPieces(workers::all, src.cols, 512, [&](int begin, int end) {
        const std::size_t n = static_cast<std::size_t>(end - begin);
        for (int i = 0; i < src.rows; ++i)
        {
            const areaShare &s = shares[static_cast<std::size_t>(i)];
            saxpy(n, s.first, src.row(i) + begin, dst.row(s.lo) + begin);
            if (s.rest != 0.0f)
                saxpy(n, s.rest, src.row(i) + begin, dst.row(s.hi) + begin);
        }
    });
}

/// Between which two source samples a destination sample lies on an axis that grows.
struct between
{
    int index;
    float t; ///< share of sample index + 1; 0 at the ends
};

between positionOf(int x, float factor, int count)
{
    const float u = static_cast<float>((static_cast<double>(x) + 0.5) * static_cast<double>(factor) - 0.5);
    const int i = static_cast<int>(std::floor(u));
    if (i < 0)
        return {0, 0.0f};
    if (i >= count - 1)
        return {count - 1, 0.0f};
    return {i, u - static_cast<float>(i)};
}

STILLMARK_MULTIVERSION
void mixRows(const float *a, const float *b, float t, float *out, int count)
{
    for (int x = 0; x < count; ++x)
        out[x] = a[x] + (b[x] - a[x]) * t;
}

void enlarge(const floatArray &src, const floatArray &dst)
{
    const float fx = static_cast<float>(src.cols) / static_cast<float>(dst.cols);
    const float fy = static_cast<float>(src.rows) / static_cast<float>(dst.rows);
    std::vector<between> columns(static_cast<std::size_t>(dst.cols));
    for (int x = 0; x < dst.cols; ++x)
        columns[static_cast<std::size_t>(x)] = positionOf(x, fx, src.cols);

    // The two source rows in use, widened; each source row is widened at most once.
    const floatArray wide = floatArray::allocate(2, dst.cols);
    int held[2] = {-1, -1};
    const auto widened = [&](int y) -> const float * {
        float *out = wide.row(y % 2);
        if (held[y % 2] != y)
        {
            const float *in = src.row(y);
            for (int x = 0; x < dst.cols; ++x)
            {
                const between p = columns[static_cast<std::size_t>(x)];
                out[x] = p.t == 0.0f ? in[p.index] : in[p.index] + (in[p.index + 1] - in[p.index]) * p.t;
            }
            held[y % 2] = y;
        }
        return out;
    };
    for (int y = 0; y < dst.rows; ++y)
    {
        const between p = positionOf(y, fy, src.rows);
        const float *a = widened(p.index);
        mixRows(a, widened(std::min(p.index + 1, src.rows - 1)), p.t, dst.row(y), dst.cols);
    }
}

} // namespace

void resize(const floatArray &src, const floatArray &dst)
{
    assert(src.rows > 0 && src.cols > 0 && dst.rows > 0 && dst.cols > 0);
    const bool fewerCols = src.cols > dst.cols, fewerRows = src.rows > dst.rows;
    if (fewerCols && src.rows != dst.rows)
    {
        const floatArray narrow = floatArray::allocate(src.rows, dst.cols);
        shrinkCols(src, narrow);
        fewerRows ? shrinkRows(narrow, dst) : enlarge(narrow, dst);
    }
    else if (fewerCols)
        shrinkCols(src, dst);
    else if (fewerRows && src.cols < dst.cols)
    {
        const floatArray low = floatArray::allocate(dst.rows, src.cols);
        shrinkRows(src, low);
        enlarge(low, dst);
    }
    else if (fewerRows)
        shrinkRows(src, dst);
    else if (src.sameShape(dst))
        copyTo(src, dst);
    else
        enlarge(src, dst);
}

void subPixelCrop(const floatArray &src, const floatArray &dst, float centreX, float centreY)
{
    const float x0 = centreX - static_cast<float>(dst.cols - 1) * 0.5f;
    const float y0 = centreY - static_cast<float>(dst.rows - 1) * 0.5f;
    const int left = static_cast<int>(std::floor(x0)), top = static_cast<int>(std::floor(y0));
    const float tx = x0 - static_cast<float>(left), ty = y0 - static_cast<float>(top);
    const auto sample = [&](int y, int x) {
        return src.row(std::clamp(y, 0, src.rows - 1))[std::clamp(x, 0, src.cols - 1)];
    };
    for (int r = 0; r < dst.rows; ++r)
        for (int c = 0; c < dst.cols; ++c)
        {
            const int y = top + r, x = left + c;
            const float upper = sample(y, x) * (1.0f - tx) + sample(y, x + 1) * tx;
            const float lower = sample(y + 1, x) * (1.0f - tx) + sample(y + 1, x + 1) * tx;
            dst.row(r)[c] = upper * (1.0f - ty) + lower * ty;
        }
}

} // namespace CorvaneDeblur
