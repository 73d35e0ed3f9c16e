#include "deblur/estimate/seedKernels.h"

#include "deblur/estimate/arrayOps.h"

#include <algorithm>

namespace CorvaneDeblur
{
namespace
{

template <typename Inside> floatArray shape(int size, const Inside &inside)
{
    const floatArray seed = floatArray::allocate(size, size);
    for (int y = 0; y < size; ++y)
        for (int x = 0; x < size; ++x)
            seed.at(y, x) = inside(y, x) ? 1.0f : 0.0f;
    normaliseSum(seed);
    return seed;
}

} // namespace

std::array<floatArray, 12> makeSeedKernels()
{
    std::array<floatArray, 12> seeds;
    std::size_t next = 0;
    for (const int size : {3, 5})
    {
        const int middle = size / 2;
        seeds[next++] = shape(size, [&](int y, int x) { return y == middle && x == middle; });
        seeds[next++] = shape(size, [&](int, int x) { return x == middle; });
        seeds[next++] = shape(size, [&](int y, int) { return y == middle; });
        seeds[next++] = shape(size, [&](int y, int x) { return x == y; });
        seeds[next++] = shape(size, [&](int y, int x) { return x + y == size - 1; });
        seeds[next++] =
            shape(size, [&](int y, int x) { return std::abs(y - middle) <= 1 && std::abs(x - middle) <= 1; });
    }
    return seeds;
}

floatArray placedSeed(const floatArray &seed, int rows, int cols)
{
    const floatArray placed = floatArray::allocate(rows, cols);
    fill(placed, 0.0f);
    copyTo(seed.subRect(0, 0, std::min(seed.rows, rows), std::min(seed.cols, cols)), placed);
    return placed;
}

} // namespace CorvaneDeblur
