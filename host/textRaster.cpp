#include "host/textRaster.h"

#include "host/vipsHandle.h"

#include <cstring>
#include <vips/vips.h>

namespace Stillmark
{
namespace
{

/// Without what the library would take for markup.
std::string escaped(const std::string &text)
{
    std::string plain;
    for (const char c : text)
        plain += c == '&' ? "&amp;" : c == '<' ? "&lt;" : std::string(1, c);
    return plain;
}

} // namespace

textRaster renderText(const std::string &text)
{
    startVips();
    VipsImage *drawn = nullptr;
    if (text.empty() || vips_text(&drawn, escaped(text).c_str(), "font", "sans 9", "dpi", 96, nullptr) != 0)
    {
        vips_error_clear();
        return {};
    }
    const vipsImage image(drawn);
    std::size_t size = 0;
    void *memory = vips_image_write_to_memory(drawn, &size);
    textRaster raster{vips_image_get_width(drawn), vips_image_get_height(drawn), {}};
    if (memory == nullptr || size != static_cast<std::size_t>(raster.width) * static_cast<std::size_t>(raster.height))
    {
        g_free(memory);
        vips_error_clear();
        return {};
    }
    raster.coverage.resize(size);
    std::memcpy(raster.coverage.data(), memory, size);
    g_free(memory);
    return raster;
}

} // namespace Stillmark
