#include "framework/icons/pngDecoder.h"

#include "framework/icons/pngFormat.h"

#include <cstring>
#include <png.h>

namespace Sarnik
{
namespace
{

/// The library's structure for a picture that it reads in one go: errors come back as values.
struct pngPicture
{
    pngPicture() { image.version = PNG_IMAGE_VERSION; }
    ~pngPicture() { png_image_free(&image); }
    pngPicture(const pngPicture &) = delete;
    pngPicture &operator=(const pngPicture &) = delete;

    png_image image{};
};

} // namespace

Platform::raster CPNGDecoder::Decode(std::span<const std::byte> png) const
{
    const auto size = CPNGFormat::Size(png);
    if (!size || size->width > largestSide || size->height > largestSide)
        return {};

    pngPicture picture;
    if (png_image_begin_read_from_memory(&picture.image, png.data(), png.size()) == 0)
        return {};
    Platform::raster pixels(static_cast<int>(picture.image.width), static_cast<int>(picture.image.height));
    picture.image.format = PNG_FORMAT_RGBA;
    if (png_image_finish_read(&picture.image, nullptr, pixels.row(0), 0, nullptr) == 0)
        return {};

    for (int y = 0; y < pixels.height(); ++y)
        for (int x = 0; x < pixels.width(); ++x)
        {
            std::uint8_t samples[4];
            std::memcpy(samples, pixels.row(y) + x, sizeof samples);
            pixels.row(y)[x] = Platform::packed({samples[0], samples[1], samples[2], samples[3]});
        }
    return pixels;
}

} // namespace Sarnik
