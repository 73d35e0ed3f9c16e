#include "framework/pixels/pixmapScaler.h"

#include "platform/math/multiversion.h"

#include <algorithm>
#include <stdexcept>
#include <vector>

namespace Sarnik
{
namespace
{

template <class Sample>
[[gnu::always_inline]] inline void addBody(std::size_t n, const Sample *__restrict row, float weight,
                                           float *__restrict sums)
{
    for (std::size_t i = 0; i < n; ++i)
        sums[i] += weight * static_cast<float>(row[i]);
}

STILLMARK_MULTIVERSION
void addRow(std::size_t n, const std::uint8_t *row, float weight, float *sums)
{
    addBody(n, row, weight, sums);
}

STILLMARK_MULTIVERSION
void addRow(std::size_t n, const std::uint16_t *row, float weight, float *sums)
{
    addBody(n, row, weight, sums);
}

STILLMARK_MULTIVERSION
void addRow(std::size_t n, const float *row, float weight, float *sums)
{
    addBody(n, row, weight, sums);
}

/// Weights of some pixels in a row.
class weightTable
{
public:
    weightTable(const CScaleAxis &axis, std::int64_t first, std::int64_t end, std::int64_t firstSample)
    {
        std::vector<float> some(axis.MostWeights());
        for (std::int64_t i = first; i < end; ++i)
        {
            const int count = axis.Weights(i, some.data());
            taps.push_back({axis.Needed({i, i + 1}).first - firstSample, weights.size(), count});
            weights.insert(weights.end(), some.begin(), some.begin() + count);
        }
    }

    struct tap
    {
        std::int64_t sample; ///< the first one, from the area's first
        std::size_t weight;  ///< the first one
        int count;
    };
    std::vector<tap> taps;
    std::vector<float> weights;
};

template <class Sample> Sample rounded(float v)
{
    if constexpr (std::is_same_v<Sample, float>)
        return v;
    else
        return static_cast<Sample>(static_cast<int>(v + 0.5f));
}

/// Along a row of sums: each pixel from the samples that it needs.
template <class Sample> void narrow(const weightTable &columns, const float *sums, Sample *out)
{
    for (const weightTable::tap &tap : columns.taps)
    {
        const float *samples = sums + tap.sample, *weights = columns.weights.data() + tap.weight;
        float sum = 0.0f;
        for (int k = 0; k < tap.count; ++k)
            sum += weights[k] * samples[k];
        *out++ = rounded<Sample>(sum);
    }
}

template <class Sample>
void scalePlane(const CPixelArea &from, const CRect &area, const weightTable &columns, const weightTable &rows,
                const CPixelArea &to, std::vector<float> &sums)
{
    const auto n = static_cast<std::size_t>(area.Width());
    const std::int64_t skip = std::int64_t{area.left} - from.rect.left;
    for (std::size_t y = 0; y < rows.taps.size(); ++y)
    {
        const weightTable::tap &tap = rows.taps[y];
        std::fill_n(sums.begin(), n, 0.0f);
        for (int k = 0; k < tap.count; ++k)
            addRow(n, from.Row<const Sample>(static_cast<std::int32_t>(area.top + tap.sample + k)) + skip,
                   rows.weights[tap.weight + static_cast<std::size_t>(k)], sums.data());
        narrow(columns, sums.data(), to.Row<Sample>(to.rect.top + static_cast<std::int32_t>(y)));
    }
}

} // namespace

CPixmapScaler::CPixmapScaler(const CRect &largerRect, const CRect &ownRect)
    : larger(largerRect), own(ownRect), x(larger.Width(), own.Width()), y(larger.Height(), own.Height())
{
    if (larger.Empty() || own.Empty())
        throw std::invalid_argument("an empty picture cannot be scaled");
}

CRect CPixmapScaler::SourceOf(const CRect &area) const
{
    const CRect a = area.Intersected(own);
    if (a.Empty())
        return {};
    const CScaleAxis::Range across = x.Needed({std::int64_t{a.left} - own.left, std::int64_t{a.right} - own.left});
    const CScaleAxis::Range down = y.Needed({std::int64_t{a.top} - own.top, std::int64_t{a.bottom} - own.top});
    return {CRect::Clamped(larger.left + across.first), CRect::Clamped(larger.top + down.first),
            CRect::Clamped(larger.left + across.end), CRect::Clamped(larger.top + down.end)};
}

CRect CPixmapScaler::AreaOf(const CRect &source) const
{
    const CRect s = source.Intersected(larger);
    if (s.Empty())
        return {};
    const CScaleAxis::Range across =
        x.Touched({std::int64_t{s.left} - larger.left, std::int64_t{s.right} - larger.left});
    const CScaleAxis::Range down = y.Touched({std::int64_t{s.top} - larger.top, std::int64_t{s.bottom} - larger.top});
    return {CRect::Clamped(own.left + across.first), CRect::Clamped(own.top + down.first),
            CRect::Clamped(own.left + across.end), CRect::Clamped(own.top + down.end)};
}

void CPixmapScaler::Scale(CBasicPixmap &from, int firstFrom, CBasicPixmap &to, int firstTo, int count) const
{
    const CRect wanted = to.Bounds(), area = SourceOf(wanted);
    if (wanted.Empty())
        return;
    if (!own.Contains(wanted) || !from.Bounds().Contains(area) || from.GetDepth() != to.GetDepth())
        throw std::invalid_argument("these pixels cannot be scaled into those");
    const weightTable columns(x, std::int64_t{wanted.left} - own.left, std::int64_t{wanted.right} - own.left,
                              std::int64_t{area.left} - larger.left);
    const weightTable rows(y, std::int64_t{wanted.top} - own.top, std::int64_t{wanted.bottom} - own.top,
                           std::int64_t{area.top} - larger.top);
    std::vector<float> sums(static_cast<std::size_t>(area.Width()));
    for (int p = 0; p < count; ++p)
    {
        const CPixelArea in = from.Plane(firstFrom + p), out = to.Plane(firstTo + p);
        switch (from.GetDepth())
        {
        case 8:
            scalePlane<std::uint8_t>(in, area, columns, rows, out, sums);
            break;
        case 16:
            scalePlane<std::uint16_t>(in, area, columns, rows, out, sums);
            break;
        case 32:
            scalePlane<float>(in, area, columns, rows, out, sums);
            break;
        default:
            throw std::invalid_argument("only samples of 8, 16 or 32 bits can be scaled");
        }
    }
}

namespace
{

std::uint32_t partsOf(const CScaleAxis &axis)
{
    std::uint32_t parts = 1;
    while (axis.Reduces() && axis.Factor() > parts && parts < 65)
        parts *= 2;
    return parts;
}

} // namespace

CPixScaler::CPixScaler(const CRect &largerRect, const CRect &ownRect)
    : CPixmapScaler(largerRect, ownRect), factorX(partsOf(X())), factorY(partsOf(Y()))
{
}

CRect CPixScaler::Part(const CRect &cell, std::int64_t side, std::uint32_t step) const
{
    const std::int64_t column = step % factorX, row = step / factorX;
    return CRect{CRect::Clamped(cell.left + column * side / factorX), CRect::Clamped(cell.top + row * side / factorY),
                 CRect::Clamped(cell.left + (column + 1) * side / factorX),
                 CRect::Clamped(cell.top + (row + 1) * side / factorY)}
        .Intersected(cell);
}

} // namespace Sarnik
