#pragma once

#include "host/photo.h"
#include "host/sampleRaster.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <vector>

namespace Stillmark
{

/// How much each pixel of a photo is selected: 0 not at all, 255 wholly. Something is selected always. In memory up to
/// 256 MB, in a scratch file beyond. Safe from any thread.
class selectionMask
{
public:
    /// From a grey picture of exactly this size, or the luma (0.299 R + 0.587 G + 0.114 B) of an RGB one; 8 or 16 bits,
    /// white is selected; transparency is not looked at. Throws Platform::fileError with one line: the picture cannot
    /// be read, is of another size or kind, or selects nothing. Throws Platform::cancelled.
    static selectionMask open(const std::string &path, int width, int height, const progressCheck &progress = {});

    /// From values row by row. Throws std::invalid_argument if their number is wrong or all are 0.
    selectionMask(int width, int height, const std::vector<std::uint8_t> &values);

    int width() const { return raster->width(); }
    int height() const { return raster->height(); }
    /// The smallest rectangle around all that is not 0.
    const rectangle &bounds() const { return selected; }

    /// The values of area, which lies within the mask; rows start rowBytes apart. Throws Platform::fileError if the
    /// scratch file cannot be read.
    void read(const rectangle &area, std::uint8_t *values, std::size_t rowBytes) const;

private:
    selectionMask(int width, int height);
    void append(int y, const std::uint8_t *row); ///< each row once, from the top

    std::unique_ptr<sampleRaster> raster;
    rectangle selected; ///< width 0 while nothing is
};

} // namespace Stillmark
