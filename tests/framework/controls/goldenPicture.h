#pragma once

#include "platform/canvas/raster.h"

#include <gtest/gtest.h>

#include <string>

namespace Sarnik::Test
{

/// Whether a picture looks like tests/data/controls/<name>.png: at most 2 in 100 pixels differ by more than 8 levels,
/// none by more than 96 (edges are drawn a little differently by other versions of the drawing library). Where it does
/// not, the picture is left in the temporary folder, and the message says where.
testing::AssertionResult looksLike(const Platform::raster &picture, const std::string &name);

} // namespace Sarnik::Test
