#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace Stillmark
{

/// Text as a picture: how much of each pixel it covers, 0 to 255, row by row.
struct textRaster
{
    int width = 0, height = 0;
    std::vector<std::uint8_t> coverage;
};

/// Plain text in the system's sans-serif font; a line feed begins a new line. Empty where the picture library cannot
/// draw text here, for want of a font.
textRaster renderText(const std::string &text);

} // namespace Stillmark
