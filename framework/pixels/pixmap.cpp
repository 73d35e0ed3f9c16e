#include "framework/pixels/pixmap.h"

#include <cstring>
#include <stdexcept>
#include <utility>

namespace Sarnik
{

CPixelLock::~CPixelLock()
{
    if (pixmap != nullptr)
        pixmap->Unlock(pins, access);
}

void CPixelLock::Swap(CPixelLock &other) noexcept
{
    std::swap(rect, other.rect);
    planes.swap(other.planes);
    std::swap(pixmap, other.pixmap);
    pins.swap(other.pins);
    std::swap(access, other.access);
}

void copyPlanes(CPixmap &destination, int firstDestination, CPixmap &source, int firstSource, int count,
                const CRect &rect)
{
    if (destination.GetDepth() != source.GetDepth())
        throw std::invalid_argument("pixels cannot be copied between depths");
    const std::int64_t sampleBytes = source.GetDepth() / 8;
    const CRect shared = rect.Intersected(destination.Bounds());

    forEachPiece(source, shared, firstSource, count, CPixelAccess::read, [&](const CPixelLock &from) {
        forEachPiece(destination, from.Rect(), firstDestination, count, CPixelAccess::write, [&](const CPixelLock &to) {
            const CRect &r = to.Rect();
            const auto bytes = static_cast<std::size_t>(r.Width() * sampleBytes);
            const std::int64_t skip = (std::int64_t{r.left} - from.Rect().left) * sampleBytes;
            for (int p = 0; p < count; ++p)
                for (std::int32_t y = r.top; y < r.bottom; ++y)
                    std::memcpy(to[p].Row<std::byte>(y), from[p].Row<std::byte>(y) + skip, bytes);
        });
    });
}

} // namespace Sarnik
