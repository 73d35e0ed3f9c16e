#include "host/pfm.h"

#include "platform/files.h"

#include <bit>
#include <cerrno>
#include <charconv>
#include <cmath>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace Stillmark
{

namespace
{

bool isSpace(char c)
{
    return c == ' ' || c == '\t' || c == '\n' || c == '\r';
}

/// Takes the next word and the white space before it off text; empty if there is none.
std::string_view nextWord(std::string_view &text)
{
    while (!text.empty() && isSpace(text.front()))
        text.remove_prefix(1);
    std::size_t length = 0;
    while (length < text.size() && !isSpace(text[length]))
        ++length;
    const std::string_view word = text.substr(0, length);
    text.remove_prefix(length);
    return word;
}

template <typename Number> bool parse(std::string_view word, Number &value)
{
    const auto [end, code] = std::from_chars(word.data(), word.data() + word.size(), value);
    return code == std::errc() && end == word.data() + word.size();
}

void swapBytes(float *samples, std::size_t count)
{
    for (std::size_t i = 0; i < count; ++i)
        samples[i] = std::bit_cast<float>(__builtin_bswap32(std::bit_cast<std::uint32_t>(samples[i])));
}

/// Like pread, but until everything is there or the file ends.
std::size_t readAt(int fd, std::uint64_t offset, void *bytes, std::size_t size, const std::string &path)
{
    std::size_t got = 0;
    while (got < size)
    {
        const ssize_t n = ::pread(fd, static_cast<char *>(bytes) + got, size - got, static_cast<off_t>(offset + got));
        if (n < 0 && errno == EINTR)
            continue;
        if (n < 0)
            throw Platform::errnoError(path, "cannot be read", errno);
        if (n == 0)
            break;
        got += static_cast<std::size_t>(n);
    }
    return got;
}

} // namespace

pfmReader::pfmReader(const std::string &file) : path(file), fd(::open(file.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK))
{
    if (fd < 0)
        throw Platform::errnoError(path, "cannot be read", errno);
    try
    {
        parseHeader();
    }
    catch (...)
    {
        ::close(fd);
        throw;
    }
}

pfmReader::~pfmReader()
{
    ::close(fd);
}

bool pfmReader::recognises(const std::uint8_t *bytes, std::size_t size)
{
    return size >= 3 && bytes[0] == 'P' && (bytes[1] == 'f' || bytes[1] == 'F') && isSpace(static_cast<char>(bytes[2]));
}

void pfmReader::parseHeader()
{
    char bytes[256];
    const std::size_t size = readAt(fd, 0, bytes, sizeof bytes, path);
    if (!recognises(reinterpret_cast<const std::uint8_t *>(bytes), size))
        throw Platform::fileError(path + ": is not a portable float map");
    samplesPerPixel = bytes[1] == 'F' ? 3 : 1;

    std::string_view text(bytes + 2, size - 2);
    double scale = 0;
    if (!parse(nextWord(text), columns) || !parse(nextWord(text), rows) || !parse(nextWord(text), scale) ||
        columns < 1 || rows < 1 || !std::isfinite(scale) || scale == 0 || text.empty())
        throw Platform::fileError(path + ": its header is damaged");
    if (columns > largestPfmSide || rows > largestPfmSide)
        throw Platform::fileError(path + ": too large: its header says " + std::to_string(columns) + " x " +
                                  std::to_string(rows) + " pixels");
    start = size - text.size() + 1; // one white space ends the header; the next byte may look like another
    foreignOrder = (scale < 0) != (std::endian::native == std::endian::little);

    struct stat info;
    const std::uint64_t needed = std::uint64_t{4} * static_cast<std::uint64_t>(columns) *
                                 static_cast<std::uint64_t>(rows) * static_cast<std::uint64_t>(samplesPerPixel);
    if (::fstat(fd, &info) != 0)
        throw Platform::errnoError(path, "cannot be read", errno);
    if (static_cast<std::uint64_t>(info.st_size) < start + needed)
        throw Platform::fileError(path + ": cut short: " + std::to_string(start + needed) + " bytes are announced, " +
                                  std::to_string(info.st_size) + " are there");
}

void pfmReader::readRow(int y, float *samples) const
{
    const std::size_t count = static_cast<std::size_t>(columns) * static_cast<std::size_t>(samplesPerPixel);
    const std::uint64_t offset = start + static_cast<std::uint64_t>(rows - 1 - y) * count * sizeof(float);
    if (readAt(fd, offset, samples, count * sizeof(float), path) != count * sizeof(float))
        throw Platform::fileError(path + ": cut short while it was read");
    if (foreignOrder)
        swapBytes(samples, count);
}

floatRaster readPfm(const std::string &path)
{
    const pfmReader reader(path);
    floatRaster raster{reader.width(), reader.height(), reader.planes(), {}};
    const std::size_t row = static_cast<std::size_t>(raster.width) * static_cast<std::size_t>(raster.planes);
    raster.samples.resize(row * static_cast<std::size_t>(raster.height));
    for (int y = 0; y < raster.height; ++y)
        reader.readRow(y, raster.samples.data() + static_cast<std::size_t>(y) * row);
    return raster;
}

std::string pfmHeader(int width, int height, int planes)
{
    return (planes == 3 ? "PF\n" : "Pf\n") + std::to_string(width) + " " + std::to_string(height) + "\n-1.0\n";
}

void writePfm(const std::string &path, const floatRaster &raster)
{
    static_assert(std::endian::native == std::endian::little, "samples are written as they lie in memory");
    const std::size_t row = static_cast<std::size_t>(raster.width) * static_cast<std::size_t>(raster.planes);
    Platform::atomicFile file(path);
    const std::string header = pfmHeader(raster.width, raster.height, raster.planes);
    file.write(header.data(), header.size());
    for (int y = raster.height - 1; y >= 0; --y)
        file.write(raster.samples.data() + static_cast<std::size_t>(y) * row, row * sizeof(float));
    file.commit();
}

} // namespace Stillmark
