#pragma once

#include "deblur/estimate/floatArray.h"

namespace CorvaneDeblur
{

/// Grows a tile to a periodic grid: the tile in the top left corner of `extended` (allocated by the caller, at least
/// the tile's size), the added strips filled with the smoothest surface that joins the tile's bottom edge to its top
/// edge and its right edge to its left edge, so that the grid's periodic continuation has no jump.
void extendPeriodic(const floatArray &tile, const floatArray &extended);

/// Replaces the interior of the grid by the discrete harmonic function with the values of its outermost rows and
/// columns. A grid without an interior stays as it is.
void solveLaplace(const floatArray &grid);

} // namespace CorvaneDeblur
