#pragma once

#include <vector>

namespace CorvaneDeblur
{

struct levelSize
{
    int cols, rows;
    bool operator==(const levelSize &) const = default;
};

/// Factor from one level's kernel to the next coarser one's: the decimal, not the root of one half, and rounding tells.
constexpr float pyramidScale = 0.7071f;
constexpr int pyramidMinimum = 3;

/// Kernel sizes of an estimation, coarsest first: `scale` to the power of the level times the kernel's size, made odd,
/// equal neighbours dropped, without the `finestSkipped` finest. 31 x 31 gives 3, 5, 9, 11, 15, 23, 31.
/// The size is at least 3 on both axes.
std::vector<levelSize> buildPyramid(int cols, int rows, float scale, int minimumSize, int finestSkipped = 0);

/// size * factor rounded to the nearest whole number.
int scaledSize(int size, float factor);

} // namespace CorvaneDeblur
