#include "framework/icons/programIcons.h"

#include "framework/base/service.h"
#include "framework/icons/iconCursor.h"
#include "framework/icons/iconNames.h"
#include "framework/icons/iconResources.h"
#include "framework/icons/pngDecoder.h"
#include "framework/layout/layoutResources.h"

#include <gtest/gtest.h>
#include <random>

using namespace Sarnik;

namespace
{

struct ProgramIcons : testing::Test
{
    ~ProgramIcons() override { CService::ShutdownAll(); }

    CProgramIcons &icons = *CProgramIcons::Get();
};

/// Every name that layouts and the program ask for.
std::vector<std::string> wantedNames(const CResourceDataProvider &provider)
{
    std::vector<std::string> names(std::begin(namedIcons), std::end(namedIcons));
    for (const std::uint32_t id : numberedIcons)
        provider.GetIconName(id, names.emplace_back());

    constexpr std::string_view before = " icon: '";
    for (const auto &layout : LayoutResources())
        for (std::size_t at = 0; (at = layout.text.find(before, at)) != std::string_view::npos;)
        {
            at += before.size();
            names.emplace_back(layout.text.substr(at, layout.text.find('\'', at) - at));
        }
    return names;
}

TEST_F(ProgramIcons, HaveEveryPictureThatIsAskedForAtBothResolutions)
{
    const auto names = wantedNames(icons.Provider());
    EXPECT_GT(names.size(), std::size(namedIcons) + std::size(numberedIcons) + 5) << "layouts name icons too";
    for (const std::string &name : names)
    {
        const CIcon low = CIconSource::Icon(name, 1), high = CIconSource::Icon(name, 2);
        ASSERT_TRUE(low && high) << name;
        EXPECT_EQ(std::make_pair(low.scale, high.scale), std::make_pair(1.0, 2.0));
        EXPECT_EQ(high.pixels->width(), 2 * low.pixels->width()) << name;
        EXPECT_EQ(high.pixels->height(), 2 * low.pixels->height()) << name;
        for (const auto &picture : {low.pixels, high.pixels})
        {
            bool seen = false;
            for (int y = 0; y < picture->height(); ++y)
                for (int x = 0; x < picture->width(); ++x)
                {
                    const std::uint32_t p = picture->row(y)[x], alpha = p >> 24;
                    seen |= alpha > 200;
                    ASSERT_TRUE((p >> 16 & 255) <= alpha && (p >> 8 & 255) <= alpha && (p & 255) <= alpha)
                        << name << ": colours that are not multiplied by alpha";
                }
            EXPECT_TRUE(seen) << name << " is empty";
        }
    }
    EXPECT_EQ(CIconSource::Icon("ZoomIn", 1).pixels->row(5)[5], 0xffdcdcdcu);
}

TEST_F(ProgramIcons, ComeFromTheResolutionAndStateThatSuit)
{
    for (const auto &[scale, chosen] : {std::pair(0.5, 1.0), {1.0, 1.0}, {1.25, 2.0}, {2.0, 2.0}, {3.0, 2.0}})
        EXPECT_EQ(CIconSource::Icon("NewKernel", scale).scale, chosen);
    const auto normal = CIconSource::Icon("NewKernel", 1).pixels;
    EXPECT_EQ(CIconSource::Icon("NewKernel", 1).pixels, normal) << "decoded once";
    EXPECT_EQ(CIconSource::Icon("NewKernel", 1, 3).pixels, normal) << "a state that is not there";
    EXPECT_EQ(CIconSource::Icon("NewKernel", 1, 9).pixels, normal);
    EXPECT_NE(*CIconSource::Icon("NewKernel", 1, 6).pixels, *normal);
    EXPECT_FALSE(CIconSource::Icon("NoSuchIcon", 1));
    CService::ShutdownAll();
    EXPECT_EQ(CIconSource::Current(), nullptr);
}

TEST_F(ProgramIcons, AreCursorsOfTheScreensSize)
{
    for (const double scale : {1.0, 1.25, 1.5, 2.0, 3.0})
    {
        const CIconCursor hand(kCursor_Hand, scale);
        ASSERT_NE(hand.image, nullptr);
        EXPECT_EQ(hand.image->width(), static_cast<int>(24 * scale));
        EXPECT_NEAR(hand.hotX, 12 * scale, scale);
        EXPECT_EQ(CIconCursor(kCursor_Hand, scale), hand) << "the same picture, not another one";
    }
    for (const std::uint32_t id : numberedIcons)
        if (id >= kCursor_Arrow)
        {
            const CIconCursor cursor(id);
            EXPECT_TRUE(cursor.hotX > 0 && cursor.hotY > 0 && cursor.image != nullptr) << id;
        }
    EXPECT_EQ(CIconCursor(kCursor_Arrow), Platform::cursor{});
    EXPECT_EQ(CIconCursor(27000, 2), Platform::cursor{});
}

TEST_F(ProgramIcons, DecodeOrAreAbsentWhateverTheBytes)
{
    const auto png = icons.Provider().Find("Alpha_15019", kIconResolution_High, 0).png;
    const Platform::raster whole = CPNGDecoder(56).Decode(png);
    EXPECT_EQ(whole, *icons.Icon(kIcon_Enhance, 2).pixels);
    EXPECT_TRUE(CPNGDecoder(55).Decode(png).empty());
    for (std::size_t length = 0; length < png.size(); ++length)
    {
        const Platform::raster cut = CPNGDecoder(56).Decode(png.first(length));
        EXPECT_TRUE(cut.empty() || (cut == whole && length + 12 >= png.size())) << length;
    }

    std::mt19937 random(11);
    for (int round = 0; round < 2000; ++round)
    {
        std::vector<std::byte> spoilt(png.begin(), png.end());
        for (std::uint32_t n = 1 + random() % 3; n > 0; --n)
            spoilt[random() % spoilt.size()] ^= static_cast<std::byte>(1u << random() % 8);
        const Platform::raster picture = CPNGDecoder(56).Decode(spoilt);
        EXPECT_TRUE(picture.width() <= 56 && picture.height() <= 56);
    }

    const auto index = IconResource(CResourceDataProvider::Icons);
    const auto stores = IconResource(CResourceDataProvider::HighResolutionDataFile);
    for (int round = 0; round < 20; ++round)
    {
        std::vector<std::byte> records(index.begin(), index.end()), store(stores.begin(), stores.end());
        for (int n = 0; n < 200; ++n)
        {
            const std::size_t at = 546 + random() % (records.size() - 546);
            if ((at - 546) % 368 >= 48)
                records[at] ^= static_cast<std::byte>(1u << random() % 8);
            store[random() % store.size()] ^= static_cast<std::byte>(random());
        }
        const CResourceDataProvider provider(
            [&](std::string_view key) { return std::span<const std::byte>(key == "Icons" ? records : store); });
        ResourceConversionThunk thunk(provider);
        EXPECT_GT(provider.Count(), 40u);
        for (const std::string &name : wantedNames(provider))
        {
            const CIcon icon = thunk.Find(name, 2, 6);
            EXPECT_TRUE(!icon || icon.pixels->width() <= 1024);
            thunk.OnScreen(name, 1.5);
        }
    }
}

} // namespace
