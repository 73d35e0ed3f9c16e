#pragma once

#include "host/photo.h"

#include <cstddef>

namespace Stillmark
{

/// Samples of one plane: packed rows of file codes, rowBytes apart, aligned as their type wants it.
struct planeSamples
{
    const std::byte *data = nullptr;
    std::size_t rowBytes = 0;

    const std::byte *row(int y) const { return data + static_cast<std::size_t>(y) * rowBytes; }
};

/// A picture that a document shows: planes of codes as colourMode has them, the colours first, then transparency and
/// further masks. One thread at a time.
class pictureSource
{
public:
    virtual ~pictureSource() = default;

    virtual int width() const = 0;
    virtual int height() const = 0;
    virtual int depth() const = 0; ///< bits of a sample: 8, 16 or 32 (float)
    virtual colourMode mode() const = 0;
    virtual int extraPlanes() const = 0;

    int sampleBytes() const { return depth() / 8; }
    int colourPlanes() const;
    int planes() const { return colourPlanes() + extraPlanes(); }

    /// The samples of a plane in area, which is not empty and lies within the picture. Good until the next call. May
    /// hold several times the area in memory: callers go through large areas in bands (bandRows).
    /// Throws Platform::fileError if they cannot be read.
    virtual planeSamples plane(int number, const rectangle &area) = 0;

    /// Rows of an area of this width that are well taken at once.
    int bandRows(int areaWidth) const;
};

} // namespace Stillmark
