#include "framework/pixels/pixmapScaler.h"

#include <algorithm>

namespace Sarnik
{
namespace
{

std::int64_t floorDivided(std::int64_t a, std::int64_t b)
{
    return a / b - (a % b < 0 ? 1 : 0);
}

} // namespace

CScaleAxis::Range CScaleAxis::Needed(Range pixels) const
{
    if (pixels.end <= pixels.first)
        return {};
    if (from >= to)
        return {pixels.first * from / to, std::min(from, (pixels.end * from + to - 1) / to)};
    // The sample left of the first pixel's middle to the one right of the last's.
    const auto leftOf = [this](std::int64_t i) { return floorDivided((2 * i + 1) * from - to, 2 * to); };
    return {std::max<std::int64_t>(0, leftOf(pixels.first)), std::min(from, leftOf(pixels.end - 1) + 2)};
}

CScaleAxis::Range CScaleAxis::Touched(Range samples) const
{
    if (samples.end <= samples.first)
        return {};
    if (from >= to)
        return {samples.first * to / from, std::min(to, (samples.end * to + from - 1) / from)};
    // Middles within one sample's width of a sample's middle; a pixel more on either side does no harm.
    const std::int64_t first = floorDivided((2 * samples.first - 1) * to, 2 * from) - 1;
    const std::int64_t end = floorDivided((2 * samples.end + 1) * to, 2 * from) + 2;
    return {std::max<std::int64_t>(0, samples.first == 0 ? 0 : first), samples.end == from ? to : std::min(to, end)};
}

int CScaleAxis::Weights(std::int64_t i, float *weights) const
{
    if (from == to)
    {
        weights[0] = 1.0f;
        return 1;
    }
    const Range needed = Needed({i, i + 1});
    const int count = static_cast<int>(needed.end - needed.first);
    if (from > to)
    {
        // In units of 1 / to of a sample: exact.
        const std::int64_t start = i * from, end = (i + 1) * from;
        for (int k = 0; k < count; ++k)
        {
            const std::int64_t left = std::max(start, (needed.first + k) * to);
            const std::int64_t right = std::min(end, (needed.first + k + 1) * to);
            weights[k] = static_cast<float>(static_cast<double>(right - left) / static_cast<double>(from));
        }
        return count;
    }
    const std::int64_t position = (2 * i + 1) * from - to; // of the middle, in units of 1 / (2 to), from sample 0's
    const std::int64_t rest = position - floorDivided(position, 2 * to) * 2 * to;
    const float right = static_cast<float>(static_cast<double>(rest) / static_cast<double>(2 * to));
    if (count == 1)
        weights[0] = 1.0f;
    else
    {
        weights[0] = 1.0f - right;
        weights[1] = right;
    }
    return count;
}

} // namespace Sarnik
