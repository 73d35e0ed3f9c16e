#pragma once

#include "platform/canvas/raster.h"

#include <string>

namespace Stillmark
{

/// A window's pixels as a PNG of 8 bits, without the alpha. Throws std::runtime_error.
void writeScreenshot(const Platform::raster &picture, const std::string &path);

} // namespace Stillmark
