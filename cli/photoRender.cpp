#include "cli/photoRender.h"

#include "cli/scratchFolder.h"
#include "cli/stopSignal.h"
#include "deblur/deconv/shrinkageTableStore.h"
#include "platform/files.h"

#include <algorithm>
#include <cctype>
#include <cerrno>
#include <cstdio>
#include <filesystem>
#include <memory>

namespace Stillmark
{
namespace
{

using namespace CorvaneDeblur;

rectangle areaOf(const pixelRect &area)
{
    return {area.x, area.y, area.width, area.height};
}

class photoReader : public planeReader
{
public:
    explicit photoReader(const photo &from) : picture(from) {}
    void read(const pixelRect &area, std::byte *planes, std::ptrdiff_t rowBytes) override
    {
        picture.read(areaOf(area), planes, static_cast<std::size_t>(rowBytes));
    }

private:
    const photo &picture;
};

class resultWriter : public planeWriter
{
public:
    explicit resultWriter(photoWriter &to) : result(to) {}
    void write(const pixelRect &area, const std::byte *planes, std::ptrdiff_t rowBytes) override
    {
        result.write(areaOf(area), planes, static_cast<std::size_t>(rowBytes));
    }

private:
    photoWriter &result;
};

template <class Result> void save(Result &result, runContext &context)
{
    context.bar.stage("Saving");
    stopSignal::check();
    result.commit(context.progress());
    context.notes.insert(context.notes.end(), result.notes().begin(), result.notes().end());
}

/// "jpg" for JPG, jpeg and so on.
std::string formatOf(const std::string &path)
{
    std::string name = std::filesystem::path(path).extension().string();
    std::transform(name.begin(), name.end(), name.begin(),
                   [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    return name == ".jpeg" ? ".jpg" : name == ".tiff" ? ".tif" : name;
}

void copyFile(const std::string &from, const std::string &to, runContext &context)
{
    const std::unique_ptr<std::FILE, int (*)(std::FILE *)> file(std::fopen(from.c_str(), "rb"), std::fclose);
    if (!file)
        throw Platform::errnoError(from, "cannot be read", errno);
    std::error_code unknown;
    const double size = std::max(1.0, static_cast<double>(std::filesystem::file_size(from, unknown)));

    Platform::atomicFile copy(to);
    std::vector<char> bytes(1 << 20);
    double copied = 0;
    while (const std::size_t count = std::fread(bytes.data(), 1, bytes.size(), file.get()))
    {
        stopSignal::check();
        copy.write(bytes.data(), count);
        copied += static_cast<double>(count);
        context.bar.set(copied / size);
    }
    if (std::ferror(file.get()))
        throw Platform::errnoError(from, "cannot be read", errno);
    copy.commit();
}

void copyPixels(const photo &picture, photoWriter &result, runContext &context)
{
    const std::size_t rowBytes =
        static_cast<std::size_t>(picture.width()) * static_cast<std::size_t>(picture.sampleBytes());
    constexpr int rowsAtOnce = 64;
    std::vector<std::byte> strip(rowBytes * static_cast<std::size_t>(picture.colourPlanes()) * rowsAtOnce);
    for (int y = 0; y < picture.height(); y += rowsAtOnce)
    {
        stopSignal::check();
        const rectangle area{0, y, picture.width(), std::min(rowsAtOnce, picture.height() - y)};
        picture.read(area, strip.data(), rowBytes);
        result.write(area, strip.data(), rowBytes);
        context.bar.set(static_cast<double>(y) / picture.height());
    }
}

} // namespace

void renderPhoto(const photo &picture, photoWriter &result, const renderSettings &settings, runContext &context)
{
    context.bar.stage("Removing it");
    shrinkageTableStore tables(scratchFolder());
    cellRenderSettings cells;
    cells.imageCols = picture.width();
    cells.imageRows = picture.height();
    cells.planes = picture.colourPlanes();
    cells.depth = picture.depth();
    cells.method = settings.method;
    cells.kernels = settings.kernels;
    cells.cellSize = settings.cellSize;
    photoReader source(picture);
    resultWriter destination(result);
    const auto progress = [&](int done, int total) { context.bar.set(static_cast<double>(done) / total); };
    if (!renderCells(cells, tables, source, destination, progress, stopSignal::requested()))
        throw Platform::cancelled();
    save(result, context);
}

void saveResult(resultRaster &result, runContext &context)
{
    save(result, context);
}

void savePhotoUnchanged(const photo &picture, const std::string &path, runContext &context)
{
    context.bar.stage("Saving");
    if (formatOf(picture.path()) == formatOf(path))
        return copyFile(picture.path(), path, context);
    photoWriter result(picture, path);
    copyPixels(picture, result, context);
    save(result, context);
}

} // namespace Stillmark
