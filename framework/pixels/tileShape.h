#pragma once

#include <cstddef>
#include <cstdint>

namespace Sarnik
{

/// A tile of paged memory: `256 << sizeClass` bytes, width and height powers of two, at most twice as wide as high and
/// never higher than wide.
struct CTileShape
{
    int sizeClass = 0;
    std::int32_t width = 0, height = 0; ///< in pixels
};

constexpr int tileClassCount = 16;
/// Set in a tile number whose low bits choose a preset: squares of 64, 128, 256, 512, 1024 pixels for 0 to 4.
constexpr std::uint32_t tilePreset = 0x80000000u;

constexpr std::size_t tileBytes(int sizeClass)
{
    return std::size_t{256} << sizeClass;
}

/// depthLog: 3, 4, 5 for 8, 16, 32 bits a sample. tileSpec: a class 0 to 15, or tilePreset with a preset. Throws
/// std::invalid_argument for others.
CTileShape tileShape(std::uint32_t tileSpec, int depthLog);

} // namespace Sarnik
