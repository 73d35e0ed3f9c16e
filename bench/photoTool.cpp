#include "bench/scenes.h"
#include "host/pfm.h"
#include "host/photo.h"
#include "host/photoWriter.h"

#include <charconv>
#include <cstdio>
#include <cstring>
#include <exception>
#include <string>
#include <vector>

/// stillmark_bench_photo WIDTH HEIGHT OUT: makes a shaken photograph, RGB, 8 bits a sample unless OUT is a .pfm.
/// stillmark_bench_photo PHOTO: prints the bytes of the decoded picture.
namespace
{

using namespace Stillmark;

constexpr int largestSide = 20000;

int parseSide(const char *text)
{
    int side = 0;
    const auto [end, error] = std::from_chars(text, text + std::strlen(text), side);
    if (error != std::errc() || *end != '\0' || side < 1 || side > largestSide)
        throw std::runtime_error(std::string("not a number of pixels: ") + text);
    return side;
}

/// Through a float map, which the host reads as a photo and saves as any other format.
void makePhoto(int width, int height, const std::string &path)
{
    const std::string scratch = path + ".pfm";
    {
        const auto planes = Bench::shakenScene(height, width, 3, 45, 53);
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

void describePhoto(const std::string &path)
{
    const photo picture = photo::open(path);
    const long long samples =
        static_cast<long long>(picture.width()) * picture.height() * (picture.colourPlanes() + picture.extraPlanes());
    std::printf("%lld\n", samples * picture.sampleBytes());
}

} // namespace

int main(int argc, char **argv)
{
    try
    {
        if (argc == 4)
            makePhoto(parseSide(argv[1]), parseSide(argv[2]), argv[3]);
        else if (argc == 2)
            describePhoto(argv[1]);
        else
        {
            std::fprintf(stderr, "usage: stillmark_bench_photo WIDTH HEIGHT OUT, or stillmark_bench_photo PHOTO\n");
            return 2;
        }
        return 0;
    }
    catch (const std::exception &e)
    {
        std::fprintf(stderr, "stillmark_bench_photo: %s\n", e.what());
        return 1;
    }
}
