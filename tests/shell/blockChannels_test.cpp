#include "shell/blockChannels.h"

#include "framework/base/exceptions.h"
#include "shell/layerReader.h"

#include <gtest/gtest.h>

#include <cstring>

namespace
{

using namespace Sarnik;

/// A host in C over memory: a 16-bit grey document of 24 x 10 pixels at (5, -3), its transparency, and an 8-bit
/// selection. It refuses what the interface forbids, and the Nth call when told so.
struct cPlane
{
    TNRect32 bounds;
    int depth;
    unsigned char samples[24 * 10 * 2];
};

struct cHost
{
    cPlane planes[4];
    TNChannel channels[4];
    TNDocument document;
    TNFilterBlock block;
    TNChannelPortsSuite suite;
    int calls, failAt;
    TNError failCode;
};

extern "C" TNError moveSamples(cHost *host, TNPort port, const TNRect32 *rect, const TNPixelMemory *memory, int reading)
{
    auto *plane = reinterpret_cast<cPlane *>(port);
    const int bytes = plane->depth / 8;
    if (host->calls++ == host->failAt)
        return host->failCode;
    if (memory->depth != plane->depth || memory->columnBits < memory->depth || rect->left < plane->bounds.left ||
        rect->top < plane->bounds.top || rect->right > plane->bounds.right || rect->bottom > plane->bounds.bottom ||
        rect->left >= rect->right || rect->top >= rect->bottom)
        return TNErrParameter;
    for (int y = rect->top; y < rect->bottom; ++y)
        for (int x = rect->left; x < rect->right; ++x)
        {
            unsigned char *mine = plane->samples + ((y - plane->bounds.top) * 24 + x - plane->bounds.left) * bytes;
            auto *theirs = static_cast<unsigned char *>(memory->data) + (y - rect->top) * memory->rowBits / 8 +
                           (x - rect->left) * memory->columnBits / 8;
            std::memcpy(reading ? theirs : mine, reading ? mine : theirs, static_cast<std::size_t>(bytes));
        }
    return TNNoError;
}

extern "C" TNError readSamples(void *context, TNPort port, const TNRect32 *rect, const TNPixelMemory *to)
{
    return moveSamples(static_cast<cHost *>(context), port, rect, to, 1);
}

extern "C" TNError writeSamples(void *context, TNPort port, const TNRect32 *rect, const TNPixelMemory *from)
{
    return moveSamples(static_cast<cHost *>(context), port, rect, from, 0);
}

class BlockChannels : public testing::Test
{
protected:
    BlockChannels()
    {
        host.failAt = -1;
        for (int i = 0; i < 4; ++i)
        {
            cPlane &p = host.planes[i];
            p.bounds = {5, -3, 29, 7};
            p.depth = i == 2 ? 8 : 16; // colour, transparency, selection, the layer's colour
            for (std::size_t s = 0; s < sizeof p.samples; ++s)
                p.samples[s] = static_cast<unsigned char>((s * 37 + static_cast<std::size_t>(i) * 11) % 128);
            auto *port = reinterpret_cast<TNPort>(&p);
            host.channels[i] = {nullptr, p.bounds, p.depth, 1, port, port};
        }
        layers[0] = {&layers[1], &host.channels[0], nullptr, nullptr};
        layers[1] = {nullptr, &host.channels[3], nullptr, &host.channels[1]};
        host.document.version = 2;
        host.document.depth = 16;
        host.document.origin = {5, -3}; // picture coordinates start at 0 then
        host.document.targetComposite = &host.channels[0];
        host.document.targetTransparency = &host.channels[1];
        host.document.selection = &host.channels[2];
        host.document.layers = layers;
        host.block.size = sizeof host.block;
        host.block.imageMode = TNModeGrey16;
        host.block.document = &host.document;
        host.suite = {&host, readSamples, writeSamples};
        host.block.pixelContext = &host;
        host.block.readPixels = readSamples;
        host.block.writePixels = writeSamples;
    }

    std::uint16_t Sample(int plane, std::int32_t x, std::int32_t y) const
    {
        std::uint16_t v;
        std::memcpy(&v, host.planes[plane].samples + (y * 24 + x) * 2, 2);
        return v;
    }

    cHost host{};
    TNLayer layers[2]{};
    const CRect inner{3, 2, 20, 9};
};

TEST_F(BlockChannels, BothEntryPointsReadAndWriteEverySample)
{
    for (const bool bySuite : {false, true})
    {
        CBlockChannels channels(host.block, bySuite ? &host.suite : nullptr);
        CMemoryPixmap pixmap(inner, 16, 3), again(inner, 16, 2);
        ReadLayer(channels, pixmap, layerTarget, layerNone, CFillMode::replicate);
        ReadMask(channels, pixmap, layerSelection, 2);
        for (std::int32_t y = inner.top; y < inner.bottom; ++y)
            for (std::int32_t x = inner.left; x < inner.right; ++x)
            {
                ASSERT_EQ(pixmap.Plane(0).Row<std::uint16_t>(y)[x - 3], Sample(0, x, y));
                ASSERT_EQ(pixmap.Plane(1).Row<std::uint16_t>(y)[x - 3], Sample(1, x, y));
                ASSERT_EQ(pixmap.Plane(2).Row<std::uint16_t>(y)[x - 3],
                          (host.planes[2].samples[y * 24 + x] * 32768u + 128) / 255);
                ++pixmap.Plane(0).Row<std::uint16_t>(y)[x - 3];
            }
        const std::uint16_t outside = Sample(0, 2, 5), transparency = Sample(1, 5, 5);
        WriteTarget(channels, pixmap, inner, true);
        ReadLayer(channels, again, layerTarget, layerNone, CFillMode::replicate);
        for (std::int32_t y = inner.top; y < inner.bottom; ++y)
            ASSERT_EQ(std::memcmp(again.Plane(0).Row<char>(y), pixmap.Plane(0).Row<char>(y), 17 * 2), 0);
        EXPECT_EQ(Sample(0, 2, 5), outside);
        EXPECT_EQ(Sample(1, 5, 5), transparency);

        CMemoryPixmap layer(inner, 16, 1), mask(inner, 16, 1);
        ReadLayer(channels, layer, 1, layerNone, CFillMode::constant);
        ReadMask(channels, mask, 1, 0);
        EXPECT_EQ(layer.Plane(0).Row<std::uint16_t>(4)[1], Sample(3, 4, 4));
        EXPECT_EQ(mask.Plane(0).Row<std::uint16_t>(4)[1], Sample(1, 4, 4)) << "the layer's mask";
    }
}

TEST_F(BlockChannels, KnowsWhatThereIsNot)
{
    CBlockChannels channels(host.block, &host.suite);
    EXPECT_EQ(channels.Channels(2), nullptr) << "two layers only";
    EXPECT_TRUE(channels.Channels(layerAlpha)->colour.empty());
    EXPECT_EQ(channels.Channels(layerNone), nullptr);
    host.document.version = 1;
    EXPECT_EQ(channels.Channels(0), nullptr) << "no layers before version 2";
    host.block.document = nullptr;
    EXPECT_FALSE(channels.HasDocument());
    EXPECT_EQ(channels.Channels(layerTarget), nullptr);
    EXPECT_FALSE(channels.HasSelection());

    TNBounds32 wide{0, {70000, 80000}, {10, 20, 60000, 70000}};
    host.block.filterRect = {1, 2, 3, 4};
    EXPECT_EQ(ImageBounds(host.block), (CRect{1, 2, 3, 4}));
    host.block.bounds32 = &wide;
    EXPECT_EQ(ImageBounds(host.block), (CRect{1, 2, 3, 4})) << "not used by the plug-in";
    wide.pluginUses = 1;
    EXPECT_EQ(ImageBounds(host.block), (CRect{10, 20, 60000, 70000}));
}

/// Each lie of a host ends in an exception or in pixels, never in memory that is not ours.
TEST_F(BlockChannels, ALyingHostDoesNoHarm)
{
    CBlockChannels channels(host.block, &host.suite);
    CMemoryPixmap pixmap(inner, 16, 2);
    const auto read = [&] { ReadLayer(channels, pixmap, layerTarget, layerNone, CFillMode::replicate); };

    host.channels[0].next = &host.channels[0];
    EXPECT_LE(channels.Channels(layerTarget)->colour.size(), 64u) << "a list in a circle";
    EXPECT_NO_THROW(read());
    host.channels[0].next = nullptr;

    host.channels[0].depth = 8;
    EXPECT_THROW(read(), CAbort);
    host.channels[0].depth = 16;
    host.channels[0].readPort = nullptr;
    EXPECT_THROW(read(), CAbort);
    host.channels[0].readPort = reinterpret_cast<TNPort>(&host.planes[0]);
    host.channels[0].bounds = {INT32_MIN, INT32_MIN, INT32_MAX, INT32_MAX};
    EXPECT_NO_THROW(read()) << "within the picture it tells the truth";
    host.channels[0].bounds = {20, 5, 4, 1};
    EXPECT_NO_THROW(read()) << "a rectangle that ends before it begins is empty";
    host.channels[0].bounds = host.planes[0].bounds;
    host.document.origin = {INT32_MAX, INT32_MIN};
    EXPECT_NO_THROW(read());
    host.document.origin = {5, -3};

    for (const TNError code : {TNError{-36}, TNError{1}})
        for (int n = 0; n < 2; ++n)
        {
            host.calls = 0;
            host.failAt = n;
            host.failCode = code;
            EXPECT_THROW(read(), CAbort) << "read " << n;
            host.calls = 0;
            if (code < 0)
                EXPECT_THROW(WriteTarget(channels, pixmap, inner, true), CTintorelError) << "write " << n;
            else
                EXPECT_THROW(WriteTarget(channels, pixmap, inner, true), CAbort) << "write " << n;
        }
    host.failAt = -1;
    host.suite.readPixels = nullptr;
    EXPECT_THROW(read(), CAbort);
}

TEST_F(BlockChannels, ColourConversionsThatFailAreTold)
{
    TNColorSpaceSuite suite{nullptr,
                            [](void *, std::uint8_t *quads, std::uint64_t pixels) -> TNError {
                                for (std::uint64_t i = 0; i < pixels; ++i)
                                    quads[4 * i] = 99;
                                return TNNoError;
                            },
                            [](void *, std::uint16_t *, std::uint64_t) -> TNError { return TNErrMemoryFull; }};
    CSuiteQuadConverter converter(suite);
    CMemoryPixmap eight(3, 3, 8, 5), sixteen(3, 3, 16, 5), grey(3, 3, 64, 1);
    ASSERT_TRUE(ToGrey(eight, eight.Bounds(), {CPixelKind::cmyk, false, &converter, {}}, grey));
    EXPECT_DOUBLE_EQ(grey.Plane(0).Row<double>(2)[2], 99 * double{0.299f} / 255);
    EXPECT_THROW(ToGrey(sixteen, sixteen.Bounds(), {CPixelKind::cmyk, false, &converter, {}}, grey), CTintorelError);
    suite.cmykToRgb8 = nullptr;
    EXPECT_THROW(ToGrey(eight, eight.Bounds(), {CPixelKind::cmyk, false, &converter, {}}, grey), CTintorelError);
}

} // namespace
