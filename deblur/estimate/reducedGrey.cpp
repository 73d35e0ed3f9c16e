#include "deblur/estimate/reducedGrey.h"

#include "deblur/estimate/arrayOps.h"
#include "deblur/estimate/finiteSamples.h"
#include "deblur/estimate/resample.h"

#include <algorithm>

namespace CorvaneDeblur
{
namespace
{

constexpr int largestStripRows = 256;
constexpr int stripSamples = 1 << 22; ///< 16 MB of a strip, whatever the width of the image

/// dst += weight * src, for one row.
void addRow(float weight, const float *src, float *dst, int count)
{
    for (int x = 0; x < count; ++x)
        dst[x] += weight * src[x];
}

/// Adds a strip's rows, which start at `firstRow` of `sourceRows`, to the rows of dst that they shrink into: the area
/// weighting of `resize`, row by row in the same order.
void shrinkRowsInto(const floatArray &dst, const floatArray &strip, int firstRow, int sourceRows)
{
    const float ratio = static_cast<float>(dst.rows) / static_cast<float>(sourceRows);
    const int last = dst.rows - 1;
    for (int y = 0; y < strip.rows; ++y)
    {
        const int i = firstRow + y;
        if (i == sourceRows - 1)
        {
            addRow(ratio, strip.row(y), dst.row(last), dst.cols);
            continue;
        }
        const float from = static_cast<float>(i) * ratio, to = static_cast<float>(i + 1) * ratio;
        const int lo = std::min(static_cast<int>(from), last), hi = std::min(static_cast<int>(to), last);
        const float first = lo == hi ? ratio : static_cast<float>(hi) - from;
        addRow(first, strip.row(y), dst.row(lo), dst.cols);
        if (const float rest = ratio - first; rest != 0.0f)
            addRow(rest, strip.row(y), dst.row(hi), dst.cols);
    }
}

} // namespace

floatArray readFinite(greySource &source, const regionRect &rect)
{
    const floatArray grey = floatArray::allocate(rect.height, rect.width);
    source.readGrey(rect, grey);
    zeroNonFinite(grey);
    return grey;
}

floatArray reducedGrey(greySource &source, int largestSide, const std::atomic<bool> *stop)
{
    const int cols = source.cols(), rows = source.rows();
    if (cols < 1 || rows < 1)
        return {};
    if (std::max(cols, rows) <= largestSide)
        return readFinite(source, {0, 0, cols, rows});

    const float scale = static_cast<float>(largestSide) / static_cast<float>(std::max(cols, rows));
    const auto scaled = [scale](int length) {
        return std::max(1, static_cast<int>(static_cast<float>(length) * scale + 0.5f));
    };
    const floatArray reduced = floatArray::allocate(scaled(rows), scaled(cols));
    fill(reduced, 0.0f);

    const int stripRows = std::clamp(stripSamples / cols, 1, largestStripRows);
    const floatArray narrow = floatArray::allocate(std::min(stripRows, rows), reduced.cols);
    for (int y = 0; y < rows; y += stripRows)
    {
        if (stop != nullptr && stop->load(std::memory_order_relaxed))
            return {};
        const int height = std::min(stripRows, rows - y);
        const floatArray strip = readFinite(source, {0, y, cols, height});
        const floatArray narrowStrip = narrow.subRect(0, 0, height, reduced.cols);
        resize(strip, narrowStrip);
        shrinkRowsInto(reduced, narrowStrip, y, rows);
    }
    return reduced;
}

} // namespace CorvaneDeblur
