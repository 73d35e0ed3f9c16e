#include "host/photoWriter.h"

#include "host/photoMetadata.h"
#include "host/photoSaver.h"

#include <algorithm>
#include <atomic>
#include <cassert>
#include <stdexcept>

namespace Stillmark
{

struct photoWriter::state
{
    std::shared_ptr<const photo::content> model;
    std::string path;
    const photoFormat &format;
    savePlan plan;
    sampleRaster raster;
    std::atomic<std::uint64_t> pixelsWritten{0};
};

void photoWriter::check(const std::string &path)
{
    formatForPath(path);
    Platform::checkWritable(path);
}

photoWriter::photoWriter(const photo &model, const std::string &path)
{
    const photoFormat &format = formatForPath(path);
    Platform::checkWritable(path);
    savePlan plan = planSaving(model, format, path);
    noteLostMetadata(model.opened->metadata.get(), format.id, plan);
    const sampleRaster &like = *model.opened->raster;
    s.reset(new state{model.opened, path, format, std::move(plan),
                      sampleRaster(like.width(), like.height(), like.planes(), like.sampleBytes())});
}

photoWriter::~photoWriter() = default;

const std::vector<std::string> &photoWriter::notes() const
{
    return s->plan.notes;
}

void photoWriter::write(const rectangle &area, const void *planar, std::size_t rowBytes)
{
    if (area.width <= 0 || area.height <= 0)
        return;
    sampleRaster &raster = s->raster;
    const int colours = colourPlanesOf(s->model->mode);
    const std::size_t rowLength = static_cast<std::size_t>(area.width) * raster.pixelBytes();
    const std::size_t planeBytes = static_cast<std::size_t>(area.height) * rowBytes;
    const int bandRows = std::min(raster.bandRows(area.width), area.height);
    std::vector<std::uint8_t> band(rowLength * static_cast<std::size_t>(bandRows));
    for (int y = 0; y < area.height; y += bandRows)
    {
        const rectangle part{area.x, area.y + y, area.width, std::min(bandRows, area.height - y)};
        if (s->model->extraPlanes > 0)
            s->model->raster->read(part, band.data(), rowLength);
        const auto *from = static_cast<const std::uint8_t *>(planar) + static_cast<std::size_t>(y) * rowBytes;
        for (int p = 0; p < colours; ++p, from += planeBytes)
            planeToPixels(from, rowBytes, part.width, part.height, raster.planes(), raster.sampleBytes(), p,
                          band.data());
        raster.write(part, band.data(), rowLength);
    }
    s->pixelsWritten += static_cast<std::uint64_t>(area.width) * static_cast<std::uint64_t>(area.height);
}

void photoWriter::takeModelPixels()
{
    const sampleRaster &model = *s->model->raster;
    const int width = model.width(), rowsAtOnce = model.bandRows(width);
    const std::size_t rowBytes = static_cast<std::size_t>(width) * model.pixelBytes();
    std::vector<std::uint8_t> band(rowBytes * static_cast<std::size_t>(rowsAtOnce));
    for (int y = 0; y < model.height(); y += rowsAtOnce)
    {
        const rectangle rows{0, y, width, std::min(rowsAtOnce, model.height() - y)};
        model.read(rows, band.data(), rowBytes);
        s->raster.write(rows, band.data(), rowBytes);
    }
    s->pixelsWritten = static_cast<std::uint64_t>(width) * static_cast<std::uint64_t>(model.height());
}

void photoWriter::replacePlane(int plane, const rectangle &area, const void *samples, std::size_t rowBytes)
{
    s->raster.writePlane(area, plane, samples, rowBytes);
}

void photoWriter::commit(const progressCheck &progress)
{
    if (s->pixelsWritten != static_cast<std::uint64_t>(s->raster.width()) * s->raster.height())
        throw std::logic_error("photoWriter: not every pixel was written once");
    Platform::atomicFile file(s->path);
    savePicture(s->raster, *s->model, s->format, s->plan, file, s->path, progress);
    file.commit(true);
}

} // namespace Stillmark
