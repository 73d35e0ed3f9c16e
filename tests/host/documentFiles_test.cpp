#include "host/document/colourConverter.h"
#include "host/document/hostDocument.h"
#include "host/document/photoSource.h"
#include "host/document/resultRaster.h"
#include "host/sampleRaster.h"
#include "tests/host/hostFixture.h"

#include <cstring>
#include <gmock/gmock.h>
#include <random>
#include <thread>

namespace Stillmark
{
namespace
{

using ::testing::HasSubstr;

/// A picture of given bytes, one to four bands of 8 or 16 bits.
vipsImage imageOf(const std::vector<std::uint16_t> &samples, int width, int height, int bands, VipsBandFormat format)
{
    std::vector<std::uint8_t> bytes(samples.begin(), samples.end());
    const bool wide = format == VIPS_FORMAT_USHORT;
    vipsImage image(vips_image_new_from_memory_copy(wide ? static_cast<const void *>(samples.data()) : bytes.data(),
                                                    samples.size() * (wide ? 2 : 1), width, height, bands, format));
    image->Type = bands < 3 ? (wide ? VIPS_INTERPRETATION_GREY16 : VIPS_INTERPRETATION_B_W)
                            : (wide ? VIPS_INTERPRETATION_RGB16 : VIPS_INTERPRETATION_sRGB);
    return image;
}

class DocumentFiles : public hostTest
{
};

// Tiles of the picture are read and changed through a document, in random order; the saved file must be what a plain
// copy of the planes with the same changes is.
TEST_F(DocumentFiles, AResultIsThePhotoButForWhatWasWritten)
{
    for (const pictureKind &kind : {pictureKind{"rgba8", ".png", 4, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_sRGB},
                                    pictureKind{"masks16", ".tif", 6, VIPS_FORMAT_USHORT, VIPS_INTERPRETATION_RGB16},
                                    pictureKind{"cmyk8", ".tif", 4, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_CMYK},
                                    pictureKind{"greyFloat", ".tif", 1, VIPS_FORMAT_FLOAT, VIPS_INTERPRETATION_B_W}})
    {
        SCOPED_TRACE(kind.name);
        constexpr int width = 143, height = 111, tile = 32;
        const photo before = photo::open(make(kind, width, height));
        const std::string target = file("result" + kind.extension);
        photoSource source(before);
        resultRaster result(before, target);
        hostDocument document(source, &result);
        auto model = planesOf(before);
        std::vector<const TNChannel *> channels;
        for (const TNChannel *c = document.document()->targetComposite; c; c = c->next)
            channels.push_back(c);
        if (before.hasTransparency())
            channels.push_back(document.document()->targetTransparency);

        const int depth = before.depth(), bytes = depth / 8;
        std::mt19937 random(5);
        for (int round = 0; round < 60; ++round)
        {
            const std::size_t plane = random() % channels.size();
            const TNChannel &channel = *channels[plane];
            const int x = static_cast<int>(random() % (width - tile)), y = static_cast<int>(random() % (height - tile));
            const TNRect32 area{x, y, x + tile, y + tile};
            std::vector<std::uint32_t> memory(tile * tile);
            const TNPixelMemory layout{memory.data(), depth, depth, tile * depth};
            ASSERT_EQ(document.readPixels(channel.readPort, area, layout), TNNoError);
            // The top left sample becomes the largest one; the rest is written as it was read.
            const std::uint32_t white = depth == 8 ? 255 : depth == 16 ? 32768 : 0x3f800000;
            std::memcpy(memory.data(), &white, bytes);
            ASSERT_EQ(document.writePixels(channel.writePort, area, layout), TNNoError);
            const std::uint32_t code = before.mode() == colourMode::cmyk ? 0 : depth == 16 ? 65535 : white;
            const auto original = planesOf(before, {x, y, tile, tile});
            for (int row = 0; row < tile; ++row)
                std::memcpy(&model[((plane * height + y + row) * width + x) * bytes],
                            &original[(plane * tile + row) * tile * bytes], static_cast<std::size_t>(tile) * bytes);
            std::memcpy(&model[((plane * height + y) * width + x) * bytes], &code, bytes);
        }
        result.commit();
        const photo after = photo::open(target);
        EXPECT_EQ(after.profile(), before.profile());
        EXPECT_TRUE(planesOf(after) == model);
    }
}

TEST_F(DocumentFiles, ARasterReplacesPlanesAlikeInMemoryAndOnDisk)
{
    constexpr int width = 700, height = 300, planes = 3;
    std::mt19937 random(3);
    std::vector<std::uint16_t> pixels(width * height * planes), samples(200 * 200);
    for (std::uint16_t &each : pixels)
        each = static_cast<std::uint16_t>(random());
    sampleRaster inMemory(width, height, planes, 2), onDisk(width, height, planes, 2, 0);
    const rectangle all{0, 0, width, height};
    for (sampleRaster *raster : {&inMemory, &onDisk})
        raster->write(all, pixels.data(), width * planes * 2);
    for (int round = 0; round < 20; ++round)
    {
        const int w = 1 + static_cast<int>(random() % 200), h = 1 + static_cast<int>(random() % 200);
        const rectangle area{static_cast<int>(random() % (width - w)), static_cast<int>(random() % (height - h)), w, h};
        const int plane = round % planes;
        for (std::uint16_t &each : samples)
            each = static_cast<std::uint16_t>(random());
        for (sampleRaster *raster : {&inMemory, &onDisk})
            raster->writePlane(area, plane, samples.data(), 200 * 2);
        for (int y = 0; y < h; ++y)
            for (int x = 0; x < w; ++x)
                pixels[((area.y + y) * width + area.x + x) * planes + plane] = samples[y * 200 + x];
    }
    for (const sampleRaster *raster : {&inMemory, &onDisk})
    {
        std::vector<std::uint16_t> got(pixels.size());
        raster->read(all, got.data(), width * planes * 2);
        EXPECT_TRUE(got == pixels);
    }
}

TEST_F(DocumentFiles, ASelectionIsThePicturesLight)
{
    const auto valuesOf = [](const selectionMask &mask) {
        std::vector<std::uint8_t> values(static_cast<std::size_t>(mask.width()) * mask.height());
        mask.read({0, 0, mask.width(), mask.height()}, values.data(), static_cast<std::size_t>(mask.width()));
        return values;
    };
    // 127 of 65535 is nearer to nothing than to 1 of 255.
    const auto grey = imageOf({0, 127, 0, 0, 0, 129, 65535, 0, 0, 0, 32768, 0}, 4, 3, 1, VIPS_FORMAT_USHORT);
    const auto fromGrey = selectionMask::open(save(grey.get(), "grey.png"), 4, 3);
    EXPECT_EQ(valuesOf(fromGrey), (std::vector<std::uint8_t>{0, 0, 0, 0, 0, 1, 255, 0, 0, 0, 128, 0}));
    const rectangle &bounds = fromGrey.bounds();
    EXPECT_EQ((std::vector{bounds.x, bounds.y, bounds.width, bounds.height}), (std::vector{1, 1, 2, 2}));

    const auto colour = imageOf({255, 0, 0, 0, 255, 0, 0, 0, 255, 255, 255, 255}, 4, 1, 3, VIPS_FORMAT_UCHAR);
    EXPECT_EQ(valuesOf(selectionMask::open(save(colour.get(), "colour.png"), 4, 1)),
              (std::vector<std::uint8_t>{76, 150, 29, 255}));
}

TEST_F(DocumentFiles, AUselessSelectionIsRefusedInPlainWords)
{
    const auto refused = [](const std::string &path, int width, int height) -> std::string {
        try
        {
            selectionMask::open(path, width, height);
        }
        catch (const Platform::fileError &error)
        {
            return error.what();
        }
        return {};
    };
    const std::string black = save(imageOf({0, 0, 0, 0}, 2, 2, 1, VIPS_FORMAT_UCHAR).get(), "black.png");
    const std::string floats = make({"floats", ".tif", 1, VIPS_FORMAT_FLOAT, VIPS_INTERPRETATION_B_W}, 2, 2);
    const std::string start = ": cannot be used as a selection: ";
    EXPECT_EQ(refused(black, 2, 2), black + start + "it is black all over, which selects nothing");
    EXPECT_EQ(refused(black, 3, 2), black + start + "it has 2 x 2 pixels, the photo 3 x 2 pixels");
    EXPECT_EQ(refused(floats, 2, 2), floats + start + "it is not a grey or RGB picture of 8 or 16 bits");
    EXPECT_THAT(refused(file("none.png"), 2, 2), HasSubstr("none.png: cannot be read: No such file"));
}

std::vector<std::uint8_t> cmykProfile()
{
    VipsBlob *blob = nullptr;
    if (vips_profile_load("cmyk", &blob, nullptr) != 0 || !blob)
        throw std::runtime_error(takeVipsError());
    std::size_t size = 0;
    const auto *bytes = static_cast<const std::uint8_t *>(vips_blob_get(blob, &size));
    std::vector<std::uint8_t> profile(bytes, bytes + size);
    vips_area_unref(VIPS_AREA(blob));
    return profile;
}

TEST_F(DocumentFiles, CmykBecomesRgbByTheProfileOrPlainly)
{
    using quads8 = std::vector<std::uint8_t>;
    const quads8 inks{255, 255, 255, 255, 0, 255, 255, 255, 255, 0, 0, 255, 128, 128, 128, 128};
    const auto convert = [](const colourConverter &by, auto quads) {
        by.cmykToRgb(quads.data(), quads.size() / 4);
        return quads;
    };
    const colourConverter plain;
    EXPECT_EQ(convert(plain, inks), (quads8{255, 255, 255, 255, 0, 255, 255, 255, 255, 0, 0, 255, 64, 64, 64, 128}));
    EXPECT_EQ(convert(plain, std::vector<std::uint16_t>{32768, 16384, 65535, 32768}),
              (std::vector<std::uint16_t>{32768, 16384, 32768, 32768}));

    auto profile = cmykProfile();
    const colourConverter real(profile);
    ASSERT_TRUE(real.usesProfile());
    const vipsImage carrier = noiseImage({"", "", 4, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_CMYK}, 3, 3);
    vips_image_set_blob_copy(carrier.get(), VIPS_META_ICC_NAME, profile.data(), profile.size());
    EXPECT_EQ(photo::open(save(carrier.get(), "carrier.tif")).profile(), profile);
    const quads8 rgb = convert(real, inks);
    for (int c = 0; c < 3; ++c)
        EXPECT_GE(rgb[c], 250) << "paper is white";
    EXPECT_LT(rgb[4], 60); // cyan ink takes red away, and is a duller thing than plain cyan
    EXPECT_GT(rgb[6], 150);
    EXPECT_LT(rgb[6], 250);
    EXPECT_EQ(rgb[3], 255);
    EXPECT_EQ(rgb[15], 128);

    // Both depths agree, and threads do not disturb one another.
    std::mt19937 random(9);
    quads8 many(4 * 5000);
    std::vector<std::uint16_t> deep(many.size());
    for (std::size_t i = 0; i < many.size(); ++i)
    {
        many[i] = static_cast<std::uint8_t>(random());
        deep[i] = static_cast<std::uint16_t>((many[i] * 32768 + 127) / 255);
    }
    const quads8 alone = convert(real, many);
    quads8 elsewhere;
    {
        const std::jthread other([&] { elsewhere = convert(real, many); });
        deep = convert(real, deep);
    }
    EXPECT_TRUE(elsewhere == alone);
    int apart = 0;
    for (std::size_t i = 0; i < many.size(); ++i)
        apart += i % 4 != 3 && std::abs(deep[i] * 255.0 / 32768 - alone[i]) > 2;
    EXPECT_EQ(apart, 0);

    // Not of CMYK, cut short, damaged at random: taken or left, never a crash.
    EXPECT_FALSE(colourConverter(std::vector<std::uint8_t>(profile.begin(), profile.begin() + 1000)).usesProfile());
    EXPECT_FALSE(colourConverter(quads8(5000, 0x41)).usesProfile());
    for (int round = 0; round < 20; ++round)
    {
        auto damaged = profile;
        for (int i = 0; i < 30; ++i)
            damaged[random() % (i < 15 ? 600 : damaged.size())] = static_cast<std::uint8_t>(random());
        convert(colourConverter(damaged), inks);
    }
}

} // namespace
} // namespace Stillmark
