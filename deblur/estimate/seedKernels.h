#pragma once

#include "deblur/estimate/floatArray.h"

#include <array>

namespace CorvaneDeblur
{

/// Twelve simple shapes that the coarsest levels can start from, each summing to 1: of 3 x 3 and then of 5 x 5 samples
/// the centre, the middle column, the middle row, the main diagonal, the anti-diagonal, and the 3 x 3 block.
std::array<floatArray, 12> makeSeedKernels();

/// A fresh rows x cols array with the seed in its top left corner, cut or continued with zeros where shapes differ.
floatArray placedSeed(const floatArray &seed, int rows, int cols);

} // namespace CorvaneDeblur
