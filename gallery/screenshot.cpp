#include "gallery/screenshot.h"

#include <png.h>

#include <stdexcept>
#include <vector>

namespace Stillmark
{

void writeScreenshot(const Platform::raster &picture, const std::string &path)
{
    std::vector<png_byte> rgb;
    for (int y = 0; y < picture.height(); ++y)
        for (int x = 0; x < picture.width(); ++x)
        {
            const Platform::colour c = Platform::unpacked(picture.row(y)[x]);
            rgb.insert(rgb.end(), {c.red, c.green, c.blue});
        }
    png_image image{};
    image.version = PNG_IMAGE_VERSION;
    image.width = static_cast<png_uint_32>(picture.width());
    image.height = static_cast<png_uint_32>(picture.height());
    image.format = PNG_FORMAT_RGB;
    const int done = png_image_write_to_file(&image, path.c_str(), 0, rgb.data(), 0, nullptr);
    const std::string why = image.message;
    png_image_free(&image);
    if (done == 0)
        throw std::runtime_error(path + ": " + why);
}

} // namespace Stillmark
