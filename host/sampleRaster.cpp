#include "host/sampleRaster.h"

#include "platform/math/multiversion.h"

#include <algorithm>
#include <cassert>
#include <cstring>
#include <type_traits>
#include <vector>

namespace Stillmark
{

namespace
{

/// Calls use with a sample of the size, and the number of planes known to the compiler where it is a common one.
template <typename Use> void withShape(int sampleBytes, int pixelPlanes, const Use &use)
{
    const auto withPlanes = [&](auto sample) {
        switch (pixelPlanes)
        {
        case 1:
            return use(sample, std::integral_constant<int, 1>());
        case 3:
            return use(sample, std::integral_constant<int, 3>());
        case 4:
            return use(sample, std::integral_constant<int, 4>());
        default:
            return use(sample, pixelPlanes);
        }
    };
    if (sampleBytes == 1)
        withPlanes(std::uint8_t());
    else if (sampleBytes == 2)
        withPlanes(std::uint16_t());
    else
        withPlanes(std::uint32_t());
}

/// Three planes of a row at once: the compiler makes shuffles of it.
template <typename Sample>
inline void splitThree(std::size_t n, const Sample *from, std::size_t step, Sample *__restrict a, Sample *__restrict b,
                       Sample *__restrict c)
{
    for (std::size_t i = 0; i < n; ++i, from += step)
    {
        a[i] = from[0];
        b[i] = from[1];
        c[i] = from[2];
    }
}

#define STILLMARK_SPLIT_THREE(SAMPLE) \
    STILLMARK_MULTIVERSION \
    void splitRow(std::size_t n, const SAMPLE *from, std::size_t step, SAMPLE *a, SAMPLE *b, SAMPLE *c) \
    { \
        return step == 3 ? splitThree(n, from, 3, a, b, c) : splitThree(n, from, step, a, b, c); \
    }
STILLMARK_SPLIT_THREE(std::uint8_t)
STILLMARK_SPLIT_THREE(std::uint16_t)
STILLMARK_SPLIT_THREE(std::uint32_t)
#undef STILLMARK_SPLIT_THREE

} // namespace

sampleRaster::sampleRaster(int width, int height, int planes, int sampleBytes, std::uint64_t keepInMemory)
    : columns(width), rows(height), planeCount(planes), bytesPerSample(sampleBytes)
{
    const std::uint64_t size = offset(0, height);
    if (size <= keepInMemory)
        memory = std::make_unique_for_overwrite<std::uint8_t[]>(static_cast<std::size_t>(size));
    else
        disk.emplace(size);
}

std::uint64_t sampleRaster::offset(int x, int y) const
{
    return (static_cast<std::uint64_t>(y) * static_cast<std::uint64_t>(columns) + static_cast<std::uint64_t>(x)) *
           pixelBytes();
}

int sampleRaster::bandRows(int width) const
{
    const std::size_t rowLength = std::max<std::size_t>(static_cast<std::size_t>(width) * pixelBytes(), 1);
    return static_cast<int>(std::clamp<std::size_t>((std::size_t{1} << 18) / rowLength, 1, 1024));
}

void sampleRaster::read(const rectangle &area, void *pixels, std::size_t rowBytes) const
{
    assert(area.x >= 0 && area.y >= 0 && area.x + area.width <= columns && area.y + area.height <= rows);
    const std::size_t length = static_cast<std::size_t>(area.width) * pixelBytes();
    auto *to = static_cast<std::uint8_t *>(pixels);
    if (!memory && area.width == columns && rowBytes == length)
        return disk->read(offset(0, area.y), to, length * static_cast<std::size_t>(area.height));
    for (int y = 0; y < area.height; ++y, to += rowBytes)
        if (memory)
            std::memcpy(to, memory.get() + offset(area.x, area.y + y), length);
        else
            disk->read(offset(area.x, area.y + y), to, length);
}

void sampleRaster::write(const rectangle &area, const void *pixels, std::size_t rowBytes)
{
    assert(area.x >= 0 && area.y >= 0 && area.x + area.width <= columns && area.y + area.height <= rows);
    const std::size_t length = static_cast<std::size_t>(area.width) * pixelBytes();
    const auto *from = static_cast<const std::uint8_t *>(pixels);
    if (!memory && area.width == columns && rowBytes == length)
        return disk->write(offset(0, area.y), from, length * static_cast<std::size_t>(area.height));
    for (int y = 0; y < area.height; ++y, from += rowBytes)
        if (memory)
            std::memcpy(memory.get() + offset(area.x, area.y + y), from, length);
        else
            disk->write(offset(area.x, area.y + y), from, length);
}

void sampleRaster::writePlane(const rectangle &area, int plane, const void *samples, std::size_t rowBytes)
{
    assert(area.x >= 0 && area.y >= 0 && area.x + area.width <= columns && area.y + area.height <= rows);
    assert(plane >= 0 && plane < planeCount);
    const auto *from = static_cast<const std::uint8_t *>(samples);
    const std::size_t length = static_cast<std::size_t>(area.width) * pixelBytes();
    const int rowsAtOnce = memory ? 1 : std::min(bandRows(area.width), area.height);
    std::vector<std::uint8_t> band(memory ? 0 : length * static_cast<std::size_t>(rowsAtOnce));
    for (int y = 0; y < area.height; y += rowsAtOnce, from += rowBytes * static_cast<std::size_t>(rowsAtOnce))
    {
        const rectangle part{area.x, area.y + y, area.width, std::min(rowsAtOnce, area.height - y)};
        if (!memory)
            read(part, band.data(), length);
        std::uint8_t *pixels = memory ? memory.get() + offset(part.x, part.y) : band.data();
        planeToPixels(from, rowBytes, part.width, part.height, planeCount, bytesPerSample, plane, pixels);
        if (!memory)
            write(part, band.data(), length);
    }
}

void pixelsToPlanes(const void *pixels, int width, int height, int pixelPlanes, int sampleBytes, int firstPlane,
                    int planes, void *samples, std::size_t rowBytes, std::size_t planeBytes)
{
    withShape(sampleBytes, pixelPlanes, [&](auto sample, auto step) {
        using type = decltype(sample);
        const auto *from = static_cast<const type *>(pixels) + firstPlane;
        const auto columns = static_cast<std::size_t>(width);
        for (int y = 0; y < height; ++y, from += columns * static_cast<std::size_t>(pixelPlanes))
        {
            auto *const row = static_cast<std::uint8_t *>(samples) + static_cast<std::size_t>(y) * rowBytes;
            const auto planeRow = [&](int p) {
                return reinterpret_cast<type *>(row + static_cast<std::size_t>(p) * planeBytes);
            };
            int p = 0;
            for (; p + 3 <= planes; p += 3)
                splitRow(columns, from + p, static_cast<std::size_t>(pixelPlanes), planeRow(p), planeRow(p + 1),
                         planeRow(p + 2));
            for (; p < planes; ++p)
            {
                const type *one = from + p;
                type *to = planeRow(p);
                for (std::size_t x = 0; x < columns; ++x, one += step)
                    to[x] = *one;
            }
        }
    });
}

void planeToPixels(const void *samples, std::size_t rowBytes, int width, int height, int pixelPlanes, int sampleBytes,
                   int plane, void *pixels)
{
    withShape(sampleBytes, pixelPlanes, [&](auto sample, auto planes) {
        auto *to = static_cast<decltype(sample) *>(pixels) + plane;
        const auto *row = static_cast<const std::uint8_t *>(samples);
        for (int y = 0; y < height; ++y, row += rowBytes)
        {
            const auto *from = reinterpret_cast<const decltype(sample) *>(row);
            for (int x = 0; x < width; ++x, to += planes)
                *to = from[x];
        }
    });
}

} // namespace Stillmark
