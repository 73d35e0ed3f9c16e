#include "framework/controls/buttons/checkButton.h"
#include "framework/controls/buttons/iconButton.h"
#include "framework/controls/buttons/pushButton.h"
#include "framework/controls/panes/framePane.h"
#include "framework/controls/panes/progressBar.h"
#include "tests/framework/controls/controlStage.h"
#include "tests/framework/controls/goldenPicture.h"

#include <cmath>
#include <random>

using namespace Sarnik;
using namespace Sarnik::Test;

namespace
{

/// Contrast ratio of two colours as the web's accessibility guidelines (WCAG 2.1) define it: 1 to 21.
double contrast(Platform::colour a, Platform::colour b)
{
    const auto luminance = [](Platform::colour c) {
        const auto linear = [](double v) { return v <= 0.03928 ? v / 12.92 : std::pow((v + 0.055) / 1.055, 2.4); };
        return 0.2126 * linear(c.red / 255.0) + 0.7152 * linear(c.green / 255.0) + 0.0722 * linear(c.blue / 255.0);
    };
    const double first = luminance(a), second = luminance(b);
    return (std::max(first, second) + 0.05) / (std::min(first, second) + 0.05);
}

TEST(palette, TextsCanBeRead)
{
    const CPalette &c = CDrawTools::Colours();
    EXPECT_NEAR(contrast({255, 255, 255}, {0, 0, 0}), 21, 1e-9);
    EXPECT_NEAR(contrast({255, 255, 255}, {118, 118, 118}), 4.54, 0.01) << "a known pair";
    for (const Platform::colour behind : {c.window, c.panel, c.field, c.menu, c.face, c.faceHot, c.facePressed,
                                          c.accent, c.accentHot, c.accentPressed, c.accentDim})
        EXPECT_GE(contrast(c.text, behind), 4.5) << int{behind.red} << " " << int{behind.green};
    EXPECT_GE(contrast(c.tipText, c.tip), 4.5);
    EXPECT_GE(contrast(c.ring, c.window), 3.0);
}

/// What has no text: text is drawn differently by every version of every font.
class looks : public controlStage, public testing::WithParamInterface<double>
{
public:
    looks() : controlStage(GetParam()) { pane.SetFrame(window.Bounds()); }
};

INSTANTIATE_TEST_SUITE_P(controls, looks, testing::Values(1.0, 2.0));

TEST_P(looks, ShapesAreAsTheyWere)
{
    pane.Make<CFramePane>(CRect{0, 0, 200, 120}, kFramePlacard);
    for (int row = 0; row < 2; ++row)
        for (int i = 0; i < 3; ++i)
        {
            auto &check = pane.Make<CCheckButton>(CRect{4 + 20 * i, 4 + 20 * row, 24 + 20 * i, 24 + 20 * row});
            check.SetValue(static_cast<EButtonValue>(i));
            auto &holder = pane.Make<CPane>(CRect{70 + 20 * i, 4 + 20 * row, 90 + 20 * i, 24 + 20 * row});
            auto &radio = holder.Make<CRadioButton>(CRect{0, 0, 20, 20});
            radio.SetValue(i == 1 ? kOn : kOff);
            auto &arrow =
                pane.Make<CIconButton>(CRect{134 + 20 * i, 6 + 20 * row, 150 + 20 * i, 22 + 20 * row}, kCheckButton);
            arrow.SetStyle(kButtonStyle_Disclosure);
            arrow.SetValue(i == 1 ? kOn : kOff);
            auto &push = pane.Make<CPushButton>(CRect{4 + 50 * i, 46 + 24 * row, 50 + 50 * i, 68 + 24 * row});
            push.SetDefault(i == 1);
            for (CView *const view : std::initializer_list<CView *>{&check, &holder, &arrow, &push})
                view->Enable(row == 0 && i < 3);
            if (i == 2 && row == 0)
                push.SetFocus();
        }
    pane.Make<CProgressBar>(CRect{4, 96, 100, 104}).SetValue(0.6);
    constexpr EFrameStyle styles[] = {kFramePrimaryGroup, kFrameScrollerWell, kFrameEtched, kFrameIn3D, kDividerTopUIB};
    for (int i = 0; i < 5; ++i)
        pane.Make<CFramePane>(CRect{104 + 19 * i, 94, 120 + 19 * i, 114}, styles[i]);
    display.tap(Platform::key::f1).tap(Platform::key::right);
    Run();
    EXPECT_TRUE(looksLike(Screen().screen(), "shapes_" + std::to_string(static_cast<int>(GetParam()))));
}

/// Whatever happens to them, buttons show what was last said of them and are up in the end.
TEST(buttonScripts, MessagesTellEveryChange)
{
    struct scripted : controlStage
    {
        void TestBody() override {}
    };
    std::mt19937 random(5);
    for (int round = 0; round < 20; ++round)
    {
        scripted stage;
        std::vector<CCheckButton *> checks;
        for (int i = 0; i < 4; ++i)
            checks.push_back(&stage.Control<CCheckButton>(std::to_string(i).c_str(), {0, i * 25, 100, i * 25 + 20}));
        std::vector<int> expected(4);
        for (int step = 0; step < 40; ++step)
        {
            const double x = random() % 140, y = random() % 110;
            switch (random() % 6)
            {
            case 0:
                stage.display.click(x, y);
                break;
            case 1:
                stage.display.drag({{x, y}, {double(random() % 140), double(random() % 110)}, {50, 10}});
                break;
            case 2:
                stage.display.tap(Platform::key::tab);
                break;
            case 3:
                stage.display.tap(Platform::key::space);
                break;
            case 4:
                checks[random() % 4]->Enable(random() % 3 != 0);
                break;
            default:
                checks[random() % 4]->Show(random() % 3 != 0);
            }
            for (const std::string &told : stage.Told())
            {
                const auto which = static_cast<std::size_t>(told[0] - '0');
                ASSERT_EQ(told, std::to_string(which) + " 2 " + std::to_string(1 - expected[which]));
                expected[which] = 1 - expected[which];
            }
            for (std::size_t i = 0; i < 4; ++i)
            {
                ASSERT_EQ(checks[i]->Value(), expected[i]);
                ASSERT_FALSE(checks[i]->IsPressed());
            }
        }
    }
}

} // namespace
