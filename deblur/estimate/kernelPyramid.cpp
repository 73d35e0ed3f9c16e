#include "deblur/estimate/kernelPyramid.h"

#include <algorithm>
#include <cassert>
#include <cmath>

namespace CorvaneDeblur
{

int scaledSize(int size, float factor)
{
    return static_cast<int>(static_cast<float>(size) * factor + 0.5f);
}

std::vector<levelSize> buildPyramid(int cols, int rows, float scale, int minimumSize, int finestSkipped)
{
    assert(std::min(cols, rows) >= minimumSize);
    const double smaller = std::min(cols, rows), factor = static_cast<double>(scale);
    int levels = static_cast<int>(std::log(smaller / minimumSize) / std::log(1.0 / factor) + 0.5);
    while (static_cast<int>(std::pow(factor, levels - 1) * smaller + 0.5) > minimumSize)
        ++levels;

    const auto odd = [](int n) { return n % 2 == 0 ? n + 1 : n; };
    std::vector<levelSize> sizes;
    for (int k = levels - 1; k >= finestSkipped; --k)
    {
        const float f = static_cast<float>(std::pow(factor, k));
        const levelSize size =
            k < 1 ? levelSize{cols, rows} : levelSize{odd(scaledSize(cols, f)), odd(scaledSize(rows, f))};
        if (sizes.empty() || !(sizes.back() == size))
            sizes.push_back(size);
    }
    return sizes;
}

} // namespace CorvaneDeblur
