#include "bench/photoFile.h"

#include "bench/scenes.h"
#include "host/pfm.h"
#include "host/photo.h"
#include "host/photoWriter.h"

#include <cstdio>
#include <vector>

namespace Bench
{

using namespace Stillmark;

/// Through a float map, which the host reads as a photo and saves as any other format.
void makePhoto(int width, int height, const std::string &path)
{
    const std::string scratch = path + ".pfm";
    {
        const auto planes = shakenScene(height, width, 3, 45, 53);
        floatRaster raster{width, height, 3, {}};
        for (int y = 0; y < height; ++y)
            for (int x = 0; x < width; ++x)
                for (const auto &plane : planes)
                    raster.samples.push_back(plane.row(y)[x]);
        writePfm(scratch, raster);
    }
    struct removal
    {
        const std::string &file;
        ~removal() { std::remove(file.c_str()); }
    } const removeScratch{scratch};

    const photo picture = photo::open(scratch);
    photoWriter writer(picture, path);
    const std::size_t rowBytes = static_cast<std::size_t>(width) * sizeof(float);
    std::vector<float> row(static_cast<std::size_t>(width) * 3);
    for (int y = 0; y < height; ++y)
    {
        const rectangle area{0, y, width, 1};
        picture.read(area, row.data(), rowBytes);
        writer.write(area, row.data(), rowBytes);
    }
    writer.commit();
}

} // namespace Bench
