#include "deblur/deconv/shrinkageLookup.h"

#include "platform/math/multiversion.h"

#include <algorithm>
#include <cmath>
#include <cstring>

namespace CorvaneDeblur
{
namespace
{

constexpr float tableStart = -10.0f;
constexpr float tableReciprocal = 1.0f / 0.0001f;
constexpr int block = 32; ///< differences looked at together

/// The two entries around a position.
struct interval
{
    float left, right;
};

/// d = b - a; returns whether any magnitude reaches `dead` (NaN does). An or of integers, unlike a largest float, may
/// be taken in any order, so the loop vectorises.
inline bool differences(const float *a, const float *b, float dead, float *d)
{
    int alive = 0;
    for (int i = 0; i < block; ++i)
    {
        d[i] = b[i] - a[i];
        alive |= static_cast<int>(!(std::fabs(d[i]) < dead));
    }
    return alive != 0;
}

/// Positions in the table, whole and with their fraction, in a loop of their own so that only the loads of the next
/// one are scalar.
inline void positions(const float *d, int lastInterval, int *index, float *fraction)
{
    const float last = static_cast<float>(lastInterval);
    for (int i = 0; i < block; ++i)
    {
        const float q = (d[i] - tableStart) * tableReciprocal;
        const float inside = q > 0.0f ? (q < last ? q : last) : 0.0f;
        index[i] = static_cast<int>(inside);
        fraction[i] = q - static_cast<float>(index[i]);
    }
}

inline void interpolate(const interval *around, const float *fraction, float *out)
{
    for (int i = 0; i < block; ++i)
        out[i] = (around[i].right - around[i].left) * fraction[i] + around[i].left;
}

STILLMARK_MULTIVERSION
void shrinkDifferences(const float *table, int lastInterval, float dead, const float *a, const float *b, float *shrunk,
                       int count)
{
    int i = 0;
    for (; i + block <= count; i += block)
    {
        float d[block], fraction[block];
        int index[block];
        interval around[block];
        if (!differences(a + i, b + i, dead, d))
        {
            std::memset(shrunk + i, 0, sizeof(d));
            continue;
        }
        positions(d, lastInterval, index, fraction);
        for (int j = 0; j < block; ++j)
            std::memcpy(&around[j], table + index[j], sizeof(interval));
        interpolate(around, fraction, shrunk + i);
    }
    for (; i < count; ++i)
        shrunk[i] = shrinkageLookup(table, b[i] - a[i], tableStart, tableReciprocal, lastInterval);
}

} // namespace

differenceShrinker::differenceShrinker(std::span<const float> entries)
    : table(entries.data()), lastInterval(static_cast<int>(entries.size()) - 2)
{
    // The middle entry belongs to 0. One entry less on each side: a position is rounded before it is looked up.
    const int middle = static_cast<int>(entries.size()) / 2;
    int reach = 0;
    while (reach < middle && table[middle + reach] == 0.0f && table[middle - reach] == 0.0f)
        ++reach;
    dead = static_cast<float>(std::max(reach - 2, 0)) / tableReciprocal;
}

void differenceShrinker::run(const float *a, const float *b, float *shrunk, int count) const
{
    shrinkDifferences(table, lastInterval, dead, a, b, shrunk, count);
}

} // namespace CorvaneDeblur
