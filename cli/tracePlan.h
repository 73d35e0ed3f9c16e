#pragma once

#include "cli/runContext.h"
#include "host/photo.h"

#include <optional>
#include <vector>

namespace Stillmark
{

/// Where the main job looks for the blur, and how large it may be.
struct tracePlan
{
    std::vector<rectangle> regions; ///< with room for the size
    int size = 0;
};

/// Whether the options leave everything to the plug-in, which then finds a region and a size by itself.
bool isAutomatic(const removeOptions &options, const rectangle &area);

/// What the options ask for; what they leave open is measured. `area` is what may be looked at: the photo, or the
/// bounds of what is selected. No region where none is good enough, and a note then. Throws Platform::fileError when
/// a region lies outside or the area is too small, Platform::cancelled.
tracePlan planTraces(const removeOptions &options, const photo &picture, const rectangle &area, runContext &context);

} // namespace Stillmark
