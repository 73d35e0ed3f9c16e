#include "framework/pixels/fills.h"

#include <algorithm>
#include <cstring>

namespace Sarnik
{
namespace
{

template <class Sample> struct typedFills
{
    static void Fill(const CPixelArea &plane, const CRect &area, std::uint32_t value)
    {
        const std::int64_t skip = std::int64_t{area.left} - plane.rect.left;
        for (std::int32_t y = area.top; y < area.bottom; ++y)
            std::fill_n(plane.Row<Sample>(y) + skip, area.Width(), static_cast<Sample>(value));
    }

    static void Replicate(const CPixelArea &plane, const CRect &inner)
    {
        const CRect &all = plane.rect;
        const std::int64_t skip = std::int64_t{inner.left} - all.left;
        const auto bytes = static_cast<std::size_t>(inner.Width()) * sizeof(Sample);
        for (std::int32_t y = all.top; y < inner.top; ++y)
            std::memcpy(plane.Row<Sample>(y) + skip, plane.Row<Sample>(inner.top) + skip, bytes);
        for (std::int32_t y = inner.bottom; y < all.bottom; ++y)
            std::memcpy(plane.Row<Sample>(y) + skip, plane.Row<Sample>(inner.bottom - 1) + skip, bytes);

        const std::int64_t end = std::int64_t{inner.right} - all.left;
        for (std::int32_t y = all.top; y < all.bottom; ++y)
        {
            Sample *row = plane.Row<Sample>(y);
            std::fill_n(row, skip, row[skip]);
            std::fill(row + end, row + all.Width(), row[end - 1]);
        }
    }
};

template <class Visit> void byDepth(int depth, Visit visit)
{
    switch (depth)
    {
    case 8:
        visit(typedFills<std::uint8_t>());
        break;
    case 16:
        visit(typedFills<std::uint16_t>());
        break;
    case 32:
        visit(typedFills<std::uint32_t>());
        break;
    default:
        break;
    }
}

} // namespace

void fillArea(CBasicPixmap &pixmap, int plane, const CRect &area, std::uint32_t value)
{
    const CRect inside = area.Intersected(pixmap.Bounds());
    if (!inside.Empty())
        byDepth(pixmap.GetDepth(), [&](auto fills) { fills.Fill(pixmap.Plane(plane), inside, value); });
}

void fillBorder(CBasicPixmap &pixmap, int plane, const CRect &wanted, std::uint32_t value)
{
    const CRect all = pixmap.Bounds(), inner = wanted.Intersected(all);
    if (inner.Empty())
        return fillArea(pixmap, plane, all, value);
    fillArea(pixmap, plane, {all.left, all.top, all.right, inner.top}, value);
    fillArea(pixmap, plane, {all.left, inner.top, inner.left, inner.bottom}, value);
    fillArea(pixmap, plane, {inner.right, inner.top, all.right, inner.bottom}, value);
    fillArea(pixmap, plane, {all.left, inner.bottom, all.right, all.bottom}, value);
}

void replicateBorder(CBasicPixmap &pixmap, int plane, const CRect &wanted)
{
    const CRect inner = wanted.Intersected(pixmap.Bounds());
    if (!inner.Empty())
        byDepth(pixmap.GetDepth(), [&](auto fills) { fills.Replicate(pixmap.Plane(plane), inner); });
}

} // namespace Sarnik
