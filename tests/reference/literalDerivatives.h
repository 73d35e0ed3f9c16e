#pragma once

#include "platform/math/complexSample.h"

#include <cmath>
#include <numbers>

namespace Reference
{

/// Spectrum of the forward difference at frequency u of n: exp(2 pi i u / n) - 1.
inline CorvaneDeblur::complexSample differenceSpectrum(int u, int n)
{
    const double angle = 2.0 * std::numbers::pi * u / n;
    return {static_cast<float>(std::cos(angle) - 1.0), static_cast<float>(std::sin(angle))};
}

} // namespace Reference
