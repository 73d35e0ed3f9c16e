#pragma once

#include <vector>

namespace CorvaneDeblur
{

/// Exponent of the hyper-Laplacian prior.
constexpr float priorExponent = 2.0f / 3.0f;

/// beta of each round of the half-quadratic splitting: 1, times 2 * sqrt(2) from round to round, while below 256.
std::vector<float> splittingBetas();

/// Power of the forward difference along an axis of `size` samples at its first `count` frequencies:
/// |exp(2 pi i f / size) - 1|^2.
std::vector<float> differencePower(int size, int count);

} // namespace CorvaneDeblur
