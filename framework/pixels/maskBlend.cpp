#include "framework/pixels/maskBlend.h"

#include "platform/math/multiversion.h"

#include <stdexcept>

namespace Sarnik
{
namespace
{

template <class Sample>
[[gnu::always_inline]] inline void blendBody(std::size_t n, const Sample *__restrict source,
                                             const Sample *__restrict mask, float full, Sample *__restrict result)
{
    for (std::size_t i = 0; i < n; ++i)
    {
        const float m = static_cast<float>(mask[i]) / full;
        const float s = static_cast<float>(source[i]), r = static_cast<float>(result[i]);
        const float mixed = (1.0f - m) * s + m * r;
        const float limited = mixed < full ? mixed : full;
        const Sample between = static_cast<Sample>(static_cast<int>(limited));
        result[i] = m <= 0.0f ? source[i] : m >= 1.0f ? result[i] : between;
    }
}

STILLMARK_MULTIVERSION
void blendRow(std::size_t n, const std::uint8_t *source, const std::uint8_t *mask, std::uint8_t *result)
{
    blendBody(n, source, mask, 255.0f, result);
}

STILLMARK_MULTIVERSION
void blendRow(std::size_t n, const std::uint16_t *source, const std::uint16_t *mask, std::uint16_t *result)
{
    blendBody(n, source, mask, 32768.0f, result);
}

STILLMARK_MULTIVERSION
void blendRow(std::size_t n, const float *__restrict source, const float *__restrict mask, float *__restrict result)
{
    for (std::size_t i = 0; i < n; ++i)
    {
        const float m = mask[i];
        const float mixed = (1.0f - m) * source[i] + m * result[i];
        result[i] = m >= 1.0f ? result[i] : m > 0.0f ? mixed : source[i]; // no selection where it is not a number
    }
}

template <class Sample>
void blendPlanes(CBasicPixmap &result, CBasicPixmap &source, int planes, int maskPlane, const CRect &shared)
{
    const auto n = static_cast<std::size_t>(shared.Width());
    const CPixelLock mask = source.LockArea(shared, maskPlane, CPixelAccess::read);
    for (int p = 0; p < planes; ++p)
    {
        const CPixelLock from = source.LockArea(shared, p, CPixelAccess::read);
        const CPixelLock to = result.LockArea(shared, p, CPixelAccess::write);
        for (std::int32_t y = shared.top; y < shared.bottom; ++y)
            blendRow(n, from[0].Row<const Sample>(y), mask[0].Row<const Sample>(y), to[0].Row<Sample>(y));
    }
}

} // namespace

void blendByMask(CBasicPixmap &result, CBasicPixmap &source, int planes, int maskPlane)
{
    if (result.GetDepth() != source.GetDepth())
        throw std::invalid_argument("pixels of two depths cannot be mixed");
    const CRect shared = result.Bounds().Intersected(source.Bounds());
    if (shared.Empty())
        return;
    switch (result.GetDepth())
    {
    case 8:
        return blendPlanes<std::uint8_t>(result, source, planes, maskPlane, shared);
    case 16:
        return blendPlanes<std::uint16_t>(result, source, planes, maskPlane, shared);
    case 32:
        return blendPlanes<float>(result, source, planes, maskPlane, shared);
    default:
        throw std::invalid_argument("only samples of 8, 16 or 32 bits can be mixed");
    }
}

} // namespace Sarnik
