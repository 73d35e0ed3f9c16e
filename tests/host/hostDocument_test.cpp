#include "host/document/hostDocument.h"

#include "host/document/comparingSink.h"
#include "host/document/syntheticSource.h"

#include <bit>
#include <cmath>
#include <cstring>
#include <gmock/gmock.h>
#include <limits>
#include <random>

namespace Stillmark
{
namespace
{

using ::testing::Each;

/// Keeps the planes of a result.
class keptResult : public pictureResult
{
public:
    explicit keptResult(const pictureSource &like)
        : width(like.width()), bytes(like.sampleBytes()),
          planes(like.planes(), std::vector<std::byte>(static_cast<std::size_t>(width) * like.height() * bytes))
    {
    }
    void write(int plane, const rectangle &area, const planeSamples &codes) override
    {
        for (int y = 0; y < area.height; ++y)
            std::memcpy(at(plane, area.x, area.y + y), codes.row(y), static_cast<std::size_t>(area.width) * bytes);
    }
    std::byte *at(int plane, int x, int y) { return &planes[plane][(static_cast<std::size_t>(y) * width + x) * bytes]; }

private:
    int width, bytes;
    std::vector<std::vector<std::byte>> planes;
};

/// A sample of any depth as a number; the bits of a float.
std::uint32_t numberAt(const std::byte *from, int depth)
{
    std::uint32_t number = 0;
    std::memcpy(&number, from, static_cast<std::size_t>(depth) / 8);
    return number;
}

/// What the interface's header says of a code, in the plainest arithmetic.
std::uint32_t shown(std::uint32_t code, int depth, bool inverted)
{
    if (depth == 8)
        return inverted ? 255 - code : code;
    if (depth == 16)
        return static_cast<std::uint32_t>(std::lround((inverted ? 65535 - code : code) * 32768.0 / 65535));
    return code;
}

std::uint32_t codeAt(pictureSource &source, int plane, int x, int y)
{
    return numberAt(source.plane(plane, {x, y, 1, 1}).data, source.depth());
}

/// Memory for a rectangle with gaps between samples and rows, and a guard that tells what was touched.
struct stridedMemory
{
    stridedMemory(const TNRect32 &area, int depth, int columnFactor, int rowGap)
        : width(area.right - area.left),
          height(area.bottom - area.top), layout{nullptr, depth, depth * columnFactor,
                                                 (width * columnFactor + rowGap) * std::int64_t{depth}},
          bytes(static_cast<std::size_t>(layout.rowBits / 8 * height), std::byte{0x5a})
    {
        layout.data = bytes.data();
    }
    std::byte *at(int x, int y) { return bytes.data() + y * (layout.rowBits / 8) + x * (layout.columnBits / 8); }

    int width, height;
    TNPixelMemory layout;
    std::vector<std::byte> bytes;
};

struct documentKind
{
    const char *name;
    colourMode mode;
    int depth, extraPlanes;
    TNImageMode imageMode;
};

void PrintTo(const documentKind &kind, std::ostream *out)
{
    *out << kind.name;
}

std::vector<const TNChannel *> channelsOf(const TNChannel *first)
{
    std::vector<const TNChannel *> channels;
    for (; first; first = first->next)
        channels.push_back(first);
    return channels;
}

TNRect32 someRect(const TNRect32 &within, std::mt19937 &random)
{
    const auto span = [&](int from, int to) {
        int a = from + static_cast<int>(random() % (to - from)), b = from + static_cast<int>(random() % (to - from));
        return std::pair(std::min(a, b), std::max(a, b) + 1);
    };
    const auto [left, right] = span(within.left, within.right);
    const auto [top, bottom] = span(within.top, within.bottom);
    return {left, top, right, bottom};
}

constexpr int width = 61, height = 43;

class EveryMode : public ::testing::TestWithParam<documentKind>
{
protected:
    EveryMode()
    {
        settings.origin = {-1000, 30000};
        settings.layerAt = {5, -3};
        settings.canvas = TNPoint32{60, 200}; // narrower and higher than the layer
        settings.layerMask = &layerMask;
        settings.layerMaskAt = {-40, 7};
    }

    const documentKind kind = GetParam();
    syntheticSource source{{width, height, kind.depth, kind.mode, kind.extraPlanes, 7}};
    syntheticSource layerMask{{90, 30, kind.depth, colourMode::grey, 0, 8}};
    documentSettings settings;
    std::mt19937 random{11};
};

/// Reads random rectangles of a channel and compares them with the plane of a source whose first pixel lies at first.
void expectReads(hostDocument &document, const TNChannel &channel, pictureSource &source, int plane, TNPoint32 first,
                 bool inverted, std::mt19937 &random)
{
    for (int round = 0; round < 6; ++round)
    {
        const TNRect32 area = round == 0 ? channel.bounds : someRect(channel.bounds, random);
        stridedMemory memory(area, channel.depth, 1 + round % 3, round % 2);
        ASSERT_EQ(document.readPixels(channel.readPort, area, memory.layout), TNNoError);
        int wrong = 0;
        for (int y = 0; y < memory.height; ++y)
            for (int x = 0; x < memory.width; ++x)
            {
                const std::uint32_t code = codeAt(source, plane, area.left - first.x + x, area.top - first.y + y);
                wrong += numberAt(memory.at(x, y), channel.depth) != shown(code, channel.depth, inverted);
                std::memset(memory.at(x, y), 0x5a, static_cast<std::size_t>(channel.depth) / 8);
            }
        EXPECT_EQ(wrong, 0) << "plane " << plane << ", round " << round;
        EXPECT_THAT(memory.bytes, Each(std::byte{0x5a})); // nothing in the gaps
    }
}

TEST_P(EveryMode, ReadsGiveThePictureWhereverItLies)
{
    hostDocument document(source, nullptr, settings);
    EXPECT_EQ(document.imageMode(), kind.imageMode);
    const TNRect32 filter = document.filterRect();
    EXPECT_THAT((std::vector{filter.left, filter.top, filter.right, filter.bottom}),
                ::testing::ElementsAre(5, -3, 5 + width, -3 + height));
    const TNDocument &lists = *document.document();
    EXPECT_EQ(lists.version, 4);
    EXPECT_EQ(lists.depth, kind.depth);

    const TNPoint32 first{-995, 29997};
    const int colours = source.colourPlanes();
    const auto expectList = [&](const TNChannel *list, int plane, int count, const TNRect32 &bounds) {
        const auto channels = channelsOf(list);
        ASSERT_EQ(channels.size(), static_cast<std::size_t>(count));
        for (const TNChannel *channel : channels)
        {
            EXPECT_EQ(std::memcmp(&channel->bounds, &bounds, sizeof bounds), 0);
            EXPECT_EQ(channel->depth, kind.depth);
            EXPECT_EQ(channel->writePort, nullptr); // there is no result
            const bool inverted = kind.mode == colourMode::cmyk && plane < colours;
            expectReads(document, *channel, source, plane++, first, inverted, random);
        }
    };
    const TNRect32 layer{-995, 29997, -995 + width, 29997 + height}, onCanvas{-995, 30000, -940, 29997 + height};
    const int transparent = std::min(kind.extraPlanes, 1);
    expectList(lists.targetComposite, 0, colours, layer);
    expectList(lists.targetTransparency, colours, transparent, layer);
    expectList(lists.alpha, colours + 1, kind.extraPlanes - transparent, layer);
    expectList(lists.mergedComposite, 0, colours, onCanvas);
    expectList(lists.mergedTransparency, colours, transparent, onCanvas);
    expectList(lists.layers->composite, 0, colours, layer);
    expectList(lists.layers->transparency, colours, transparent, layer);
    expectReads(document, *lists.targetMask, layerMask, 0, {-1040, 30007}, false, random);
}

TEST_P(EveryMode, WrittenSamplesComeBackAndUnchangedOnesAreTheVeryCodes)
{
    keptResult result(source);
    hostDocument document(source, &result, settings);
    auto channels = channelsOf(document.document()->targetComposite);
    if (kind.extraPlanes > 0)
        channels.push_back(document.document()->targetTransparency);
    for (std::size_t plane = 0; plane < channels.size(); ++plane)
    {
        const TNChannel &channel = *channels[plane];
        const bool inverted = kind.mode == colourMode::cmyk && plane < 4;
        stridedMemory memory(channel.bounds, kind.depth, 1 + static_cast<int>(plane % 2), 3);
        ASSERT_EQ(document.readPixels(channel.readPort, channel.bounds, memory.layout), TNNoError);
        for (int y = 0; y < height; ++y) // every second sample is another one
            for (int x = y % 2; x < width; x += 2)
            {
                const std::uint32_t sample = kind.depth == 16 ? random() % 32769 : static_cast<std::uint32_t>(random());
                std::memcpy(memory.at(x, y), &sample, static_cast<std::size_t>(kind.depth) / 8);
            }
        ASSERT_EQ(document.writePixels(channel.writePort, channel.bounds, memory.layout), TNNoError);
        int wrong = 0;
        for (int y = 0; y < height; ++y)
            for (int x = 0; x < width; ++x)
            {
                const std::uint32_t got = numberAt(result.at(static_cast<int>(plane), x, y), kind.depth);
                wrong += shown(got, kind.depth, inverted) != numberAt(memory.at(x, y), kind.depth);
                wrong += (x + y) % 2 != 0 && got != codeAt(source, static_cast<int>(plane), x, y);
            }
        EXPECT_EQ(wrong, 0) << "plane " << plane;
    }
}

TEST_P(EveryMode, TheHostBlendsByTheSelectionWhileTheBlockSaysSo)
{
    std::vector<std::uint8_t> values(static_cast<std::size_t>(width) * height);
    for (int y = 10; y < 30; ++y)
        for (int x = 20; x < 50; ++x)
            values[static_cast<std::size_t>(y) * width + x] = static_cast<std::uint8_t>(x < 30 ? 255 : 8 * (50 - x));
    const selectionMask selection(width, height, values);
    settings.selection = &selection;
    keptResult result(source);
    hostDocument document(source, &result, settings);
    const TNRect32 filter = document.filterRect();
    EXPECT_EQ((std::vector{filter.left, filter.top, filter.right, filter.bottom}), (std::vector{25, 7, 55, 27}));

    const TNChannel &selected = *document.document()->selection;
    stridedMemory mask(selected.bounds, 8, 1, 0);
    ASSERT_EQ(document.readPixels(selected.readPort, selected.bounds, mask.layout), TNNoError);
    EXPECT_EQ(std::memcmp(mask.bytes.data(), values.data(), values.size()), 0);

    // All becomes white.
    const TNChannel &channel = *document.document()->targetComposite;
    const bool inverted = kind.mode == colourMode::cmyk;
    const std::uint32_t white = kind.depth == 8 ? 255 : kind.depth == 16 ? 32768 : 0x3f800000;
    stridedMemory memory(channel.bounds, kind.depth, 1, 0);
    for (std::size_t at = 0; at < memory.bytes.size(); at += kind.depth / 8)
        std::memcpy(&memory.bytes[at], &white, kind.depth / 8);
    const auto valueOf = [&](std::uint32_t code) {
        return kind.depth == 32 ? std::bit_cast<float>(code) : double{1} * shown(code, kind.depth, inverted);
    };
    for (const std::uint8_t automatic : {1, 0})
    {
        document.watchAutoMask(&automatic);
        ASSERT_EQ(document.writePixels(channel.writePort, channel.bounds, memory.layout), TNNoError);
        int wrong = 0;
        for (int y = 0; y < height; ++y)
            for (int x = 0; x < width; ++x)
            {
                const double weight = automatic ? values[static_cast<std::size_t>(y) * width + x] / 255.0 : 1;
                const std::uint32_t was = codeAt(source, 0, x, y), is = numberAt(result.at(0, x, y), kind.depth);
                const double to = kind.depth == 32 ? 1 : white, blended = valueOf(was) + (to - valueOf(was)) * weight;
                wrong += std::abs(valueOf(is) - blended) > (kind.depth == 32 ? 1e-6 : 0.51);
                wrong += weight == 0 && is != was;
            }
        EXPECT_EQ(wrong, 0) << "automatic mask " << int{automatic};
    }
}

INSTANTIATE_TEST_SUITE_P(Kinds, EveryMode,
                         ::testing::Values(documentKind{"grey8", colourMode::grey, 8, 1, TNModeGrey},
                                           documentKind{"grey16", colourMode::grey, 16, 0, TNModeGrey16},
                                           documentKind{"grey32", colourMode::grey, 32, 1, TNModeGrey32},
                                           documentKind{"rgb8", colourMode::rgb, 8, 3, TNModeRGB},
                                           documentKind{"rgb16", colourMode::rgb, 16, 1, TNModeRGB16},
                                           documentKind{"rgb32", colourMode::rgb, 32, 0, TNModeRGB32},
                                           documentKind{"cmyk8", colourMode::cmyk, 8, 1, TNModeCMYK},
                                           documentKind{"cmyk16", colourMode::cmyk, 16, 2, TNModeCMYK16},
                                           documentKind{"lab8", colourMode::lab, 8, 0, TNModeLab},
                                           documentKind{"lab16", colourMode::lab, 16, 1, TNModeLab16}),
                         [](const auto &test) { return std::string(test.param.name); });

/// A 16-bit grey picture of given codes in one row.
class rowOfCodes : public pictureSource
{
public:
    std::vector<std::uint16_t> codes = std::vector<std::uint16_t>(65536);
    int width() const override { return 65536; }
    int height() const override { return 1; }
    int depth() const override { return 16; }
    colourMode mode() const override { return colourMode::grey; }
    int extraPlanes() const override { return 0; }
    planeSamples plane(int, const rectangle &area) override
    {
        return {reinterpret_cast<const std::byte *>(codes.data() + area.x), codes.size() * 2};
    }
};

TEST(HostDocument, All16BitCodesSurviveUnchangedAndAreOffByAtMostOneElsewhere)
{
    rowOfCodes source;
    for (int i = 0; i < 65536; ++i)
        source.codes[i] = static_cast<std::uint16_t>(i);
    keptResult result(source);
    hostDocument document(source, &result);
    const TNChannel &channel = *document.document()->targetComposite;
    std::vector<std::uint16_t> samples(65536);
    const TNPixelMemory memory{samples.data(), 16, 16, 65536 * 16};
    ASSERT_EQ(document.readPixels(channel.readPort, channel.bounds, memory), TNNoError);
    EXPECT_EQ(samples[0], 0);
    EXPECT_EQ(samples[32768], 16384); // the zero of Lab's a and b
    EXPECT_EQ(samples[65535], 32768);

    const auto code = [&](int x) { return static_cast<int>(numberAt(result.at(0, x, 0), 16)); };
    ASSERT_EQ(document.writePixels(channel.writePort, channel.bounds, memory), TNNoError);
    int changed = 0, far = 0;
    for (int i = 0; i < 65536; ++i)
        changed += code(i) != i;
    for (std::uint16_t &other : source.codes) // what was there says nothing about the samples now
        other ^= 0x8000;
    ASSERT_EQ(document.writePixels(channel.writePort, channel.bounds, memory), TNNoError);
    for (int i = 0; i < 65536; ++i)
        far += std::abs(code(i) - i) > 1;
    EXPECT_EQ(changed, 0);
    EXPECT_EQ(far, 0);

    samples.assign(65536, 40000); // beyond the range: white
    ASSERT_EQ(document.writePixels(channel.writePort, channel.bounds, memory), TNNoError);
    EXPECT_EQ(code(1), 65535);
}

TEST(HostDocument, RefusesWhatTheInterfaceDoesNotAllow)
{
    syntheticSource source({20, 10, 16, colourMode::rgb, 2, 1});
    keptResult result(source);
    documentSettings settings;
    settings.origin = {100, 100};
    settings.switchedOff = {1};
    hostDocument document(source, &result, settings);
    const TNDocument &lists = *document.document();
    const TNChannel &red = *lists.targetComposite;
    EXPECT_FALSE(red.next->present);
    EXPECT_EQ(red.next->readPort, nullptr);
    EXPECT_EQ(lists.alpha->writePort, nullptr);
    EXPECT_TRUE(lists.layers->composite->next->present); // switched off in the target only

    std::vector<std::uint16_t> samples(400, 7);
    const TNRect32 all = red.bounds;
    const TNPixelMemory good{samples.data(), 16, 16, 320};
    ASSERT_EQ(document.readPixels(red.readPort, all, good), TNNoError);
    samples.assign(400, 7);
    const auto expectRefused = [&](TNPort toRead, TNPort toWrite, const TNRect32 &area, const TNPixelMemory &memory) {
        EXPECT_EQ(document.readPixels(toRead, area, memory), TNErrParameter);
        EXPECT_EQ(document.writePixels(toWrite, area, memory), TNErrParameter);
    };
    int stranger = 0;
    expectRefused(nullptr, nullptr, all, good);
    expectRefused(reinterpret_cast<TNPort>(&stranger), reinterpret_cast<TNPort>(&stranger), all, good);
    expectRefused(red.writePort, red.readPort, all, good);
    constexpr std::int32_t lowest = std::numeric_limits<std::int32_t>::min();
    constexpr std::int32_t highest = std::numeric_limits<std::int32_t>::max();
    for (const TNRect32 &area :
         {TNRect32{99, 100, 120, 110}, TNRect32{100, 100, 121, 110}, TNRect32{100, 99, 120, 110},
          TNRect32{100, 100, 120, 111}, TNRect32{110, 105, 110, 106}, TNRect32{110, 105, 105, 106},
          TNRect32{0, 0, 20, 10}, TNRect32{lowest, lowest, highest, highest},
          TNRect32{highest, highest, lowest, lowest}})
        expectRefused(red.readPort, red.writePort, area, good);
    for (const TNPixelMemory &memory :
         {TNPixelMemory{nullptr, 16, 16, 320}, TNPixelMemory{samples.data(), 8, 8, 160},
          TNPixelMemory{samples.data(), 0, 16, 320}, TNPixelMemory{samples.data(), 16, 0, 320},
          TNPixelMemory{samples.data(), 16, 16, 0}, TNPixelMemory{samples.data(), 16, 24, 480},
          TNPixelMemory{samples.data(), 16, 16, 328}, TNPixelMemory{samples.data(), 16, -16, 320},
          TNPixelMemory{samples.data(), 16, 16, -320}})
        expectRefused(red.readPort, red.writePort, all, memory);
    EXPECT_THAT(samples, Each(7));
    EXPECT_EQ(document.cmykToRgb8(nullptr, 1), TNErrParameter);
    EXPECT_EQ(document.cmykToRgb16(nullptr, 1), TNErrParameter);

    syntheticSource float4({2, 2, 32, colourMode::cmyk, 0, 1});
    EXPECT_THROW(hostDocument(float4, nullptr), std::invalid_argument);
    settings.layerAt = {highest - 110, 0};
    EXPECT_THROW(hostDocument(source, nullptr, settings), std::invalid_argument);
}

// A plug-in may hand over memory at odd addresses.
TEST(HostDocument, SamplesMayLieAtAnyAddress)
{
    syntheticSource source({33, 5, 32, colourMode::rgb, 0, 3});
    comparingSink sink(source);
    hostDocument document(source, &sink);
    std::vector<std::byte> bytes(33 * 5 * 4 + 1);
    const TNPixelMemory memory{bytes.data() + 1, 32, 32, 33 * 32};
    for (const TNChannel *channel : channelsOf(document.document()->targetComposite))
    {
        ASSERT_EQ(document.readPixels(channel->readPort, channel->bounds, memory), TNNoError);
        ASSERT_EQ(document.writePixels(channel->writePort, channel->bounds, memory), TNNoError);
    }
    EXPECT_EQ(sink.pixelsWritten(), 33u * 5);
    EXPECT_EQ(sink.samplesWritten(), 33u * 5 * 3);
    EXPECT_EQ(sink.samplesDiffering(), 0u);
    bytes[50] ^= std::byte{1};
    const TNChannel &red = *document.document()->targetComposite;
    ASSERT_EQ(document.writePixels(red.writePort, red.bounds, memory), TNNoError);
    EXPECT_GE(sink.samplesDiffering(), 1u);
}

TEST(SyntheticSource, IsTheSameEverywhereAndOnEveryMachine)
{
    syntheticSource huge({30000, 20000, 16, colourMode::rgb, 0, 5});
    std::vector<std::uint32_t> drawn;
    for (const auto &[x, y] : {std::pair(0, 0), std::pair(29999, 19999), std::pair(12345, 6789)})
        for (int plane = 0; plane < 3; ++plane)
            drawn.push_back(codeAt(huge, plane, x, y));
    // By the same formula, computed elsewhere.
    EXPECT_EQ(drawn, (std::vector<std::uint32_t>{51274, 20745, 51806, 38245, 38620, 30848, 37304, 34507, 46399}));

    std::set<std::uint32_t> values;
    for (int x = 0; x < 1000; ++x)
        values.insert(codeAt(huge, 0, x, 77));
    EXPECT_GT(values.size(), 900u);
}

} // namespace
} // namespace Stillmark
