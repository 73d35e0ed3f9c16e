#include "tests/host/hostFixture.h"

#include <algorithm>
#include <ostream>
#include <random>

namespace Stillmark
{

void PrintTo(const pictureKind &kind, std::ostream *out)
{
    *out << kind.name << kind.extension;
}

vipsImage noiseImage(const pictureKind &kind, int width, int height)
{
    std::mt19937 noise(static_cast<unsigned>(width * 31 + kind.bands));
    const std::size_t samples = static_cast<std::size_t>(width) * height * kind.bands;
    std::vector<std::uint8_t> bytes(samples * vips_format_sizeof(kind.format));
    if (kind.format == VIPS_FORMAT_FLOAT)
        std::generate_n(reinterpret_cast<float *>(bytes.data()), samples,
                        [&] { return static_cast<float>(noise() % 20001) / 10000 - 0.5f; });
    else
        std::generate(bytes.begin(), bytes.end(), [&] { return static_cast<std::uint8_t>(noise()); });
    vipsImage image(
        vips_image_new_from_memory_copy(bytes.data(), bytes.size(), width, height, kind.bands, kind.format));
    image->Type = kind.meaning;
    return image;
}

std::string hostTest::make(const pictureKind &kind, int width, int height) const
{
    return save(noiseImage(kind, width, height).get(), kind.name + kind.extension);
}

std::string hostTest::save(VipsImage *image, const std::string &name) const
{
    const std::string path = file(name);
    if (vips_image_write_to_file(image, path.c_str(), nullptr) != 0)
        throw std::runtime_error(takeVipsError());
    return path;
}

void hostTest::expectOnly(std::vector<std::string> names) const
{
    std::sort(names.begin(), names.end());
    EXPECT_EQ(folder.names(), names);
}

std::vector<std::uint8_t> planesOf(const photo &picture, const rectangle &area)
{
    const std::size_t rowBytes = static_cast<std::size_t>(area.width) * picture.sampleBytes();
    const int planes = picture.colourPlanes() + picture.extraPlanes();
    std::vector<std::uint8_t> samples(rowBytes * area.height * planes);
    picture.readPlanes(area, 0, planes, samples.data(), rowBytes);
    return samples;
}

std::vector<std::uint8_t> planesOf(const photo &picture)
{
    return planesOf(picture, {0, 0, picture.width(), picture.height()});
}

std::string refusal(const std::string &path)
{
    try
    {
        photo::open(path);
        return {};
    }
    catch (const Platform::fileError &error)
    {
        return error.what();
    }
}

} // namespace Stillmark
