#include "store/files/kernelPng.h"

#include "deblur/estimate/arrayOps.h"
#include "framework/base/container.h"
#include "framework/base/localisedString.h"
#include "store/files/pngSession.h"

#include <array>
#include <vector>

namespace Project
{

namespace
{

using CorvaneDeblur::floatArray;

constexpr int kSignatureLength = 8;

/// What the file's first chunk says.
struct pngHeader
{
    png_uint_32 width, height;
    int colour, depth, channels;
};

void readHeader(png_structp png, png_infop info, pngHeader *header)
{
    png_set_sig_bytes(png, kSignatureLength);
    // Sizes are judged by our own rules, which have texts; the library allocates nothing by them before the rows.
    png_set_user_limits(png, PNG_UINT_31_MAX, PNG_UINT_31_MAX);
    // No ancillary chunk means anything here, so none is unpacked or kept.
    png_set_keep_unknown_chunks(png, PNG_HANDLE_CHUNK_NEVER, nullptr, -1);
    png_read_info(png, info);
    header->width = png_get_image_width(png, info);
    header->height = png_get_image_height(png, info);
    header->colour = png_get_color_type(png, info);
    header->depth = png_get_bit_depth(png, info);
    header->channels = png_get_channels(png, info);
}

void readRows(png_structp png, png_infop info, png_bytepp rows)
{
    png_set_interlace_handling(png);
    png_read_update_info(png, info);
    png_read_image(png, rows);
}

/// Why a picture with this header is not taken, as a text to be localised; null if it is. The order decides which of
/// several reasons is given.
const char *refusalOf(const pngHeader &header, int maxSize)
{
    const bool rgb = header.colour == PNG_COLOR_TYPE_RGB || header.colour == PNG_COLOR_TYPE_RGB_ALPHA;
    if (header.colour == PNG_COLOR_TYPE_GRAY_ALPHA)
        return "$$$/Deblur/Error/ReadKernelDataFromPNG/InvalidFileFormat1=Invalid file format: transparent grayscale "
               "image is not supported.";
    if ((header.depth != 8 && header.depth != 16) || (!rgb && header.colour != PNG_COLOR_TYPE_GRAY))
        return "$$$/Deblur/Error/ReadKernelDataFromPNG/InvalidFileFormat2=Invalid file format: a 8/16-bit grayscale "
               "or RGB PNG file is required.";
    if (header.width != header.height)
        return "$$$/Deblur/Error/ReadKernelDataFromPNG/InvalidFileFormat3=Invalid file format: a square image is "
               "required.";
    if (header.height < kSmallestKernelPng)
        return "$$$/Deblur/Error/ReadKernelDataFromPNG/InvalidFileFormat5=Invalid file format: the image dimension is "
               "too small, should be greater than ^0 pixels.";
    if (maxSize < 0 || header.height > static_cast<png_uint_32>(maxSize))
        return "$$$/Deblur/Error/ReadKernelDataFromPNG/InvalidFileFormat6=Invalid file format: the image dimensions "
               "are too large.";
    return nullptr;
}

/// One channel's code of 8 or 16 bits, most significant byte first.
float codeAt(const png_byte *sample, int bytes)
{
    return static_cast<float>(bytes == 1 ? sample[0] : sample[0] << 8 | sample[1]);
}

float greyAt(const png_byte *pixel, const pngHeader &header)
{
    const int bytes = header.depth / 8;
    const float red = codeAt(pixel, bytes);
    if (header.channels == 1)
        return red;
    const float green = codeAt(pixel + bytes, bytes), blue = codeAt(pixel + 2 * bytes, bytes);
    if (red == green && green == blue) // the sum below would round it
        return red;
    return 0.299f * red + 0.587f * green + 0.114f * blue;
}

/// The rows' pixels as values 0..1 in the array's top left.
void convertRows(const std::vector<png_bytep> &rows, const pngHeader &header, const floatArray &kernel)
{
    const float scale = header.depth == 16 ? 1.5259022e-5f : 0.003921569f; // 1/65535, 1/255
    const std::size_t pixelBytes = static_cast<std::size_t>(header.channels * header.depth / 8);
    for (std::size_t y = 0; y < rows.size(); ++y)
        for (std::size_t x = 0; x < rows.size(); ++x)
            kernel.at(static_cast<int>(y), static_cast<int>(x)) = greyAt(rows[y] + x * pixelBytes, header) * scale;
}

struct pngPicture
{
    int rows, cols;
    png_bytepp pixels;
};

void writePicture(png_structp png, png_infop info, pngPicture *picture)
{
    png_set_IHDR(png, info, static_cast<png_uint_32>(picture->cols), static_cast<png_uint_32>(picture->rows), 16,
                 PNG_COLOR_TYPE_GRAY, PNG_INTERLACE_NONE, PNG_COMPRESSION_TYPE_DEFAULT, PNG_FILTER_TYPE_DEFAULT);
    png_write_info(png, info);
    png_write_image(png, picture->pixels);
    png_write_end(png, info);
}

/// The rows one after the other, stride bytes each.
std::vector<png_bytep> rowPointers(std::vector<png_byte> &pixels, std::size_t stride)
{
    std::vector<png_bytep> rows;
    for (std::size_t at = 0; at < pixels.size(); at += stride)
        rows.push_back(pixels.data() + at);
    return rows;
}

} // namespace

bool ReadKernelPng(floatArray &destination, int maxSize, Sarnik::CContainer &in, std::string &message)
{
    std::array<png_byte, kSignatureLength> signature;
    in.ReadBytes(std::as_writable_bytes(std::span(signature)));
    if (png_sig_cmp(signature.data(), 0, signature.size()) != 0)
    {
        message = Sarnik::Localize("$$$/Deblur/Error/ReadKernelDataFromPNG/InvalidSinature=Invalid file format: "
                                   "support files in 16-bit gray-scale PNG format only.");
        return false;
    }

    PPngSession session(in, PPngSession::Direction::Reading);
    pngHeader header{};
    if (!session.Good() || !session.Guarded(readHeader, &header))
        return false;
    if (const char *refusal = refusalOf(header, maxSize))
    {
        message = Sarnik::Localize(refusal, {std::to_string(kSmallestKernelPng)});
        return false;
    }

    const std::size_t stride = static_cast<std::size_t>(header.width) * header.channels * (header.depth / 8);
    std::vector<png_byte> pixels(stride * header.height);
    std::vector<png_bytep> rows = rowPointers(pixels, stride);
    if (!session.Guarded(readRows, rows.data()))
        return false;

    const int side = static_cast<int>(header.height) | 1;
    const floatArray kernel = floatArray::allocate(side, side);
    CorvaneDeblur::fill(kernel, 0.0f);
    convertRows(rows, header, kernel);
    CorvaneDeblur::normaliseSum(kernel);
    destination = kernel;
    return true;
}

bool WriteKernelPng(const floatArray &source, Sarnik::CContainer &out, std::string &)
{
    const float peak = CorvaneDeblur::peak(source);
    std::vector<png_byte> pixels;
    pixels.reserve(static_cast<std::size_t>(source.rows) * source.cols * 2);
    for (int y = 0; y < source.rows; ++y)
        for (int x = 0; x < source.cols; ++x)
        {
            const float value = source.at(y, x) * 65535.0f / peak;
            const int code = value > 0.0f ? static_cast<int>(std::min(value, 65535.0f)) : 0; // NaN is not above 0
            pixels.push_back(static_cast<png_byte>(code >> 8));
            pixels.push_back(static_cast<png_byte>(code & 0xFF));
        }

    std::vector<png_bytep> rows = rowPointers(pixels, static_cast<std::size_t>(source.cols) * 2);
    pngPicture picture{source.rows, source.cols, rows.data()};
    PPngSession session(out, PPngSession::Direction::Writing);
    return session.Good() && session.Guarded(writePicture, &picture);
}

} // namespace Project
