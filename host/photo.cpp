#include "host/photo.h"

#include "host/pfm.h"
#include "host/photoContent.h"
#include "host/photoMetadata.h"
#include "platform/files.h"

#include <algorithm>
#include <cassert>
#include <cerrno>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace Stillmark
{

namespace
{

/// An open file, closed at the end of the scope.
struct openedFile
{
    explicit openedFile(const std::string &path)
        : descriptor(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK)) // a pipe must not make us wait
    {
    }
    openedFile(const openedFile &) = delete;
    openedFile &operator=(const openedFile &) = delete;
    ~openedFile()
    {
        if (descriptor >= 0)
            ::close(descriptor);
    }

    int descriptor;
};

} // namespace

photo photo::open(const std::string &path, const progressCheck &progress)
{
    const std::string failure = "cannot be read";
    const openedFile file(path);
    struct stat info;
    if (file.descriptor < 0 || ::fstat(file.descriptor, &info) != 0)
        throw Platform::errnoError(path, failure, errno);
    if (S_ISDIR(info.st_mode))
        throw Platform::errnoError(path, failure, EISDIR);
    if (!S_ISREG(info.st_mode))
        throw Platform::fileError(path + ": " + failure + ": it is not a regular file");
    if (info.st_size == 0)
        throw Platform::fileError(path + ": " + failure + ": it is empty");

    std::uint8_t start[4];
    const ssize_t got = ::pread(file.descriptor, start, sizeof start, 0);
    if (got < 0)
        throw Platform::errnoError(path, failure, errno);
    if (pfmReader::recognises(start, static_cast<std::size_t>(got)))
        return photo(loadFloatMap(path, progress));
    return photo(loadPicture(path, file.descriptor, progress));
}

int photo::width() const
{
    return opened->raster->width();
}

int photo::height() const
{
    return opened->raster->height();
}

int photo::depth() const
{
    return opened->raster->sampleBytes() * 8;
}

colourMode photo::mode() const
{
    return opened->mode;
}

int photo::colourPlanes() const
{
    return colourPlanesOf(opened->mode);
}

int photo::extraPlanes() const
{
    return opened->extraPlanes;
}

const std::string &photo::path() const
{
    return opened->path;
}

const std::vector<std::string> &photo::notes() const
{
    return opened->notes;
}

std::vector<std::uint8_t> photo::profile() const
{
    return profileOf(opened->metadata.get());
}

void photo::read(const rectangle &area, void *planar, std::size_t rowBytes) const
{
    readPlanes(area, 0, colourPlanes(), planar, rowBytes);
}

void photo::readPlanes(const rectangle &area, int firstPlane, int planes, void *planar, std::size_t rowBytes) const
{
    const sampleRaster &raster = *opened->raster;
    assert(firstPlane >= 0 && planes >= 0 && firstPlane + planes <= raster.planes());
    if (area.width <= 0 || area.height <= 0)
        return;

    const std::size_t rowLength = static_cast<std::size_t>(area.width) * raster.pixelBytes();
    const std::size_t planeBytes = static_cast<std::size_t>(area.height) * rowBytes;
    const int bandRows = std::min(raster.bandRows(area.width), area.height);
    std::vector<std::uint8_t> band(rowLength * static_cast<std::size_t>(bandRows));
    for (int y = 0; y < area.height; y += bandRows)
    {
        const int rows = std::min(bandRows, area.height - y);
        raster.read({area.x, area.y + y, area.width, rows}, band.data(), rowLength);
        auto *to = static_cast<std::uint8_t *>(planar) + static_cast<std::size_t>(y) * rowBytes;
        pixelsToPlanes(band.data(), area.width, rows, raster.planes(), raster.sampleBytes(), firstPlane, planes, to,
                       rowBytes, planeBytes);
    }
}

std::shared_ptr<photo::content> loadFloatMap(const std::string &path, const progressCheck &progress)
{
    const pfmReader reader(path);
    auto picture = std::make_shared<photo::content>();
    picture->path = path;
    picture->mode = reader.planes() == 3 ? colourMode::rgb : colourMode::grey;
    picture->raster = std::make_unique<sampleRaster>(reader.width(), reader.height(), reader.planes(), 4);
    const std::size_t rowSamples = static_cast<std::size_t>(reader.width()) * static_cast<std::size_t>(reader.planes());
    std::vector<float> row(rowSamples);
    for (int y = 0; y < reader.height(); ++y)
    {
        if (progress && y % 64 == 0 && !progress(static_cast<double>(y) / reader.height()))
            throw Platform::cancelled();
        reader.readRow(y, row.data());
        picture->raster->write({0, y, reader.width(), 1}, row.data(), rowSamples * sizeof(float));
    }
    return picture;
}

} // namespace Stillmark
