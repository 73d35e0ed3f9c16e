#pragma once

#include "deblur/estimate/floatArray.h"

namespace Reference
{

/// extendPeriodic strip by strip, each solved by sine transforms that are sums of their definition, in double. For
/// small strips: m x n interior cells cost m n (m + n) operations.
void literalExtendPeriodic(const CorvaneDeblur::floatArray &tile, const CorvaneDeblur::floatArray &extended);

/// Replaces the interior of the grid by the discrete harmonic function with the values of its outermost rows and
/// columns.
void literalSolveLaplace(const CorvaneDeblur::floatArray &grid);

} // namespace Reference
