#pragma once

#include <algorithm>
#include <cstddef>
#include <cstring>

namespace CorvaneDeblur
{

/// out[i] = shrinkageLookup of value(i) for i < count, the same bits, in half the time: a loop with look-ups in it
/// stays scalar, so positions and interpolation run in vector loops of their own around the look-ups. value(i) is read
/// before out[i] is written, a block at a time; reading out[j], j >= i, in it is fine, and the table lies elsewhere. To
/// be called from a STILLMARK_MULTIVERSION function, into which it is inlined.
template <typename Value>
[[gnu::always_inline]] inline void blockShrinkage(const float *table, float start, float reciprocal, int lastInterval,
                                                  const Value &value, float *out, std::ptrdiff_t count)
{
    struct interval
    {
        float low, high;
    };
    constexpr int blockSize = 128;
    int index[blockSize];
    float fraction[blockSize];
    interval ends[blockSize];

    const float last = static_cast<float>(lastInterval);
    for (std::ptrdiff_t first = 0; first < count; first += blockSize)
    {
        const int size = static_cast<int>(std::min<std::ptrdiff_t>(blockSize, count - first));
        for (int j = 0; j < size; ++j)
        {
            const float q = (value(first + j) - start) * reciprocal;
            const float inside = q > 0.0f ? (q < last ? q : last) : 0.0f;
            index[j] = static_cast<int>(inside);
            fraction[j] = q - static_cast<float>(index[j]);
        }
        for (int j = 0; j < size; ++j)
            std::memcpy(&ends[j], table + index[j], sizeof(interval));
        for (int j = 0; j < size; ++j)
            out[first + j] = (ends[j].high - ends[j].low) * fraction[j] + ends[j].low;
    }
}

} // namespace CorvaneDeblur
