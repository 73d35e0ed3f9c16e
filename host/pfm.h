#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace Stillmark
{

/// Portable float maps: "Pf" (grey) or "PF" (RGB), width, height and a scale whose sign tells the byte order (negative:
/// little-endian; its magnitude is not applied), then one float a sample, the bottom row first. NaN and infinities
/// pass. Failures throw Platform::fileError.

/// Float samples, row by row from the top, the planes of a pixel side by side.
struct floatRaster
{
    int width = 0, height = 0;
    int planes = 1; ///< 1 grey or 3 RGB
    std::vector<float> samples;
};

/// The largest width and height that are taken.
constexpr int largestPfmSide = 500000;

/// Memory for the samples is taken only after the file proved to be long enough for them.
floatRaster readPfm(const std::string &path);

/// Atomic; little-endian.
void writePfm(const std::string &path, const floatRaster &raster);

/// What comes before the samples of a little-endian map.
std::string pfmHeader(int width, int height, int planes);

/// A map that is read row by row. Safe from several threads.
class pfmReader
{
public:
    /// Refuses a header out of order and a file too short for its samples.
    explicit pfmReader(const std::string &file);
    pfmReader(const pfmReader &) = delete;
    pfmReader &operator=(const pfmReader &) = delete;
    ~pfmReader();

    /// True if these first bytes of a file can be those of a portable float map.
    static bool recognises(const std::uint8_t *bytes, std::size_t size);

    int width() const { return columns; }
    int height() const { return rows; }
    int planes() const { return samplesPerPixel; }

    /// Row y from the top: width() * planes() samples.
    void readRow(int y, float *samples) const;

private:
    void parseHeader();

    std::string path;
    int fd = -1;
    int columns = 0, rows = 0, samplesPerPixel = 1;
    bool foreignOrder = false; ///< bytes are to be swapped
    std::uint64_t start = 0;   ///< where the samples begin
};

} // namespace Stillmark
