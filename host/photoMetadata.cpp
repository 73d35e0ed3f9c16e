#include "host/photoMetadata.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace Stillmark
{

namespace
{

constexpr std::string_view photoshopPrefix("Photoshop 3.0\0", 14);

bool has(VipsImage *image, const char *field)
{
    return image && vips_image_get_typeof(image, field) != 0;
}

std::string_view blobOf(VipsImage *image, const char *field)
{
    const void *bytes = nullptr;
    std::size_t size = 0;
    if (!has(image, field) || vips_image_get_blob(image, field, &bytes, &size) != 0)
        return {};
    return {static_cast<const char *>(bytes), size};
}

/// libvips writes an orientation to PNG only where there is an EXIF block to hold it: a TIFF file brings none.
void ensureExif(VipsImage *picture)
{
    static const std::uint8_t empty[] = {'E', 'x', 'i', 'f', 0, 0, 'I', 'I', 42, 0, 8, 0, 0, 0, 0, 0, 0, 0, 0, 0};
    if (vips_image_get_orientation(picture) > 1 && !has(picture, VIPS_META_EXIF_NAME))
        vips_image_set_blob_copy(picture, VIPS_META_EXIF_NAME, empty, sizeof empty);
}

/// IPTC lies among Photoshop's image resources. JPEG has them in a segment with a prefix, which libvips hands over
/// whole as "iptc-data"; TIFF has them bare in tag 34377.
void resourcesForTiff(VipsImage *picture)
{
    const std::string resources(blobOf(picture, VIPS_META_IPTC_NAME));
    vips_image_remove(picture, VIPS_META_IPTC_NAME);
    if (resources.size() > photoshopPrefix.size() && resources.starts_with(photoshopPrefix))
        vips_image_set_blob_copy(picture, VIPS_META_PHOTOSHOP_NAME, resources.data() + photoshopPrefix.size(),
                                 resources.size() - photoshopPrefix.size());
}

void resourcesForJpeg(VipsImage *picture)
{
    constexpr std::size_t longestSegment = 65533;
    const std::string resources = std::string(photoshopPrefix).append(blobOf(picture, VIPS_META_PHOTOSHOP_NAME));
    if (has(picture, VIPS_META_PHOTOSHOP_NAME) && !has(picture, VIPS_META_IPTC_NAME) &&
        resources.size() <= longestSegment)
        vips_image_set_blob_copy(picture, VIPS_META_IPTC_NAME, resources.data(), resources.size());
}

} // namespace

void copyMetadata(VipsImage *from, VipsImage *to)
{
    const auto copyField = [](VipsImage *, const char *name, GValue *value, void *target) -> void * {
        // The shape, which the target has its own of, and how the file was stored, which would steer a saver.
        static constexpr std::string_view notCarried =
            " width height bands format coding interpretation xoffset yoffset xres yres filename history vips-loader "
            "vips-sequential n-pages page-height n-subifds delay loop gif-delay gif-loop background palette "
            "palette-bit-depth bits-per-sample interlaced heif-primary heif-bitdepth heif-compression jpeg-multiscan "
            "jpeg-chroma-subsample ";
        if (notCarried.find(" " + std::string(name) + " ") == std::string_view::npos)
            vips_image_set(static_cast<VipsImage *>(target), name, value);
        return nullptr;
    };
    vips_image_map(from, copyField, to);
    to->Xres = from->Xres;
    to->Yres = from->Yres;
}

std::vector<std::uint8_t> profileOf(VipsImage *metadata)
{
    const std::string_view bytes = blobOf(metadata, VIPS_META_ICC_NAME);
    return {bytes.begin(), bytes.end()};
}

void adaptMetadata(VipsImage *picture, photoFormat::kind format)
{
    if (format == photoFormat::kind::png)
        ensureExif(picture);
    else if (format == photoFormat::kind::tiff)
        resourcesForTiff(picture);
    else if (format == photoFormat::kind::jpeg)
        resourcesForJpeg(picture);
}

void noteLostMetadata(VipsImage *metadata, photoFormat::kind format, savePlan &plan)
{
    const bool exif = has(metadata, VIPS_META_EXIF_NAME);
    if (format == photoFormat::kind::tiff && exif)
        plan.notes.push_back("Of the camera's data (EXIF) only orientation and resolution are kept in a TIFF file.");
    if (format == photoFormat::kind::floatMap && (exif || has(metadata, VIPS_META_ICC_NAME)))
        plan.notes.push_back("A float map holds neither colour profile nor camera data: they are left out.");
    if (format == photoFormat::kind::floatMap && metadata && vips_image_get_orientation(metadata) > 1)
        plan.notes.push_back("A float map holds no orientation: the picture is saved as the camera held it.");
}

} // namespace Stillmark
