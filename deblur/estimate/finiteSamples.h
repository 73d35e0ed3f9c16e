#pragma once

#include "deblur/estimate/floatArray.h"

#include <cmath>

namespace CorvaneDeblur
{

/// Sets samples that are not finite to 0: float pictures may hold them, and one would spoil a whole transform.
inline void zeroNonFinite(const floatArray &a)
{
    for (int y = 0; y < a.rows; ++y)
    {
        float *samples = a.row(y);
        for (int x = 0; x < a.cols; ++x)
            samples[x] = std::isfinite(samples[x]) ? samples[x] : 0.0f;
    }
}

} // namespace CorvaneDeblur
