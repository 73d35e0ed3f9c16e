#include "store/files/pngSession.h"

#include "framework/base/container.h"

#include <span>

namespace Project
{

namespace
{

void fail(png_structp png, png_const_charp)
{
    png_longjmp(png, 1);
}

void ignore(png_structp, png_const_charp)
{
}

/// The stream's exceptions end here: they may not pass through the library's frames.
bool readFrom(Sarnik::CContainer &stream, png_bytep bytes, std::size_t size) noexcept
try
{
    stream.ReadBytes(std::as_writable_bytes(std::span(bytes, size)));
    return true;
}
catch (...)
{
    return false;
}

bool writeTo(Sarnik::CContainer &stream, png_const_bytep bytes, std::size_t size) noexcept
try
{
    stream.WriteBytes(std::as_bytes(std::span(bytes, size)));
    return true;
}
catch (...)
{
    return false;
}

void readBytes(png_structp png, png_bytep bytes, std::size_t size)
{
    if (!readFrom(*static_cast<Sarnik::CContainer *>(png_get_io_ptr(png)), bytes, size))
        png_longjmp(png, 1);
}

void writeBytes(png_structp png, png_bytep bytes, std::size_t size)
{
    if (!writeTo(*static_cast<Sarnik::CContainer *>(png_get_io_ptr(png)), bytes, size))
        png_longjmp(png, 1);
}

void flush(png_structp)
{
}

} // namespace

PPngSession::PPngSession(Sarnik::CContainer &stream, Direction direction) : way(direction)
{
    // While a structure is created its errors jump to a place of the library's own and come back as null.
    png = way == Direction::Reading ? png_create_read_struct(PNG_LIBPNG_VER_STRING, nullptr, fail, ignore)
                                    : png_create_write_struct(PNG_LIBPNG_VER_STRING, nullptr, fail, ignore);
    if (!png)
        return;
    info = png_create_info_struct(png);
    if (way == Direction::Reading)
        png_set_read_fn(png, &stream, readBytes);
    else
        png_set_write_fn(png, &stream, writeBytes, flush);
}

PPngSession::~PPngSession()
{
    if (way == Direction::Reading)
        png_destroy_read_struct(&png, &info, nullptr);
    else
        png_destroy_write_struct(&png, &info);
}

} // namespace Project
