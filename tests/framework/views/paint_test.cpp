#include "framework/views/binding.h"
#include "tests/framework/views/stage.h"

#include <random>

using namespace Sarnik;
using namespace Sarnik::Test;

namespace
{

CRect randomRect(std::mt19937 &random, int width, int height)
{
    const int left = int(random() % unsigned(width)) - 20, top = int(random() % unsigned(height)) - 20;
    return {left, top, left + int(random() % 80), top + int(random() % 60)};
}

TEST(damage, CoversWhatWasAddedAndFewOthers)
{
    std::mt19937 random(1);
    for (int round = 0; round < 200; ++round)
    {
        CDamage damage;
        std::vector<CRect> added;
        for (int i = 0; i < 1 + round % 30; ++i)
        {
            added.push_back(randomRect(random, 300, 300));
            damage.Add(added.back());
        }
        ASSERT_LE(damage.Parts().size(), CDamage::mostParts);
        for (const CRect &rect : added)
            for (std::int32_t y = rect.top; y < rect.bottom; y += 3)
                for (std::int32_t x = rect.left; x < rect.right; x += 3)
                    ASSERT_TRUE(std::any_of(damage.Parts().begin(), damage.Parts().end(), [&](const CRect &p) {
                        return p.Contains({x, y, x + 1, y + 1});
                    }));
        for (const CRect &part : damage.Parts())
            ASSERT_TRUE(damage.Bounds().Contains(part));
    }
    CDamage two;
    two.Add({0, 0, 10, 10});
    two.Add({290, 290, 300, 300});
    EXPECT_EQ(two.Parts().size(), 2u) << "far from each other";
    two.Add({10, 0, 20, 10});
    EXPECT_EQ(two.Parts().size(), 2u) << "joined without waste";
}

TEST(binding, FollowsTheParentAndComesBack)
{
    const CRect frame{20, 10, 60, 30};
    const auto at = [&](std::uint32_t bits) { return boundFrame(frame, bits, 100, 50, 141, 81); };
    EXPECT_EQ(at(0), frame);
    EXPECT_EQ(at(kBind_Left | kBind_Top), frame);
    EXPECT_EQ(at(kBind_Right | kBind_Bottom), (CRect{61, 41, 101, 61}));
    EXPECT_EQ(at(kBind_XCenter), (CRect{40, 10, 80, 30}));
    EXPECT_EQ(at(kBind_XSizeable | kBind_YSizeable), (CRect{20, 10, 101, 61}));
    EXPECT_EQ(at(kBind_XSizeable | kBind_XCenter | kBind_Left).right, 80) << "the left half";
    EXPECT_EQ(at(kBind_XSizeable | kBind_XCenter | kBind_Right).left, 40) << "the right half";

    std::mt19937 random(2);
    for (std::uint32_t bits = 0; bits < 256; ++bits)
    {
        CRect moved = frame;
        int width = 100, height = 50;
        for (int i = 0; i < 20; ++i)
        {
            const int newWidth = i == 19 ? 100 : int(random() % 700), newHeight = i == 19 ? 50 : int(random() % 700);
            moved = boundFrame(moved, bits, width, height, newWidth, newHeight);
            width = newWidth, height = newHeight;
        }
        EXPECT_EQ(moved, frame) << bits;
    }
}

int LargestDifference(const Platform::raster &a, const Platform::raster &b)
{
    int largest = 0;
    for (int y = 0; y < a.height(); ++y)
        for (int x = 0; x < a.width(); ++x)
            for (int shift = 0; shift < 32; shift += 8)
                largest =
                    std::max(largest, std::abs(int(a.row(y)[x] >> shift & 255) - int(b.row(y)[x] >> shift & 255)));
    return largest;
}

struct painting : stage, testing::WithParamInterface<double>
{
    painting() : stage(GetParam()) {}
    /// The screen as it would be if everything were drawn now.
    Platform::raster Everything()
    {
        Run();
        const Platform::raster before = Screen().screen();
        window.Invalidate();
        Run();
        const Platform::raster after = Screen().screen();
        // Edges between pixels may differ by some levels with how they are clipped; whole ones may not.
        EXPECT_LE(LargestDifference(before, after), GetParam() == 1.25 ? 16 : 0)
            << "the damaged parts were not all that had changed";
        return after;
    }
};

INSTANTIATE_TEST_SUITE_P(views, painting, testing::Values(1.0, 1.25, 2.0));

TEST_P(painting, DamagedPartsAreAllThatChanges)
{
    std::mt19937 random(static_cast<unsigned>(GetParam() * 8));
    std::vector<notingPane *> panes;
    int made = 0;
    for (int step = 0; step < 400; ++step)
    {
        notingPane *const some = panes.empty() ? nullptr : panes[random() % panes.size()];
        switch (random() % 7)
        {
        case 0:
            if (panes.size() < 12)
            {
                const std::uint32_t options = random() % 2 * kView_DrawParts;
                panes.push_back(&Pane(std::to_string(made++), randomRect(random, 200, 120), options,
                                      random() % 2 ? some : nullptr));
                panes.back()->colour = {std::uint8_t(random()), std::uint8_t(random()), 0, std::uint8_t(random())};
            }
            break;
        case 1:
            if (some != nullptr)
                some->SetFrame(randomRect(random, 200, 120));
            break;
        case 2:
            if (some != nullptr)
                some->Show(random() % 2);
            break;
        case 3:
            if (some != nullptr && some->Children().empty())
            {
                some->Container()->Remove(*some);
                std::erase(panes, some);
            }
            break;
        case 4:
            if (some != nullptr)
            {
                some->colour.blue = std::uint8_t(random());
                some->Invalidate();
            }
            break;
        case 5:
            if (some != nullptr)
                some->Invalidate(randomRect(random, 200, 120));
            break;
        default:
            Run();
            break;
        }
        if (step % 10 == 0)
            Everything();
    }
}

TEST_P(painting, OnlyTheDamagedRectangleIsTouched)
{
    notingPane &large = Pane("large", {0, 0, 200, 120}, kView_DrawParts);
    notingPane &slider = Pane("slider", {20, 20, 100, 36});
    notingPane &other = Pane("other", {120, 60, 180, 100});
    Run();
    const std::int64_t before = Screen().presentedPixels();
    large.drawn = slider.drawn = other.drawn = 0;
    large.asked = 0;
    slider.Invalidate({10, 0, 30, 16});
    slider.Invalidate({20, 0, 40, 16});
    EXPECT_EQ(slider.drawn, 0) << "drawing waits";
    Run();
    EXPECT_EQ(Screen().presentedPixels() - before, std::int64_t(30 * GetParam()) * std::int64_t(16 * GetParam()) +
                                                       (GetParam() == 1.25 ? 38 * 20 - 37 * 20 : 0));
    EXPECT_EQ(slider.drawn, 1);
    EXPECT_EQ(large.drawn, 1) << "it lies below";
    EXPECT_EQ(large.asked, 30 * 16);
    EXPECT_EQ(other.drawn, 0);

    // Far-off parts come one by one to those who ask for parts.
    large.asked = 0;
    large.Invalidate({0, 0, 5, 5});
    large.Invalidate({190, 110, 200, 120});
    Run();
    EXPECT_EQ(large.asked, 25 + 100);

    slider.Show(false);
    Run();
    const int presents = Screen().presents();
    slider.Invalidate();
    slider.SetFrame({30, 30, 60, 60});
    Run();
    EXPECT_EQ(Screen().presents(), presents) << "nothing of a hidden view is drawn";
}

TEST_P(painting, ResizingAndScalingDrawAnew)
{
    notingPane &wide = Pane("wide", {10, 10, 190, 60});
    wide.SetBinding(kBind_XSizeable | kBind_Bottom);
    display.resize(300, 200);
    Run();
    EXPECT_EQ(window.Bounds(), (CRect{0, 0, 300, 200}));
    EXPECT_EQ(wide.Frame(), (CRect{10, 90, 290, 140}));
    const int side = static_cast<int>(300 * GetParam());
    EXPECT_EQ(Everything().width(), side);
    display.changeScale(3);
    EXPECT_EQ(Everything().width(), 900);
    EXPECT_EQ(window.Bounds(), (CRect{0, 0, 300, 200})) << "view units stay";

    display.changeScale(1);
    display.setBorder({3, 24, 3, 5});
    EXPECT_EQ(window.LargestFrame(2), (CRect{5, 26, 1915, 1073})) << "the display's frame stays on the screen";
}

} // namespace
