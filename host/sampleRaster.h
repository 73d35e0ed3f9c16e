#pragma once

#include "host/photo.h"
#include "platform/files.h"

#include <cstdint>
#include <memory>
#include <optional>

namespace Stillmark
{

/// Pixels of a whole picture, the planes of a pixel side by side, in memory while they are few and in a scratch file
/// beyond. Reads and writes of rectangles from any threads, as long as nobody reads what another is writing.
class sampleRaster
{
public:
    static constexpr std::uint64_t memoryLimit = std::uint64_t{256} << 20;

    /// Throws Platform::fileError if there is no room on disk. A raster takes memory as it is written, not before.
    sampleRaster(int width, int height, int planes, int sampleBytes, std::uint64_t keepInMemory = memoryLimit);

    int width() const { return columns; }
    int height() const { return rows; }
    int planes() const { return planeCount; }
    int sampleBytes() const { return bytesPerSample; }
    /// Rows of a band that a rectangle of this width is best handled in: few enough to stay in the processor's cache.
    int bandRows(int width) const;

    std::size_t pixelBytes() const { return static_cast<std::size_t>(planeCount) * bytesPerSample; }

    /// Pixels of area row after row, rowBytes from one to the next.
    void read(const rectangle &area, void *pixels, std::size_t rowBytes) const;
    void write(const rectangle &area, const void *pixels, std::size_t rowBytes);

    /// One plane of area, packed rows rowBytes apart; the others stay. Every pixel of it must have been written before.
    void writePlane(const rectangle &area, int plane, const void *samples, std::size_t rowBytes);

private:
    std::uint64_t offset(int x, int y) const;

    int columns, rows, planeCount, bytesPerSample;
    std::unique_ptr<std::uint8_t[]> memory; ///< null if the scratch file holds the pixels
    std::optional<Platform::scratchFile> disk;
};

/// Between pixels (pixelPlanes samples of sampleBytes 1, 2 or 4 side by side, rows without gaps) and some of their
/// planes, whose rows start rowBytes apart, from one plane to the next planeBytes.
void pixelsToPlanes(const void *pixels, int width, int height, int pixelPlanes, int sampleBytes, int firstPlane,
                    int planes, void *samples, std::size_t rowBytes, std::size_t planeBytes);
void planeToPixels(const void *samples, std::size_t rowBytes, int width, int height, int pixelPlanes, int sampleBytes,
                   int plane, void *pixels);

} // namespace Stillmark
