#include "tests/framework/controls/goldenPicture.h"

#include <png.h>

#include <algorithm>
#include <cstdlib>
#include <vector>

namespace Sarnik::Test
{
namespace
{

std::vector<png_byte> bytesOf(const Platform::raster &picture)
{
    std::vector<png_byte> bytes;
    for (int y = 0; y < picture.height(); ++y)
        for (int x = 0; x < picture.width(); ++x)
        {
            const Platform::colour c = Platform::unpacked(picture.row(y)[x]);
            bytes.insert(bytes.end(), {c.red, c.green, c.blue});
        }
    return bytes;
}

struct png
{
    png()
    {
        image.version = PNG_IMAGE_VERSION;
        image.format = PNG_FORMAT_RGB;
    }
    ~png() { png_image_free(&image); }
    png(const png &) = delete;
    png &operator=(const png &) = delete;
    png_image image{};
};

testing::AssertionResult compared(const std::vector<png_byte> &drawn, const std::string &file, png_uint_32 width,
                                  png_uint_32 height)
{
    png golden;
    if (png_image_begin_read_from_file(&golden.image, file.c_str()) == 0)
        return testing::AssertionFailure() << file << ": " << golden.image.message;
    golden.image.format = PNG_FORMAT_RGB;
    if (golden.image.width != width || golden.image.height != height)
        return testing::AssertionFailure() << file << " has another size";
    std::vector<png_byte> expected(PNG_IMAGE_SIZE(golden.image));
    if (png_image_finish_read(&golden.image, nullptr, expected.data(), 0, nullptr) == 0)
        return testing::AssertionFailure() << file << ": " << golden.image.message;

    std::size_t off = 0, worstAt = 0;
    int worst = 0;
    for (std::size_t i = 0; i < drawn.size(); i += 3)
    {
        int difference = 0;
        for (std::size_t k = i; k < i + 3; ++k)
            difference = std::max(difference, std::abs(int{drawn[k]} - expected[k]));
        off += difference > 8;
        if (difference > worst)
            worst = difference, worstAt = i / 3;
    }
    if (off * 50 <= std::size_t{width} * height && worst <= 96)
        return testing::AssertionSuccess();
    return testing::AssertionFailure() << off << " pixels differ from " << file << ", the worst by " << worst << " at "
                                       << worstAt % width << "," << worstAt / width;
}

} // namespace

testing::AssertionResult looksLike(const Platform::raster &picture, const std::string &name)
{
    const std::vector<png_byte> drawn = bytesOf(picture);
    png written;
    written.image.width = static_cast<png_uint_32>(picture.width());
    written.image.height = static_cast<png_uint_32>(picture.height());
    testing::AssertionResult result = compared(drawn, std::string(STILLMARK_TEST_DATA "/controls/") + name + ".png",
                                               written.image.width, written.image.height);
    if (result)
        return result;
    const std::string left = testing::TempDir() + name + ".png";
    png_image_write_to_file(&written.image, left.c_str(), 0, drawn.data(), 0, nullptr);
    return result << "; the drawn one is " << left;
}

} // namespace Sarnik::Test
