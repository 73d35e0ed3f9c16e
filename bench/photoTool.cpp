#include "bench/photoFile.h"
#include "host/photo.h"

#include <charconv>
#include <cstdio>
#include <cstring>
#include <exception>
#include <string>

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
            Bench::makePhoto(parseSide(argv[1]), parseSide(argv[2]), argv[3]);
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
