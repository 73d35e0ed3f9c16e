#pragma once

#include <span>

namespace CorvaneDeblur
{

/// One look-up with linear interpolation: the table's first entry belongs to `start`, neighbours lie 1 / reciprocal
/// apart, lastInterval is the number of entries less 2. The index is clamped and the end intervals are continued; NaN
/// takes index 0. Single precision as it stands: the position is rounded before it is taken apart.
inline float shrinkageLookup(const float *table, float value, float start, float reciprocal, int lastInterval)
{
    const float q = (value - start) * reciprocal;
    const float last = static_cast<float>(lastInterval);
    const float inside = q > 0.0f ? (q < last ? q : last) : 0.0f;
    const int i = static_cast<int>(inside);
    return (table[i + 1] - table[i]) * (q - static_cast<float>(i)) + table[i];
}

/// Look-ups of whole lines of differences in one of the stores' tables (from -10 in steps of 0.0001).
class differenceShrinker
{
public:
    explicit differenceShrinker(std::span<const float> table);

    /// shrunk[i] = the table at b[i] - a[i]. `shrunk` overlaps neither a nor b.
    void run(const float *a, const float *b, float *shrunk, int count) const;

private:
    const float *table;
    int lastInterval;
    float dead; ///< differences of a smaller magnitude are 0 in the table, and need no look-up
};

} // namespace CorvaneDeblur
