#include "framework/icons/iconIndex.h"

#include "framework/base/exceptions.h"
#include "framework/icons/iconPacker.h"
#include "framework/icons/resourceDataProvider.h"

#include <cstring>
#include <gtest/gtest.h>
#include <random>

using namespace Sarnik;

namespace
{

using bytes = std::vector<std::byte>;

/// As much of a PNG as the index's reader looks at, and some more that tells pictures apart.
bytes pngOf(std::uint32_t width, std::uint32_t height, std::size_t more = 0)
{
    using namespace std::string_view_literals;
    bytes png;
    for (const char c : "\x89PNG\r\n\x1a\n\0\0\0\rIHDR"sv)
        png.push_back(static_cast<std::byte>(c));
    for (const std::uint32_t side : {width, height})
        for (int shift = 24; shift >= 0; shift -= 8)
            png.push_back(static_cast<std::byte>(side >> shift));
    png.resize(png.size() + more);
    return png;
}

CIconPacker::picture pictureOf(const std::string &name, std::uint32_t width, std::uint32_t height,
                               std::uint32_t state = 0)
{
    return {name, state, width, height, 1, 2, {pngOf(width, height, 1), pngOf(2 * width, 2 * height, 5)}};
}

CIconPacker packed()
{
    CIconPacker packer;
    packer.Add(pictureOf("Alpha_26005", 24, 20));
    packer.Add(pictureOf("NewKernel", 16, 16));
    packer.Add(pictureOf("NewKernel", 16, 16, 6));
    return packer;
}

std::uint32_t u32(const bytes &from, std::size_t at)
{
    std::uint32_t number = 0;
    for (std::size_t i = 4; i-- > 0;)
        number = number << 8 | std::to_integer<std::uint32_t>(from[at + i]);
    return number;
}

std::string text(const bytes &from, std::size_t at)
{
    return reinterpret_cast<const char *>(from.data() + at);
}

/// A provider of an index and of one store for both resolutions. Both have to be kept.
CResourceDataProvider providerOf(const bytes &index, const bytes &low, const bytes &high)
{
    return CResourceDataProvider([&](std::string_view key) -> std::span<const std::byte> {
        return key == CResourceDataProvider::Icons                    ? index
               : key == CResourceDataProvider::LowResolutionDataFile  ? low
               : key == CResourceDataProvider::HighResolutionDataFile ? high
                                                                      : std::span<const std::byte>{};
    });
}

TEST(IconIndex, HasItsBytesWhereTheyBelong)
{
    const CIconPacker packer = packed();
    const bytes index = packer.Index();
    ASSERT_EQ(index.size(), 546u + 2 * 368);
    EXPECT_EQ(text(index, 0), "Tintorel Icon Resource Index 1.0\n");
    for (const auto &[at, name] : {std::pair<std::size_t, const char *>{34, "IconsLowRes.dat"},
                                   {162, "IconsHighRes.dat"},
                                   {290, "IconsXLowRes.dat"},
                                   {418, "IconsXHighRes.dat"}})
    {
        EXPECT_EQ(text(index, at), name);
        EXPECT_EQ(index[at + 126], std::byte{0});
        EXPECT_EQ(index[at + 127], std::byte{'\n'});
    }

    const std::size_t second = 546 + 368;
    EXPECT_EQ(text(index, 546), "Alpha_26005");
    EXPECT_EQ(text(index, second), "NewKernel");
    const std::uint32_t sizes[] = {24, 48, 0, 0, 20, 40, 0, 0, 1, 2, 0, 0, 2, 4, 0, 0};
    for (std::size_t i = 0; i < std::size(sizes); ++i)
        EXPECT_EQ(u32(index, 546 + 48 + 4 * i), sizes[i]) << i;

    // The second icon's pictures: states 0 and 6, low and high.
    const bytes &low = packer.Store(kIconResolution_Low), &high = packer.Store(kIconResolution_High);
    EXPECT_EQ(text(low, 0).substr(0, 4), "fdra");
    EXPECT_EQ(u32(index, second + 112), 4 + 25u);
    EXPECT_EQ(u32(index, second + 112 + 4 * 6), 4 + 25 * 2u);
    EXPECT_EQ(u32(index, second + 112 + 32 + 4 * 6), 4 + 29 * 2u);
    EXPECT_EQ(u32(index, second + 240 + 4 * 6), 25u);
    EXPECT_EQ(u32(index, second + 240 + 32 + 4 * 6), 29u);
    EXPECT_EQ(u32(index, second + 240 + 4 * 1), 0u);
    EXPECT_EQ(std::memcmp(high.data() + 4 + 29 * 2, pngOf(32, 32).data(), 24), 0);
}

TEST(IconIndex, WritesWhatItRead)
{
    std::mt19937 random(7);
    for (std::size_t count = 0; count < 20; ++count)
    {
        bytes index = writeIconIndex({});
        for (std::size_t i = 0; i < count; ++i) // in the order of their names
        {
            index.resize(index.size() + 48);
            std::memset(&index[index.size() - 48], static_cast<int>('a' + i), 1 + random() % 47);
            for (int n = 0; n < 320; ++n)
                index.push_back(static_cast<std::byte>(random()));
        }
        const auto read = readIconIndex(index);
        ASSERT_TRUE(read && read->size() == count);
        EXPECT_EQ(writeIconIndex(*read), index);
    }
}

TEST(IconIndex, IsRefusedUnlessWhole)
{
    const bytes index = packed().Index();
    for (std::size_t length = 0; length < index.size(); ++length)
    {
        const bool whole = length >= 546 && (length - 546) % 368 == 0;
        EXPECT_EQ(readIconIndex(std::span(index).first(length)).has_value(), whole) << length;
    }

    CResourceDataProvider provider;
    for (std::size_t at = 0; at < 546 + 48; ++at)
    {
        bytes spoilt = index;
        spoilt[at] ^= std::byte{0x10};
        // A name may be another one, or a letter longer; the byte after the title means nothing.
        const bool harmless = at == 33 || (at >= 546 && at <= 546 + 11);
        EXPECT_EQ(provider.ParseIndex(spoilt.data(), spoilt.size()), harmless) << at;
        EXPECT_EQ(provider.Count(), harmless ? 2u : 0u);
    }

    bytes twice = index, unended = index, nameless = index;
    std::memcpy(twice.data() + 546 + 368, twice.data() + 546, 48);
    std::memset(unended.data() + 546, 'n', 48);
    std::memset(nameless.data() + 546, 0, 48);
    for (const bytes *bad : {&twice, &unended, &nameless})
    {
        ASSERT_TRUE(provider.ParseIndex(index.data(), index.size()));
        EXPECT_FALSE(provider.ParseIndex(bad->data(), bad->size()));
        EXPECT_EQ(provider.Count(), 0u) << "what was there before is gone";
    }
}

TEST(ResourceDataProvider, GivesOnlyWhatLiesInItsStores)
{
    const CIconPacker packer = packed();
    const bytes &low = packer.Store(kIconResolution_Low), &high = packer.Store(kIconResolution_High);
    const bytes index = packer.Index();
    const CResourceDataProvider good = providerOf(index, low, high);
    const CIconData hand = good.Find("Alpha_26005", kIconResolution_High, 0);
    EXPECT_EQ(hand.png.data(), high.data() + 4);
    EXPECT_EQ(std::tie(hand.width, hand.height, hand.hotX, hand.hotY), std::make_tuple(48, 40, 2, 4));
    EXPECT_TRUE(good.Find("NewKernel", kIconResolution_Low, 6));
    for (const std::uint32_t state : {1u, 7u, 8u, 0xffffffffu})
        EXPECT_FALSE(good.Find("NewKernel", kIconResolution_Low, state));
    EXPECT_FALSE(good.Find("NewKernel", kIconResolution_XLow, 0));
    EXPECT_FALSE(good.Find("Alpha_2600", kIconResolution_Low, 0));

    // One number of the first record is wrong: its byte offset in the record, and the value.
    for (const auto &[at, value] : {std::pair<std::size_t, std::uint32_t>{48, 25},
                                    {48, 0},
                                    {48, 0x80000018},
                                    {64, 0},
                                    {80, 24},
                                    {96, 0xffffffff},
                                    {112, 0},
                                    {112, 5},
                                    {112, 0xfffffffe},
                                    {240, 0},
                                    {240, 23},
                                    {240, 1000},
                                    {240, 0xffffffff}})
    {
        bytes spoilt = index;
        for (std::size_t i = 0; i < 4; ++i)
            spoilt[546 + at + i] = static_cast<std::byte>(value >> (8 * i));
        const CResourceDataProvider provider = providerOf(spoilt, low, high);
        EXPECT_EQ(provider.Count(), 2u);
        EXPECT_FALSE(provider.Find("Alpha_26005", kIconResolution_Low, 0)) << at << ' ' << value;
        EXPECT_TRUE(provider.Find("Alpha_26005", kIconResolution_High, 0));
    }

    for (std::size_t length = 0; length < low.size(); ++length)
    {
        const bytes shorter(low.begin(), low.begin() + static_cast<std::ptrdiff_t>(length));
        EXPECT_EQ(bool(providerOf(index, shorter, high).Find("Alpha_26005", kIconResolution_Low, 0)), length >= 29);
    }
    bytes other = low;
    other[0] = std::byte{'F'};
    EXPECT_FALSE(providerOf(index, other, high).Find("Alpha_26005", kIconResolution_Low, 0));

    bytes huge = pngOf(1025, 1);
    CIconPacker larger;
    larger.Add({"Huge", 0, 1025, 1, 0, 0, {huge, pngOf(2050, 2)}});
    const bytes largerIndex = larger.Index();
    EXPECT_FALSE(providerOf(largerIndex, larger.Store(kIconResolution_Low), high).Find("Huge", kIconResolution_Low, 0));
}

TEST(ResourceDataProvider, NamesNumberedIcons)
{
    CResourceDataProvider provider;
    std::string name;
    provider.GetIconName(26005, name);
    EXPECT_EQ(name, "Alpha_26005");
    provider.SetNumberedIcons(false);
    provider.GetIconName(26005, name);
    EXPECT_EQ(name, "26005");
}

TEST(IconPacker, TakesNothingThatDoesNotFitTogether)
{
    CIconPacker packer = packed();
    const auto refuses = [&](const CIconPacker::picture &p) { EXPECT_THROW(packer.Add(p), CError) << p.name; };
    refuses(pictureOf("", 16, 16));
    refuses(pictureOf(std::string(48, 'n'), 16, 16));
    refuses(pictureOf("Eight", 16, 16, 8));
    refuses(pictureOf("NewKernel", 16, 16));
    refuses(pictureOf("NewKernel", 18, 16, 1));
    refuses(pictureOf("Narrow", 1, 16));
    CIconPacker::picture wrong = pictureOf("Wrong", 16, 16);
    wrong.png[1] = wrong.png[0];
    refuses(wrong);
    EXPECT_EQ(packer.Index(), packed().Index());
}

} // namespace
