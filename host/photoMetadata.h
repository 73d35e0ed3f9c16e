#pragma once

#include "host/photoFormat.h"
#include "host/vipsHandle.h"

#include <cstdint>
#include <vector>

namespace Stillmark
{

/// Gives an image what a result of the same picture must carry on: everything libvips knows of the file but the pixels'
/// shape and how it was stored.
void copyMetadata(VipsImage *from, VipsImage *to);

/// The ICC profile of the metadata (null for none); empty if there is none.
std::vector<std::uint8_t> profileOf(VipsImage *metadata);

/// Puts metadata where libvips looks for it when it saves the format.
void adaptMetadata(VipsImage *picture, photoFormat::kind format);

/// Adds to the plan's notes what of the metadata (null for none) the format will lose.
void noteLostMetadata(VipsImage *metadata, photoFormat::kind format, savePlan &plan);

} // namespace Stillmark
