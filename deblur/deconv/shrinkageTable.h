#pragma once

#include "deblur/estimate/floatArray.h"

#include <vector>

namespace CorvaneDeblur
{

/// Entry i belongs to the gradient v = (i - 100000) / 100000 * 10: v runs from -10 to 10 in steps of 0.0001. It holds
/// the w that minimises |w|^alpha + (beta / 2) * (w - v)^2.
using shrinkageTable = std::vector<float>;
constexpr int shrinkageTableEntries = 200001;

/// Solves a table: soft threshold for alpha = 1, the exact minimum for 2/3 and 1/2 (each within 2^-23), four Newton
/// steps from w = v for any other alpha. In double, stored single; the table is odd. beta > 0.
/// Runs on all threads of the current tbb arena; the calling thread takes up no foreign work meanwhile, so that it may
/// hold a lock.
shrinkageTable buildShrinkageTable(float beta, float alpha);

/// out = table looked up at each sample of in with linear interpolation; the table's first entry belongs to `start`,
/// neighbours lie `step` apart. The index is clamped and the end intervals are continued; NaN takes index 0. A step
/// that is not positive fills out with the first entry. in may be out. Sample by sample: the methods' own sweeps use
/// the quicker differenceShrinker (shrinkageLookup.h).
void applyShrinkage(const floatArray &in, const shrinkageTable &table, float start, float step, const floatArray &out);

} // namespace CorvaneDeblur
