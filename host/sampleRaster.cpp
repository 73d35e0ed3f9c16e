#include "host/sampleRaster.h"

#include <algorithm>
#include <cassert>
#include <cstring>
#include <vector>

namespace Stillmark
{

namespace
{

template <typename Sample>
void gather(const void *pixels, int width, int height, int pixelPlanes, int plane, void *samples, std::size_t rowBytes)
{
    const auto *from = static_cast<const Sample *>(pixels) + plane;
    auto *row = static_cast<std::uint8_t *>(samples);
    for (int y = 0; y < height; ++y, row += rowBytes)
    {
        auto *to = reinterpret_cast<Sample *>(row);
        for (int x = 0; x < width; ++x, from += pixelPlanes)
            to[x] = *from;
    }
}

template <typename Sample>
void scatter(const void *samples, std::size_t rowBytes, int width, int height, int pixelPlanes, int plane, void *pixels)
{
    auto *to = static_cast<Sample *>(pixels) + plane;
    const auto *row = static_cast<const std::uint8_t *>(samples);
    for (int y = 0; y < height; ++y, row += rowBytes)
    {
        const auto *from = reinterpret_cast<const Sample *>(row);
        for (int x = 0; x < width; ++x, to += pixelPlanes)
            *to = from[x];
    }
}

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

void pixelsToPlane(const void *pixels, int width, int height, int pixelPlanes, int sampleBytes, int plane,
                   void *samples, std::size_t rowBytes)
{
    const auto run = sampleBytes == 1   ? gather<std::uint8_t>
                     : sampleBytes == 2 ? gather<std::uint16_t>
                                        : gather<std::uint32_t>;
    run(pixels, width, height, pixelPlanes, plane, samples, rowBytes);
}

void planeToPixels(const void *samples, std::size_t rowBytes, int width, int height, int pixelPlanes, int sampleBytes,
                   int plane, void *pixels)
{
    const auto run = sampleBytes == 1   ? scatter<std::uint8_t>
                     : sampleBytes == 2 ? scatter<std::uint16_t>
                                        : scatter<std::uint32_t>;
    run(samples, rowBytes, width, height, pixelPlanes, plane, pixels);
}

} // namespace Stillmark
