#pragma once

#include "host/photo.h"
#include "host/sampleRaster.h"
#include "host/vipsHandle.h"

#include <memory>
#include <string>
#include <vector>

namespace Stillmark
{

/// A decoded photo. Filled by the loaders, not changed afterwards.
struct photo::content
{
    std::string path;
    colourMode mode = colourMode::grey;
    int extraPlanes = 0;
    std::vector<std::string> notes;
    /// Colour planes, then the extra ones, coded as colourMode says.
    std::unique_ptr<sampleRaster> raster;
    /// Carries the fields (profile, EXIF, ...) and the resolution, no pixels. Null for a float map.
    vipsImage metadata;
};

inline int colourPlanesOf(colourMode mode)
{
    return mode == colourMode::grey ? 1 : mode == colourMode::cmyk ? 4 : 3;
}

/// Decodes a picture with libvips from an open file; what photo::open promises.
std::shared_ptr<photo::content> loadPicture(const std::string &path, int descriptor, const progressCheck &progress);

/// Reads a portable float map.
std::shared_ptr<photo::content> loadFloatMap(const std::string &path, const progressCheck &progress);

} // namespace Stillmark
