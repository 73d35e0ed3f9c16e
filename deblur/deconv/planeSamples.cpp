#include "deblur/deconv/planeSamples.h"

#include "platform/math/multiversion.h"

#include <cmath>
#include <cstdint>
#include <cstring>
#include <limits>

namespace CorvaneDeblur
{
namespace
{

/// Rows may start at any address: samples are moved by memcpy, which the compiler turns into plain vector loads.
template <typename Sample> inline Sample load(const std::byte *row, std::ptrdiff_t i)
{
    Sample sample;
    std::memcpy(&sample, row + i * static_cast<std::ptrdiff_t>(sizeof(Sample)), sizeof(Sample));
    return sample;
}

template <typename Sample> inline void store(std::byte *row, std::ptrdiff_t i, Sample sample)
{
    std::memcpy(row + i * static_cast<std::ptrdiff_t>(sizeof(Sample)), &sample, sizeof(Sample));
}

/// A value that is not greater than 0, NaN included, becomes 0.
inline float clamped(float value)
{
    value = value > 0.0f ? value : 0.0f;
    return value < 1.0f ? value : 1.0f;
}

// Division, not a product with the reciprocal: that would lose codes when they are truncated on the way back.
STILLMARK_MULTIVERSION
void readRow8(const std::byte *__restrict in, float *__restrict out, std::ptrdiff_t count)
{
    for (std::ptrdiff_t i = 0; i < count; ++i)
        out[i] = static_cast<float>(load<std::uint8_t>(in, i)) / 255.0f;
}

STILLMARK_MULTIVERSION
void readRow16(const std::byte *__restrict in, float *__restrict out, std::ptrdiff_t count)
{
    for (std::ptrdiff_t i = 0; i < count; ++i)
        out[i] = static_cast<float>(load<std::uint16_t>(in, i)) / 65535.0f;
}

STILLMARK_MULTIVERSION
void readRow32(const std::byte *__restrict in, float *__restrict out, std::ptrdiff_t count)
{
    for (std::ptrdiff_t i = 0; i < count; ++i)
    {
        const float sample = load<float>(in, i);
        out[i] = std::fabs(sample) <= std::numeric_limits<float>::max() ? sample : 0.0f;
    }
}

STILLMARK_MULTIVERSION
void writeRow8(const float *__restrict in, std::byte *__restrict out, std::ptrdiff_t count)
{
    for (std::ptrdiff_t i = 0; i < count; ++i)
        store(out, i, static_cast<std::uint8_t>(static_cast<int>(clamped(in[i]) * 255.0f)));
}

STILLMARK_MULTIVERSION
void writeRow16(const float *__restrict in, std::byte *__restrict out, std::ptrdiff_t count)
{
    for (std::ptrdiff_t i = 0; i < count; ++i)
        store(out, i, static_cast<std::uint16_t>(static_cast<int>(clamped(in[i]) * 65535.0f)));
}

STILLMARK_MULTIVERSION
void writeRow32(const float *__restrict in, std::byte *__restrict out, std::ptrdiff_t count)
{
    for (std::ptrdiff_t i = 0; i < count; ++i)
        store(out, i, clamped(in[i]));
}

} // namespace

void readPlane(const std::byte *memory, const floatArray &plane, int planeIndex, std::ptrdiff_t rowBytes, int depth)
{
    const auto readRow = depth == 8 ? readRow8 : depth == 16 ? readRow16 : depth == 32 ? readRow32 : nullptr;
    if (!readRow)
        return;
    const std::byte *first = memory + rowBytes * plane.rows * planeIndex;
    for (int y = 0; y < plane.rows; ++y)
        readRow(first + rowBytes * y, plane.row(y), plane.cols);
}

void writePlane(const floatArray &plane, std::byte *memory, int planeIndex, std::ptrdiff_t rowBytes, int depth)
{
    const auto writeRow = depth == 8 ? writeRow8 : depth == 16 ? writeRow16 : depth == 32 ? writeRow32 : nullptr;
    if (!writeRow)
        return;
    std::byte *first = memory + rowBytes * plane.rows * planeIndex;
    for (int y = 0; y < plane.rows; ++y)
        writeRow(plane.row(y), first + rowBytes * y, plane.cols);
}

} // namespace CorvaneDeblur
