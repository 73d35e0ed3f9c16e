#include "framework/layout/layoutResources.h"

#include "framework/layout/layoutError.h"
#include "tests/framework/layout/layoutViews.h"

#include <gtest/gtest.h>

#include <set>
#include <string>

namespace Sarnik
{
namespace
{

/// Every class that the layouts name.
// clang-format off
const std::vector<std::string> classes = {
    "CPane", "CFramePane", "CGroupPane", "CStaticText", "CPushButton", "CCheckButton", "CRadioPopup", "CEditNumber",
    "CEditString", "CEditSlider", "CAngleSlider", "CToolButton", "CSwitchPane", "CCasePane", "CScroller", "CIconButton",
    "CFlyoutPopup", "CMenuBarPane", "CZoomProgressCombo", "PPreviewScroller", "PPreviewPane", "PDetailedPreviewPane",
    "PKernelThumbnail", "PPushEmptyButton", "PDisclosableFramePane"};
// clang-format on

const std::string_view resourceNames[] = {"PDialog.wyra", "PParamDialog.wyra", "PPreferencesDialog.wyra"};

void expectInsideAndNamedOnce(const noteView &view, std::set<std::string> &ids)
{
    if (!view.id.empty())
    {
        EXPECT_TRUE(ids.insert(view.id).second) << view.id;
    }
    const CRect &own = view.placement.frame;
    for (const auto &child : view.children)
    {
        const CRect bounds{0, 0, static_cast<std::int32_t>(own.Width()), static_cast<std::int32_t>(own.Height())};
        EXPECT_TRUE(bounds.Contains(child->placement.frame)) << view.id << " > " << child->id << " " << child->text;
        expectInsideAndNamedOnce(*child, ids);
    }
}

class LayoutTexts : public testing::TestWithParam<std::string_view>
{
};

TEST_P(LayoutTexts, BuildWithEveryViewInItsParentAndEveryIdOnce)
{
    const layoutBench bench(classes);
    const auto window = bench.Build(LayoutResource(GetParam()));
    std::set<std::string> ids;
    expectInsideAndNamedOnce(*window, ids);
    EXPECT_GE(ids.size(), 4u);
    EXPECT_FALSE(window->children.empty());
}

TEST_P(LayoutTexts, AreRefusedWhereverTheyAreCutShort)
{
    const std::string_view whole = LayoutResource(GetParam());
    const std::size_t end = whole.find_last_of('}');
    for (std::size_t length = 0; length <= end; ++length)
    {
        try
        {
            ParseLayout(whole.substr(0, length));
            ADD_FAILURE() << "accepted " << length << " bytes";
        }
        catch (const CLayoutError &error)
        {
            EXPECT_GE(error.Line(), 1u);
        }
    }
    EXPECT_NO_THROW(ParseLayout(whole.substr(0, end + 1)));
}

TEST_P(LayoutTexts, SurviveAnyWrongByte)
{
    const layoutBench bench(classes);
    const std::string whole(LayoutResource(GetParam()));
    const std::string_view bytes = "9({;'-\xFF:";
    for (std::size_t i = 0; i < whole.size(); i += 1 + i % 17)
    {
        std::string damaged = whole;
        damaged[i] = bytes[i % bytes.size()];
        try
        {
            bench.Build(damaged);
        }
        catch (const CLayoutError &)
        {
        }
    }
}

INSTANTIATE_TEST_SUITE_P(All, LayoutTexts, testing::ValuesIn(resourceNames), [](const auto &tested) {
    return std::string(tested.param.substr(0, tested.param.find('.')));
});

TEST(LayoutResources, AreTheTexts)
{
    EXPECT_EQ(LayoutResources().size(), 4u);
    EXPECT_THROW(LayoutResource("None.wyra"), CError);
}

/// What the dialog's code counts on.
TEST(LayoutResources, MainDialogHasItsFixedSizes)
{
    const layoutBench bench(classes);
    const auto window = bench.Build(LayoutResource("PDialog.wyra"));
    const auto frame = [&window](const char *id) { return window->Find(id)->placement.frame; };
    EXPECT_EQ(frame("Project/Dialog/ResultDeconvPane").Height(), 126);
    EXPECT_EQ(frame("Project/Dialog/ResultDeconvPane").top - frame("Project/Dialog/ModePane").bottom, 4);
    EXPECT_EQ(frame("Project/Dialog/AdvancedPane").top - frame("Project/Dialog/ResultDeconvPane").bottom, 4);
    // Without the suppression and the space before it the pane is 80 high.
    EXPECT_LE(frame("Project/Dialog/RingingSuppressionPane").top, 80);
    EXPECT_EQ(frame("Project/Dialog/KernelEstimator").top, frame("Project/Dialog/ManualKernelSliders").top);
}

} // namespace
} // namespace Sarnik
