#include "deblur/estimate/imageStructure.h"

#include "deblur/estimate/resample.h"

#include <algorithm>
#include <cmath>

namespace CorvaneDeblur
{

bool hasStructure(const floatArray &grey, int size, double reduction)
{
    constexpr float step = 3.0f / 255.0f;
    const double scale = std::min(1.0, 5.0 / std::max(size, 31) * reduction);
    const auto reduced = [&](int side) { return std::max(2, static_cast<int>(std::lround(side * scale))); };
    const auto small = floatArray::allocate(reduced(grey.rows), reduced(grey.cols));
    resize(grey, small);
    for (int y = 0; y + 1 < small.rows; ++y)
        for (int x = 0; x + 1 < small.cols; ++x)
            if (std::abs(small.at(y, x + 1) - small.at(y, x)) > step ||
                std::abs(small.at(y + 1, x) - small.at(y, x)) > step)
                return true;
    return false;
}

} // namespace CorvaneDeblur
