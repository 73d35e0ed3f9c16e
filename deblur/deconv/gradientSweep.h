#pragma once

#include "deblur/deconv/shrinkageTableStore.h"
#include "platform/math/realTransform2d.h"

namespace CorvaneDeblur
{

/// The step of a hyper-Laplacian round that works on pixels, in one sweep over the rows: circular differences of x in
/// both directions, shrinkage of each, the negative adjoints of both added up, and the row transforms of the sum:
///     spectrum = rows of F[ (h - h shifted right) + (v - v shifted down) ],
///     h = shrink(x shifted left - x), v = shrink(x shifted up - x).
/// Rows of zeros are recognised and not transformed; in the first rounds of most pictures that is all of them.
/// x: grid-sized. Returns false when every sample of the sum is exactly 0 (spectrum is then undefined).
bool shrunkGradientRows(const realTransform2d &grid, const floatArray &x, const shrinkageTable &table,
                        complexSample *spectrum, workers who);

} // namespace CorvaneDeblur
