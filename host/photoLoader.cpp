#include "host/photoContent.h"
#include "host/photoMetadata.h"

#include <algorithm>
#include <cmath>
#include <string_view>

namespace Stillmark
{

namespace
{

constexpr int largestSide = 500000;
constexpr int mostPlanes = 64;

/// How libvips holds the samples, told by what has to be done to get our codes.
enum class sampleForm
{
    asStored,  ///< already ours: 8 and 16-bit codes, floats
    labBytes,  ///< L code, signed a and b, a byte of low bits that 8-bit files do not have
    labShorts, ///< L from 0 to 32767, a and b times 256, further planes as stored
    labFloats, ///< CIE units
    inkFloats  ///< 0 to 1
};

std::uint16_t code16(double value)
{
    return static_cast<std::uint16_t>(std::clamp(std::isnan(value) ? 0 : std::lround(value), 0L, 65535L));
}

/// A row of libvips' samples as our codes. planes is the number of our planes.
void convertRow(sampleForm form, const VipsPel *from, int width, int planes, void *to)
{
    const std::size_t count = static_cast<std::size_t>(width) * static_cast<std::size_t>(planes);
    switch (form)
    {
    case sampleForm::asStored:
        break; // copied by the caller
    case sampleForm::labBytes:
        for (auto *out = static_cast<std::uint8_t *>(to); width > 0; --width, from += 4, out += 3)
        {
            out[0] = from[0];
            out[1] = from[1] ^ 0x80;
            out[2] = from[2] ^ 0x80;
        }
        break;
    case sampleForm::labShorts:
    {
        const auto *in = reinterpret_cast<const std::uint16_t *>(from);
        auto *out = static_cast<std::uint16_t *>(to);
        for (; width > 0; --width, in += planes, out += planes)
        {
            const unsigned lightness = in[0] & 0x7fff;
            std::copy(in, in + planes, out);
            out[0] = static_cast<std::uint16_t>(lightness << 1 | lightness >> 14); // white stays white
            out[1] = in[1] ^ 0x8000;
            out[2] = in[2] ^ 0x8000;
        }
        break;
    }
    case sampleForm::labFloats:
    {
        const auto *in = reinterpret_cast<const float *>(from);
        auto *out = static_cast<std::uint16_t *>(to);
        for (std::size_t i = 0; i < count; ++i)
        {
            const int plane = static_cast<int>(i % static_cast<std::size_t>(planes));
            out[i] = plane == 0  ? code16(in[i] / 100.0 * 65535)
                     : plane < 3 ? code16(in[i] * 256.0 + 32768)
                                 : code16(in[i] * 65535.0);
        }
        break;
    }
    case sampleForm::inkFloats:
        for (std::size_t i = 0; i < count; ++i)
            static_cast<std::uint16_t *>(to)[i] = code16(reinterpret_cast<const float *>(from)[i] * 65535.0);
        break;
    }
}

/// What a decoded image is to become.
struct shape
{
    colourMode mode = colourMode::grey;
    sampleForm form = sampleForm::asStored;
    int planes = 1;
    int sampleBytes = 1;
};

colourMode modeOf(const std::string &path, const VipsImage *image)
{
    const int bands = image->Coding == VIPS_CODING_LABQ ? 3 : image->Bands;
    switch (image->Type)
    {
    case VIPS_INTERPRETATION_B_W:
    case VIPS_INTERPRETATION_GREY16:
        return colourMode::grey;
    case VIPS_INTERPRETATION_CMYK:
        if (bands >= 4)
            return colourMode::cmyk;
        break;
    case VIPS_INTERPRETATION_LAB:
    case VIPS_INTERPRETATION_LABQ:
    case VIPS_INTERPRETATION_LABS:
        if (bands >= 3)
            return colourMode::lab;
        break;
    case VIPS_INTERPRETATION_sRGB:
    case VIPS_INTERPRETATION_RGB:
    case VIPS_INTERPRETATION_RGB16:
    case VIPS_INTERPRETATION_scRGB:
        return bands >= 3 ? colourMode::rgb : colourMode::grey;
    default:
        if (bands <= 4)
            return bands >= 3 ? colourMode::rgb : colourMode::grey;
        break;
    }
    throw Platform::fileError(path + ": cannot be used: its colour mode is neither grey, RGB, CMYK nor Lab");
}

shape shapeOf(const std::string &path, const VipsImage *image)
{
    shape s;
    s.mode = modeOf(path, image);
    s.planes = image->Coding == VIPS_CODING_LABQ ? 3 : image->Bands;
    if (image->Coding != VIPS_CODING_NONE && image->Coding != VIPS_CODING_LABQ)
        throw Platform::fileError(path + ": cannot be used: its samples are packed in an unsupported way");
    if (s.planes > mostPlanes)
        throw Platform::fileError(path + ": cannot be used: it has " + std::to_string(s.planes) + " channels");
    if (image->Xsize > largestSide || image->Ysize > largestSide)
        throw Platform::fileError(path + ": too large: " + std::to_string(image->Xsize) + " x " +
                                  std::to_string(image->Ysize) + " pixels");

    const bool lab = s.mode == colourMode::lab;
    if (image->Coding == VIPS_CODING_LABQ)
        s.form = sampleForm::labBytes;
    else if (image->BandFmt == VIPS_FORMAT_SHORT && image->Type == VIPS_INTERPRETATION_LABS)
    {
        s.form = sampleForm::labShorts;
        s.sampleBytes = 2;
    }
    else if (image->BandFmt == VIPS_FORMAT_FLOAT && (lab || s.mode == colourMode::cmyk))
    {
        s.form = lab ? sampleForm::labFloats : sampleForm::inkFloats;
        s.sampleBytes = 2;
    }
    else if (!lab && (image->BandFmt == VIPS_FORMAT_UCHAR || image->BandFmt == VIPS_FORMAT_USHORT ||
                      image->BandFmt == VIPS_FORMAT_FLOAT))
        s.sampleBytes = static_cast<int>(vips_format_sizeof(image->BandFmt));
    else
        throw Platform::fileError(path + ": cannot be used: its samples are neither unsigned integers of 8 or 16 bits "
                                         "nor floats of 32");
    return s;
}

/// Decodes the whole of an image into a raster. False if libvips failed.
///
/// On this thread alone: with several, a strip that could not be decoded is black for those that waited for it, and the
/// error may be lost. Decoders work through a file from top to bottom anyway.
bool decode(VipsImage *image, const shape &what, sampleRaster &raster, const progressCheck &progress)
{
    const std::unique_ptr<VipsRegion, vipsUnref> region(vips_region_new(image));
    const int stripRows = std::clamp(raster.bandRows(image->Xsize), 16, 256);
    std::vector<std::uint8_t> row(static_cast<std::size_t>(image->Xsize) * raster.pixelBytes());
    for (int top = 0; top < image->Ysize; top += stripRows)
    {
        if (progress && !progress(static_cast<double>(top) / image->Ysize))
            throw Platform::cancelled();
        const VipsRect strip{0, top, image->Xsize, std::min(stripRows, image->Ysize - top)};
        if (vips_region_prepare(region.get(), &strip) != 0)
            return false;
        for (int y = top; y < top + strip.height; ++y)
        {
            const VipsPel *from = VIPS_REGION_ADDR(region.get(), 0, y);
            if (what.form != sampleForm::asStored)
                convertRow(what.form, from, image->Xsize, what.planes, row.data());
            raster.write({0, y, image->Xsize, 1}, what.form == sampleForm::asStored ? from : row.data(), row.size());
        }
    }
    return true;
}

/// The name of the format, from the class of libvips' loader; empty for those that are not offered. The rest of its
/// loaders read things that are no photographs, or were not written with hostile files in mind.
std::string formatOfLoader(const char *loader)
{
    static constexpr std::string_view formats[] = {"Jpeg", "Png", "Tiff", "Webp", "Heif"};
    for (const std::string_view format : formats)
        if (loader && std::string_view(loader).starts_with("VipsForeignLoad" + std::string(format)))
            return std::string(format);
    return {};
}

Platform::fileError failed(const std::string &path, const std::string &what)
{
    const std::string detail = takeVipsError();
    return Platform::fileError(path + ": " + what + (detail.empty() ? "" : ": " + detail));
}

} // namespace

std::shared_ptr<photo::content> loadPicture(const std::string &path, int descriptor, const progressCheck &progress)
{
    startVips();
    takeVipsError(); // what others left there says nothing about this file

    const vipsSource source(vips_source_new_from_descriptor(descriptor));
    if (!source)
        throw failed(path, "cannot be read");
    const std::string format = formatOfLoader(vips_foreign_find_load_source(source.get()));
    if (format.empty())
    {
        takeVipsError();
        throw Platform::fileError(path + ": cannot be read: it is no picture of a known format");
    }
    const vipsImage image(vips_image_new_from_source(source.get(), "", "access", VIPS_ACCESS_SEQUENTIAL, "fail_on",
                                                     VIPS_FAIL_ON_ERROR, nullptr));
    if (!image)
        throw failed(path, "is damaged or of an unsupported kind");

    const shape form = shapeOf(path, image.get());
    auto picture = std::make_shared<photo::content>();
    picture->path = path;
    picture->mode = form.mode;
    picture->extraPlanes = form.planes - colourPlanesOf(form.mode);
    if (form.form == sampleForm::labFloats || form.form == sampleForm::inkFloats)
        picture->notes.push_back("32-bit CMYK and Lab are not worked on: the picture is taken with 16 bits a channel.");
    if (const int pages = vips_image_get_n_pages(image.get()); pages > 1)
        picture->notes.push_back("The file holds " + std::to_string(pages) + " pictures: the first is used.");
    picture->raster = std::make_unique<sampleRaster>(image->Xsize, image->Ysize, form.planes, form.sampleBytes);

    if (!decode(image.get(), form, *picture->raster, progress))
        throw failed(path, "is damaged or cut short");

    picture->metadata.reset(vips_image_new());
    copyMetadata(image.get(), picture->metadata.get());
    if (format == "Tiff")
        vips_image_remove(picture->metadata.get(), VIPS_META_IPTC_NAME); // libvips 8.14 reads a quarter of it
    return picture;
}

} // namespace Stillmark
