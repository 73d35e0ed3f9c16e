#include "host/sampleRaster.h"
#include "tests/host/hostFixture.h"

#include <atomic>
#include <cmath>
#include <cstring>
#include <gmock/gmock.h>
#include <random>
#include <thread>

namespace Stillmark
{
namespace
{

using ::testing::AllOf;
using ::testing::EndsWith;
using ::testing::HasSubstr;
using ::testing::Not;
using ::testing::SizeIs;
using ::testing::StartsWith;

class Photo : public hostTest
{
};

// 8-bit Lab is stored as L, a, b bytes, the latter two signed; 16-bit as L over the full range and a, b times 256.
TEST_F(Photo, LabCodesAreOffsetByHalfTheRange)
{
    const float lab[] = {100, 0, 0, 0, -128, 127, 60, 20, -30};
    const vipsImage flat(vips_image_new_from_memory_copy(lab, sizeof lab, 3, 1, 3, VIPS_FORMAT_FLOAT));
    flat->Type = VIPS_INTERPRETATION_LAB;
    VipsImage *converted = nullptr;

    ASSERT_EQ(vips_Lab2LabQ(flat.get(), &converted, nullptr), 0);
    const photo bytes = photo::open(save(vipsImage(converted).get(), "lab8.tif"));
    EXPECT_EQ(bytes.mode(), colourMode::lab);
    ASSERT_EQ(bytes.depth(), 8);
    EXPECT_EQ(planesOf(bytes), (std::vector<std::uint8_t>{255, 0, 153, 128, 0, 148, 128, 255, 98}));

    ASSERT_EQ(vips_Lab2LabS(flat.get(), &converted, nullptr), 0);
    const photo shorts = photo::open(save(vipsImage(converted).get(), "lab16.tif"));
    ASSERT_EQ(shorts.depth(), 16);
    const auto planes = planesOf(shorts);
    const auto *codes = reinterpret_cast<const std::uint16_t *>(planes.data());
    const double expected[] = {65535, 0, 39321, 32768, 0, 37888, 32768, 65280, 25088};
    for (int i = 0; i < 9; ++i)
        EXPECT_NEAR(codes[i], expected[i], 4) << i; // of L libvips keeps 15 bits

    const photo floats = photo::open(save(flat.get(), "lab32.tif"));
    EXPECT_EQ(floats.depth(), 16);
    EXPECT_THAT(floats.notes(), SizeIs(1));
}

TEST_F(Photo, RegionsEqualTheWholeInAnyOrderFromSeveralThreads)
{
    const photo picture = photo::open(make({"p", ".png", 4, VIPS_FORMAT_USHORT, VIPS_INTERPRETATION_RGB16}, 613, 411));
    const auto whole = planesOf(picture);
    std::atomic<int> wrong = 0;
    const auto readSome = [&](unsigned seed) {
        std::mt19937 random(seed);
        for (int n = 0; n < 60; ++n)
        {
            const int x = static_cast<int>(random() % 613), y = static_cast<int>(random() % 411);
            const int w = 1 + static_cast<int>(random() % (613 - x)), h = 1 + static_cast<int>(random() % (411 - y));
            const auto part = planesOf(picture, {x, y, w, h});
            for (int p = 0; p < 4; ++p)
                for (int r = 0; r < h; ++r)
                    wrong += std::memcmp(part.data() + (p * h + r) * w * 2,
                                         whole.data() + ((p * 411 + y + r) * 613 + x) * 2, w * 2) != 0;
        }
    };
    {
        std::vector<std::jthread> readers;
        for (unsigned seed = 1; seed <= 4; ++seed)
            readers.emplace_back(readSome, seed);
    }
    EXPECT_EQ(wrong, 0);
}

TEST_F(Photo, ARasterOnDiskHoldsWhatOneInMemoryHolds)
{
    sampleRaster memory(301, 77, 3, 2), disk(301, 77, 3, 2, 0);
    std::mt19937 random(5);
    std::vector<std::uint16_t> pixels(301 * 77 * 3);
    std::generate(pixels.begin(), pixels.end(), [&] { return static_cast<std::uint16_t>(random()); });
    for (sampleRaster *raster : {&memory, &disk})
    {
        raster->write({0, 0, 301, 77}, pixels.data(), 301 * 6);
        raster->write({17, 9, 120, 30}, pixels.data() + 5, 301 * 6);
    }
    for (const rectangle area : {rectangle{0, 0, 301, 77}, rectangle{3, 5, 200, 60}, rectangle{300, 76, 1, 1}})
    {
        std::vector<std::uint8_t> a(area.width * area.height * 6), b(a.size());
        memory.read(area, a.data(), area.width * 6);
        disk.read(area, b.data(), area.width * 6);
        EXPECT_EQ(a, b);
    }
}

TEST_F(Photo, RefusesWhatIsNoPictureWithOneLineThatNamesFileAndCause)
{
    writeBytes(file("empty.jpg"), "");
    writeBytes(file("text.jpg"), "This is a shopping list: eggs, flour, sugar.\n");
    writeBytes(file("page.svg"), "<svg xmlns='http://www.w3.org/2000/svg' width='9' height='9'/>");
    writeBytes(file("words.csv"), "1,2,3\n4,5,6\n");
    const std::pair<std::string, std::string> cases[] = {
        {file("none.jpg"), "No such file or directory"},
        {folder.path().string(), "Is a directory"},
        {"/dev/null", "not a regular file"},
        {file("empty.jpg"), "empty"},
        {file("text.jpg"), "no picture of a known format"},
        {file("page.svg"), "no picture of a known format"},
        {file("words.csv"), "no picture of a known format"},
        {make({"ints", ".tif", 1, VIPS_FORMAT_UINT, VIPS_INTERPRETATION_B_W}, 5, 4), "neither unsigned integers"},
    };
    for (const auto &[path, cause] : cases)
        EXPECT_THAT(refusal(path), AllOf(StartsWith(path + ": "), HasSubstr(cause), Not(HasSubstr("\n"))));
}

class CutShort : public hostTest, public ::testing::WithParamInterface<pictureKind>
{
};

TEST_P(CutShort, IsReportedWhereverTheFileEndsAndNeverFilledWithGrey)
{
    const std::string whole = bytesOf(make(GetParam(), 160, 120));
    const std::string cut = file("cut" + GetParam().extension);
    ASSERT_EQ(refusal(file(GetParam().name + GetParam().extension)), "");
    for (const double part : {0.002, 0.05, 0.3, 0.5, 0.9})
    {
        writeBytes(cut, whole.substr(0, static_cast<std::size_t>(whole.size() * part)));
        ::testing::internal::CaptureStderr();
        const std::string message = refusal(cut);
        EXPECT_EQ(::testing::internal::GetCapturedStderr(), "");
        EXPECT_THAT(message, AllOf(StartsWith(cut + ": "), Not(HasSubstr("\n")))) << part;
    }
}

INSTANTIATE_TEST_SUITE_P(Formats, CutShort,
                         ::testing::Values(pictureKind{"rgb", ".jpg", 3, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_sRGB},
                                           pictureKind{"rgb", ".png", 3, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_sRGB},
                                           pictureKind{"rgb", ".tif", 3, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_sRGB},
                                           pictureKind{"rgb", ".webp", 3, VIPS_FORMAT_UCHAR,
                                                       VIPS_INTERPRETATION_sRGB}));

TEST_F(Photo, FlippedBytesEndInAPictureOrAMessage)
{
    std::mt19937 random(11);
    for (const char *extension : {".jpg", ".png", ".tif", ".webp"})
    {
        const std::string whole =
            bytesOf(make({"p", extension, 3, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_sRGB}, 24, 18));
        for (int n = 0; n < 60; ++n)
        {
            std::string damaged = whole;
            for (int flips = 0; flips < 4; ++flips)
                damaged[random() % damaged.size()] = static_cast<char>(random());
            writeBytes(file("damaged"), damaged);
            EXPECT_THAT(refusal(file("damaged")), Not(HasSubstr("\n")));
        }
    }
}

TEST_F(Photo, OtherPagesAreMentioned)
{
    const vipsImage pages = noiseImage({"pages", ".tif", 3, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_sRGB}, 8, 24);
    vips_image_set_int(pages.get(), VIPS_META_PAGE_HEIGHT, 8);
    const photo first = photo::open(save(pages.get(), "pages.tif"));
    EXPECT_EQ(first.height(), 8);
    EXPECT_THAT(first.notes(), ElementsAre(HasSubstr("3 pictures")));
}

TEST_F(Photo, HeifIsReadWhereTheLibraryHasIt)
{
    const vipsImage image = noiseImage({"", "", 3, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_sRGB}, 64, 48);
    if (vips_heifsave(image.get(), file("p.heic").c_str(), nullptr) != 0)
        GTEST_SKIP() << "cannot make one here: " << takeVipsError();
    const std::string whole = bytesOf(file("p.heic"));
    EXPECT_EQ(photo::open(file("p.heic")).width(), 64);
    writeBytes(file("cut.heic"), whole.substr(0, whole.size() * 2 / 3));
    EXPECT_THAT(refusal(file("cut.heic")), StartsWith(file("cut.heic") + ": "));
}

TEST_F(Photo, OpeningStopsWhenItsCallerSaysSo)
{
    const std::string path = make({"p", ".png", 3, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_sRGB}, 300, 900);
    int calls = 0;
    EXPECT_THROW(photo::open(path, [&](double) { return ++calls < 2; }), Platform::cancelled);
    EXPECT_EQ(calls, 2);
}

} // namespace
} // namespace Stillmark
