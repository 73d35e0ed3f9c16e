#include "deblur/deconv/splittingRounds.h"

#include <cmath>
#include <numbers>

namespace CorvaneDeblur
{

std::vector<float> splittingBetas()
{
    const float rate = std::sqrt(2.0f) + std::sqrt(2.0f);
    std::vector<float> betas;
    for (float beta = 1.0f; beta < 256.0f; beta *= rate)
        betas.push_back(beta);
    return betas;
}

std::vector<float> differencePower(int size, int count)
{
    std::vector<float> power(static_cast<std::size_t>(count));
    for (int f = 0; f < count; ++f)
        power[static_cast<std::size_t>(f)] =
            static_cast<float>(2.0 - 2.0 * std::cos(2.0 * std::numbers::pi * f / size));
    return power;
}

} // namespace CorvaneDeblur
