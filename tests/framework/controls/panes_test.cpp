#include "framework/base/exceptions.h"
#include "framework/controls/buttons/checkButton.h"
#include "framework/controls/buttons/iconButton.h"
#include "framework/controls/dialog.h"
#include "framework/controls/panes/columnStack.h"
#include "framework/controls/panes/disclosurePane.h"
#include "framework/controls/panes/groupPane.h"
#include "framework/controls/panes/progressBar.h"
#include "framework/controls/panes/staticText.h"
#include "framework/controls/panes/switchPane.h"
#include "tests/framework/controls/controlStage.h"

#include <cmath>
#include <limits>

using namespace Sarnik;
using namespace Sarnik::Test;
using Platform::key;
using testing::ElementsAre;

namespace
{

struct panes : controlStage
{
};

TEST_F(panes, AccessKeysOfTextsHandTheFocusOn)
{
    auto &group = Control<CGroupPane>("group", {0, 0, 200, 60});
    group.SetText("&Group");
    auto &first = Control<CCheckButton>("first", {10, 22, 90, 40}, &group);
    auto &label = Control<CStaticText>("label", {0, 60, 100, 78});
    label.SetText("&Last:");
    auto &hidden = Control<CCheckButton>("hidden", {0, 80, 100, 98});
    hidden.Show(false);
    auto &last = Control<CCheckButton>("last", {0, 80, 100, 98});
    display.with(Platform::altModifier).tap(key::l).with(0);
    Run();
    EXPECT_TRUE(last.HasFocus());
    display.with(Platform::altModifier).tap(key::g).with(0);
    Run();
    EXPECT_TRUE(first.HasFocus());
    EXPECT_FALSE(last.IsOn()) << "nothing is pressed";
}

TEST_F(panes, ASwitchShowsOneCaseAndTakesTheFocusAlong)
{
    auto &choice = Control<CSwitchPane>("switch", {0, 0, 100, 50});
    std::vector<CCheckButton *> checks;
    for (const char *const name : {"one", "two", "three"})
    {
        auto made = std::make_unique<CCasePane>(CRect{0, 0, 100, 50});
        made->SetCaseId(name);
        if (std::string_view(name) != "three")
            checks.push_back(&made->Make<CCheckButton>(CRect{0, 0, 90, 20}));
        choice.AddCase(std::move(made));
    }
    const auto shown = [&] {
        return std::count_if(choice.Children().begin(), choice.Children().end(),
                             [](const auto &c) { return c->IsVisible(); });
    };
    EXPECT_EQ(choice.Current(), CObjID("one"));
    checks[0]->SetFocus();
    EXPECT_FALSE(choice.Switch("four"));
    EXPECT_TRUE(choice.Switch("two"));
    EXPECT_TRUE(checks[1]->HasFocus());
    EXPECT_FALSE(checks[0]->IsVisible());
    EXPECT_EQ(shown(), 1);
    EXPECT_TRUE(choice.Switch("three"));
    EXPECT_EQ(window.Focus(), nullptr) << "nobody there can have it";
    EXPECT_TRUE(choice.Switch("one"));
    EXPECT_EQ(window.Focus(), nullptr) << "it was not in the switch";
    EXPECT_EQ(shown(), 1);
}

//  | first 20 | advanced 60, of which heading 24 | growing |   in a column of 120, 4 units apart, 2 from its ends
TEST_F(panes, HiddenContentLeavesItsRoomToTheColumn)
{
    auto &first = Pane("first", {0, 2, 100, 22}, 0, &pane);
    auto &advanced = Control<CDisclosurePane>("advanced", {0, 26, 100, 86});
    auto &heading = advanced.Make<CPane>(CRect{8, 3, 92, 21});
    auto &arrow = Control<CIconButton>("arrow", {0, 0, 16, 16}, &heading);
    auto &content = Control<CCheckButton>("content", {8, 24, 92, 44}, &advanced);
    auto &growing = Pane("growing", {0, 90, 100, 118}, 0, &pane);
    growing.SetBinding(kBind_XSizeable | kBind_YSizeable);
    content.SetFocus();
    log.clear();

    advanced.Disclose(false);
    EXPECT_THAT(Told(), ElementsAre("Sarnik/DisclosurePane/Changed advanced"));
    EXPECT_EQ(advanced.Frame(), (CRect{0, 26, 100, 50}));
    EXPECT_FALSE(content.IsVisible());
    EXPECT_TRUE(arrow.HasFocus());
    stackColumn(pane, 2, 4);
    EXPECT_EQ(growing.Frame(), (CRect{0, 54, 100, 118}));
    first.Show(false);
    stackColumn(pane, 2, 4);
    EXPECT_EQ(growing.Frame(), (CRect{0, 30, 100, 118}));
    first.Show(true);
    advanced.Disclose(true);
    stackColumn(pane, 2, 4);
    EXPECT_EQ(first.Frame(), (CRect{0, 2, 100, 22}));
    EXPECT_EQ(advanced.Frame(), (CRect{0, 26, 100, 86}));
    EXPECT_EQ(content.Frame(), (CRect{8, 24, 92, 44}));
    EXPECT_EQ(growing.Frame(), (CRect{0, 90, 100, 118}));
}

TEST_F(panes, ProgressRedrawsWhatChangesAndHidesWhenNothingIsUnderWay)
{
    auto &bar = Control<CProgressBar>("bar", {0, 0, 200, 10});
    bar.SetValue(0.5);
    EXPECT_LE(PixelsShown([&] { bar.SetValue(0.51); }), 14 * 10);
    EXPECT_GT(PixelsShown([&] { bar.SetValue(0.9); }), 70 * 10);
    bar.SetValue(std::numeric_limits<double>::quiet_NaN());
    EXPECT_EQ(bar.Value(), 0);
    bar.SetValue(7);
    EXPECT_EQ(bar.Value(), 1);
    bar.SetAutoHide(true);
    EXPECT_FALSE(bar.IsVisible());
    bar.SetValue(0.25);
    EXPECT_TRUE(bar.IsVisible());
    bar.SetIndeterminate(true);
    const int before = Screen().presents();
    for (const double end = display.now() + 0.5; display.now() < end;)
        application.ProcessOne(0.1);
    EXPECT_GE(Screen().presents() - before, 10) << "the light moves";
    bar.SetValue(0);
    EXPECT_FALSE(bar.IsVisible());
    EXPECT_EQ(CTimer::NextDue(), std::numeric_limits<double>::infinity()) << "nothing left to wake up for";
}

TEST(paneLayouts, TextsAreAsLargeAsTheirWords)
{
    Platform::memoryDisplay display;
    CApplication application(display);
    CDialog dialog;
    dialog.LoadText("CDialog() { CGroupPane(view_id: 'group', text: 'A long title of a group', margin: 8) {"
                    "CStaticText(view_id: 'line', text: 'one two three', horizontal: align_left);"
                    "CStaticText(view_id: 'wrapped', text: 'one two three', static_wrap: true, width: 40,"
                    "    horizontal: align_left);"
                    "CFramePane(view_id: 'frame', frame_style: kFrameScrollerWell, height: 5);"
                    "CSwitchPane(view_id: 'switch', placement: place_offscreen) {"
                    "    CCasePane(case_id: 'x') { CStaticText(text: 'x', height: 30); }"
                    "    CCasePane(case_id: 'y') { CStaticText(text: 'y', height: 40); } } } }");
    const CRect line = dialog.FindView("line")->Bounds(), wrapped = dialog.FindView("wrapped")->Bounds();
    EXPECT_GT(line.right, 60);
    EXPECT_EQ(wrapped.right, 40);
    EXPECT_GE(wrapped.bottom, 2 * line.bottom);
    EXPECT_GT(dialog.FindView("group")->Bounds().right, line.right);
    EXPECT_EQ(dialog.Find<CFramePane>("frame")->FrameStyle(), kFrameScrollerWell);
    EXPECT_EQ(dialog.FindView("switch")->Bounds().bottom, 40);
    EXPECT_EQ(dialog.Find<CSwitchPane>("switch")->Current(), CObjID("x"));

    dialog.LoadLayout("PParamDialog.wyra"); // it has views: nothing happens
    EXPECT_EQ(dialog.Children().size(), 1u);
    EXPECT_EQ(dialog.FindView("Project/ParamDialog/OkButton"), nullptr);
    EXPECT_THROW(CDialog().LoadLayout("None.wyra"), CError);
}

} // namespace
