#pragma once

#include "tests/support/npy.h"

#include <algorithm>

namespace TestSupport
{

/// The photograph-like picture, 560 x 420, that the reference measures were taken on.
inline CorvaneDeblur::floatArray measuresImage()
{
    const CorvaneDeblur::byteArray levels = readBytes("measures", "image");
    const auto grey = CorvaneDeblur::floatArray::allocate(levels.rows, levels.cols);
    for (int y = 0; y < grey.rows; ++y)
        std::transform(levels.row(y), levels.row(y) + levels.cols, grey.row(y),
                       [](std::uint8_t level) { return static_cast<float>(level) / 255.0f; });
    return grey;
}

} // namespace TestSupport
