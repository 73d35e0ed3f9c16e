#include "host/photoWriter.h"

#include "host/pfm.h"
#include "tests/host/hostFixture.h"

#include <cmath>
#include <csignal>
#include <cstring>
#include <fcntl.h>
#include <gmock/gmock.h>
#include <numeric>
#include <sys/resource.h>
#include <thread>
#include <unistd.h>

namespace Stillmark
{
namespace
{

using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::StartsWith;

/// Hands the colours of a photo on as they are, in tiles and from two threads.
void copyColours(const photo &from, photoWriter &to)
{
    constexpr int tile = 50;
    const auto copyBands = [&](int start) {
        for (int y = start * tile; y < from.height(); y += 2 * tile)
            for (int x = 0; x < from.width(); x += tile)
            {
                const rectangle area{x, y, std::min(tile, from.width() - x), std::min(tile, from.height() - y)};
                const std::size_t rowBytes = 4 * tile + 4; // rows with a gap
                std::vector<std::uint8_t> planes(rowBytes * area.height * from.colourPlanes());
                from.read(area, planes.data(), rowBytes);
                to.write(area, planes.data(), rowBytes);
            }
    };
    std::jthread other(copyBands, 1);
    copyBands(0);
}

/// Saves an unchanged copy; the notes.
std::vector<std::string> copyPhoto(const std::string &from, const std::string &to)
{
    const photo model = photo::open(from);
    photoWriter writer(model, to);
    copyColours(model, writer);
    writer.commit();
    return writer.notes();
}

class PhotoWriter : public hostTest
{
};

class Lossless : public hostTest, public ::testing::WithParamInterface<pictureKind>
{
};

TEST_P(Lossless, ACopyHoldsTheSameSamplesInTheSameMode)
{
    const pictureKind &kind = GetParam();
    const vipsImage original = noiseImage(kind, 143, 111);
    const std::string source = save(original.get(), "source.tif"), target = file("target" + kind.extension);
    EXPECT_THAT(copyPhoto(source, target), IsEmpty());
    const photo before = photo::open(source), after = photo::open(target);
    const auto planes = planesOf(before);
    EXPECT_EQ(after.mode(), before.mode());
    EXPECT_EQ(after.depth(), before.depth());
    EXPECT_EQ(after.extraPlanes(), before.extraPlanes());
    EXPECT_EQ(planesOf(after), planes);
    if (before.mode() == colourMode::lab) // other codes in the file, see LabCodesAreOffsetByHalfTheRange
        return;

    const std::size_t size = before.sampleBytes();
    ASSERT_EQ(size, vips_format_sizeof(kind.format));
    ASSERT_EQ(planes.size(), VIPS_IMAGE_SIZEOF_IMAGE(original.get()));
    int different = 0;
    for (int p = 0; p < kind.bands; ++p)
        for (int y = 0; y < 111; ++y)
            for (int x = 0; x < 143; ++x)
                different += std::memcmp(planes.data() + ((p * 111 + y) * 143 + x) * size,
                                         VIPS_IMAGE_ADDR(original.get(), x, y) + p * size, size) != 0;
    EXPECT_EQ(different, 0);
}

INSTANTIATE_TEST_SUITE_P(
    Kinds, Lossless,
    ::testing::Values(pictureKind{"grey8", ".png", 1, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_B_W},
                      pictureKind{"rgba8", ".png", 4, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_sRGB},
                      pictureKind{"rgb16", ".png", 3, VIPS_FORMAT_USHORT, VIPS_INTERPRETATION_RGB16},
                      pictureKind{"masks16", ".tiff", 6, VIPS_FORMAT_USHORT, VIPS_INTERPRETATION_RGB16},
                      pictureKind{"cmyka16", ".TIF", 5, VIPS_FORMAT_USHORT, VIPS_INTERPRETATION_CMYK},
                      pictureKind{"lab16", ".tif", 3, VIPS_FORMAT_SHORT, VIPS_INTERPRETATION_LABS},
                      pictureKind{"laba16", ".tif", 4, VIPS_FORMAT_SHORT, VIPS_INTERPRETATION_LABS},
                      pictureKind{"greyFloat", ".tif", 1, VIPS_FORMAT_FLOAT, VIPS_INTERPRETATION_B_W},
                      pictureKind{"rgbaFloat", ".tif", 4, VIPS_FORMAT_FLOAT, VIPS_INTERPRETATION_scRGB},
                      pictureKind{"rgbFloat", ".pfm", 3, VIPS_FORMAT_FLOAT, VIPS_INTERPRETATION_scRGB}),
    [](const auto &test) { return test.param.name; });

/// One flat colour, as large as a JPEG or WebP needs to show it undistorted.
vipsImage flat(const pictureKind &kind, const std::vector<double> &pixel)
{
    VipsImage *black = nullptr, *made = nullptr;
    std::vector<double> ones(pixel.size(), 1);
    vips_black(&black, 64, 48, "bands", kind.bands, nullptr);
    const vipsImage ground(black);
    vips_linear(ground.get(), &made, ones.data(), const_cast<double *>(pixel.data()), kind.bands, nullptr);
    const vipsImage doubles(made);
    vips_cast(doubles.get(), &made, kind.format, nullptr);
    const vipsImage cast(made);
    vips_copy(cast.get(), &made, "interpretation", kind.meaning, nullptr);
    return vipsImage(made);
}

// What a pixel becomes where the target cannot hold it. Tolerances: coding losses, and rounding in colour conversions.
TEST_F(PhotoWriter, ConvertsWhatTheFormatCannotHoldAndSaysSo)
{
    struct conversion
    {
        pictureKind from;
        std::vector<double> pixel;
        std::string target;
        std::vector<double> result;
        double tolerance;
        std::vector<std::string> notes;
    };
    const pictureKind rgb16{"rgb16", ".tif", 3, VIPS_FORMAT_USHORT, VIPS_INTERPRETATION_RGB16};
    const pictureKind rgba8{"rgba8", ".tif", 4, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_sRGB};
    const pictureKind masks{"masks", ".tif", 5, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_sRGB};
    const pictureKind cmyk8{"cmyk8", ".tif", 4, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_CMYK};
    const pictureKind cmyka8{"cmyka8", ".tif", 5, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_CMYK};
    const pictureKind lab16{"lab16", ".tif", 3, VIPS_FORMAT_SHORT, VIPS_INTERPRETATION_LABS};
    const pictureKind laba16{"laba16", ".tif", 4, VIPS_FORMAT_SHORT, VIPS_INTERPRETATION_LABS};
    const pictureKind rgbFloat{"rgbFloat", ".tif", 3, VIPS_FORMAT_FLOAT, VIPS_INTERPRETATION_scRGB};
    const pictureKind greyFloat{"greyFloat", ".tif", 1, VIPS_FORMAT_FLOAT, VIPS_INTERPRETATION_B_W};
    const conversion cases[] = {
        {rgb16, {257 * 100 + 128, 257 * 100 + 129, 65535}, "a.jpg", {100, 101, 255}, 2, {"8 bits a channel"}},
        {rgba8, {200, 100, 0, 51}, "b.jpg", {244, 224, 204}, 2, {"over white"}},
        {rgba8, {200, 100, 0, 51}, "b.pfm", {200 / 255.0, 100 / 255.0, 0}, 1e-7, {"left out"}},
        {rgba8, {200, 100, 0, 51}, "b.webp", {200, 100, 0, 51}, 3, {}},
        {masks, {200, 100, 0, 51, 7}, "c.png", {200, 100, 0, 51}, 0, {"further masks"}},
        {cmyk8, {0, 0, 0, 0}, "d.png", {255, 255, 255}, 2, {"no CMYK"}},
        {cmyka8, {0, 0, 0, 0, 77}, "e.webp", {255, 255, 255, 77}, 2, {"no CMYK"}},
        {cmyka8, {255, 255, 255, 255, 0}, "e.jpg", {0, 0, 0, 0}, 2, {"over white"}},
        {lab16, {32767, 0, 0}, "f.png", {65535, 65535, 65535}, 300, {"no Lab"}},
        {laba16, {32767, 0, 0, 9999}, "f.jpg", {255, 255, 255}, 2, {"8 bits", "no Lab", "over white"}},
        {lab16, {32767, 0, 0}, "f.pfm", {1, 1, 1}, 0.004, {"no Lab"}},
        {rgbFloat, {-3, 0.5, 7}, "g.png", {0, 32768, 65535}, 0, {"16 bits a channel"}},
        {greyFloat, {0.25}, "h.webp", {64, 64, 64}, 2, {"8 bits a channel"}},
    };
    for (const conversion &c : cases)
    {
        SCOPED_TRACE(c.from.name + " to " + c.target);
        const std::string source = save(flat(c.from, c.pixel).get(), "source.tif");
        const auto notes = copyPhoto(source, file(c.target));
        ASSERT_EQ(notes.size(), c.notes.size());
        for (std::size_t i = 0; i < notes.size(); ++i)
            EXPECT_THAT(notes[i], HasSubstr(c.notes[i]));

        const photo saved = photo::open(file(c.target));
        ASSERT_EQ(saved.colourPlanes() + saved.extraPlanes(), static_cast<int>(c.result.size()));
        const auto sample = planesOf(saved, {30, 20, 1, 1});
        for (std::size_t p = 0; p < c.result.size(); ++p)
        {
            const double value = saved.depth() == 8    ? sample[p]
                                 : saved.depth() == 16 ? reinterpret_cast<const std::uint16_t *>(sample.data())[p]
                                                       : reinterpret_cast<const float *>(sample.data())[p];
            EXPECT_NEAR(value, c.result[p], c.tolerance) << "plane " << p;
        }
    }
}

/// A JPEG as a camera writes it, lying on its side.
std::string cameraJpeg(const std::string &path)
{
    const vipsImage image = noiseImage({"", "", 3, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_sRGB}, 33, 22);
    VipsBlob *profile = nullptr;
    vips_profile_load("p3", &profile, nullptr);
    std::size_t size = 0;
    const void *bytes = vips_blob_get(profile, &size);
    vips_image_set_blob_copy(image.get(), VIPS_META_ICC_NAME, bytes, size);
    vips_area_unref(VIPS_AREA(profile));
    const char xmp[] = "<x:xmpmeta xmlns:x='adobe:ns:meta/'/>";
    vips_image_set_blob_copy(image.get(), VIPS_META_XMP_NAME, xmp, sizeof xmp - 1);
    vips_image_set_string(image.get(), "exif-ifd0-Make", "Acme (Acme, ASCII, 5 components, 5 bytes)");
    vips_image_set_string(image.get(), "exif-ifd2-ExposureTime", "1/8 (1/8 sec., Rational, 1 components, 8 bytes)");
    vips_image_set_int(image.get(), VIPS_META_ORIENTATION, 6);
    const char iptc[] = "Photoshop 3.0\0"
                        "8BIM\x04\x04\0\0\0\0\0\x0a"
                        "\x1c\x02\x78\0\x05Hello";
    vips_image_set_blob_copy(image.get(), VIPS_META_IPTC_NAME, iptc, sizeof iptc - 1);
    image->Xres = image->Yres = 11.811; // 300 dpi
    if (vips_jpegsave(image.get(), path.c_str(), nullptr) != 0)
        throw std::runtime_error(takeVipsError());
    return path;
}

std::string blobOf(VipsImage *image, const char *name)
{
    const void *bytes = nullptr;
    std::size_t size = 0;
    if (vips_image_get_typeof(image, name) == 0 || vips_image_get_blob(image, name, &bytes, &size) != 0)
        return {};
    return {static_cast<const char *>(bytes), size};
}

std::string textOf(VipsImage *image, const char *name)
{
    const char *text = "";
    if (vips_image_get_typeof(image, name) != 0)
        vips_image_get_string(image, name, &text);
    return text;
}

TEST_F(PhotoWriter, ProfileCameraDataOrientationAndResolutionAreCarriedOver)
{
    const std::string source = cameraJpeg(file("source.jpg"));
    const vipsImage before(vips_image_new_from_file(source.c_str(), nullptr));
    for (const char *name : {"out.jpg", "out.png", "out.tif", "out.webp"})
    {
        copyPhoto(source, file(name));
        // And on from there: formats keep the same things in different places.
        for (const char *again : {"again.jpg", "again.png", "again.tif", "again.webp"})
        {
            SCOPED_TRACE(std::string(name) + ", then " + again);
            copyPhoto(file(name), file(again));
            const vipsImage after(vips_image_new_from_file(file(again).c_str(), nullptr));
            EXPECT_EQ(after->Xsize, 33);
            EXPECT_EQ(blobOf(after.get(), VIPS_META_ICC_NAME), blobOf(before.get(), VIPS_META_ICC_NAME));
            EXPECT_EQ(blobOf(after.get(), VIPS_META_XMP_NAME), blobOf(before.get(), VIPS_META_XMP_NAME));
            EXPECT_EQ(vips_image_get_orientation(after.get()), 6);
            const std::string path = std::string(name) + again;
            if (path.find("webp") == std::string::npos) // libvips does not look for a resolution there
            {
                EXPECT_NEAR(after->Xres, 11.811, 1e-3);
            }
            if (path == "out.jpgagain.jpg" || path == "out.tifagain.jpg") // the two formats that hold IPTC
            {
                EXPECT_EQ(blobOf(after.get(), VIPS_META_IPTC_NAME), blobOf(before.get(), VIPS_META_IPTC_NAME));
            }
            if (path.find("tif") != std::string::npos) // nor for EXIF here
                continue;
            for (const char *field : {"exif-ifd0-Make", "exif-ifd2-ExposureTime"})
                EXPECT_EQ(textOf(after.get(), field), textOf(before.get(), field));
        }
    }
}

TEST_F(PhotoWriter, ChecksTheTargetBeforeAnyWork)
{
    for (const char *name : {"out", "out.bmp", ".png", "none/out.png"})
        EXPECT_THROW(photoWriter::check(file(name)), Platform::fileError) << name;
    photoWriter::check(file("out.jpeg"));
    expectOnly({});

    const std::string wide = make({"wide", ".png", 1, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_B_W}, 16384, 1);
    EXPECT_THROW(photoWriter(photo::open(wide), file("wide.webp")), Platform::fileError);
}

/// Makes writes beyond a size fail, as on a full disk.
class fullDisk
{
public:
    explicit fullDisk(rlim_t bytes) : handler(std::signal(SIGXFSZ, SIG_IGN))
    {
        ::getrlimit(RLIMIT_FSIZE, &before);
        const rlimit limit{bytes, before.rlim_max};
        ::setrlimit(RLIMIT_FSIZE, &limit);
    }
    ~fullDisk()
    {
        ::setrlimit(RLIMIT_FSIZE, &before);
        std::signal(SIGXFSZ, handler);
    }

private:
    rlimit before{};
    void (*handler)(int);
};

TEST_F(PhotoWriter, AFailureLeavesTheOldFileAndNothingElse)
{
    const std::string source = make({"source", ".tif", 3, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_sRGB}, 300, 300);
    const photo model = photo::open(source);
    for (const char *name : {"out.jpg", "out.png", "out.tif", "out.webp", "out.pfm"})
    {
        SCOPED_TRACE(name);
        writeBytes(file(name), "the old one");
        {
            photoWriter writer(model, file(name));
            copyColours(model, writer);
            const fullDisk full(20000);
            try
            {
                writer.commit();
                ADD_FAILURE() << "saved on a full disk";
            }
            catch (const Platform::fileError &error)
            {
                EXPECT_THAT(error.what(), StartsWith(file(name) + ": cannot be written"));
                EXPECT_EQ(std::string(error.what()).find('\n'), std::string::npos);
            }
        }
        {
            photoWriter writer(model, file(name));
            copyColours(model, writer);
            int calls = 0;
            EXPECT_THROW(writer.commit([&](double) { return ++calls < 2; }), Platform::cancelled);
            EXPECT_EQ(calls, 2);
        }
        {
            photoWriter writer(model, file(name));
            const std::vector<std::uint8_t> row(900);
            writer.write({0, 0, 300, 1}, row.data(), 300);
            EXPECT_THROW(writer.commit(), std::logic_error);
        }
        EXPECT_EQ(bytesOf(file(name)), "the old one");
        expectOnly({"source.tif", name});
        std::filesystem::remove(file(name));
    }
}

TEST_F(PhotoWriter, AResultMayReplaceItsOwnSource)
{
    const std::string path = make({"p", ".png", 3, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_sRGB}, 90, 70);
    const auto before = planesOf(photo::open(path));
    copyPhoto(path, path);
    EXPECT_EQ(planesOf(photo::open(path)), before);
    expectOnly({"p.png"});
}

TEST_F(PhotoWriter, SameInputSameBytes)
{
    const std::string source = cameraJpeg(file("source.jpg"));
    for (const char *extension : {".jpg", ".png", ".tif", ".webp", ".pfm"})
    {
        copyPhoto(source, file(std::string("a") + extension));
        copyPhoto(source, file(std::string("b") + extension));
        EXPECT_EQ(bytesOf(file(std::string("a") + extension)), bytesOf(file(std::string("b") + extension)))
            << extension;
    }
}

} // namespace
} // namespace Stillmark
