// Controls with a field and a menu, and layouts that name the classes of menus and scrollers.

#include "framework/controls/dialog.h"
#include "framework/controls/menus/comboBox.h"
#include "framework/controls/menus/menuBar.h"
#include "framework/controls/menus/zoomProgressCombo.h"
#include "framework/controls/scrolling/listBox.h"
#include "tests/framework/views/stage.h"

namespace Sarnik::Test
{
namespace
{

using Platform::key;
using testing::ElementsAre;
using testing::IsEmpty;

struct combos : stage
{
    struct host : CPane
    {
        explicit host(Log &log) : CPane({0, 0, 200, 120}), entries(log) {}
        bool ReceiveValue(CValueMessage &m) override
        {
            std::string value;
            if (const auto *const text = dynamic_cast<CValMsg<std::string> *>(&m))
                value = "'" + text->Value() + "'";
            else if (const auto *const index = dynamic_cast<CValMsg<unsigned> *>(&m))
                value = std::to_string(index->Value());
            else if (const auto *const number = dynamic_cast<CValMsg<CNumber> *>(&m))
                value = CNumberFormat{kNumber_Decimal, 3, 0}.Text(number->Value().value);
            entries.push_back(m.Id().Name() + " " + std::to_string(m.Phase()) + " " + value);
            if (zoom != nullptr)
                zoom->SetZoom(0.25);
            return true;
        }
        Log &entries;
        CZoomProgressCombo *zoom = nullptr;
    };
    host &pane = window.Make<host>(log);
};

TEST_F(combos, EditableComboTakesAnyText)
{
    auto &combo = pane.Make<CComboBox>(CRect{10, 10, 120, 34});
    combo.SetId("test/combo");
    combo.SetItems({"$$$/Test/One=One", "Two", "Three"});
    EXPECT_TRUE(combo.CanFocus());
    combo.SetComboOptions(kCombo_Editable);
    EXPECT_FALSE(combo.CanFocus());
    EXPECT_EQ(combo.Entry(), "One");
    combo.Press();
    display.type("Tw").type("o").tap(key::enter);
    EXPECT_THAT(Told(), ElementsAre("test/combo 6 'One'", "test/combo 7 'T'", "test/combo 7 'Tw'", "test/combo 7 'Two'",
                                    "test/combo 8 'Two'"));
    EXPECT_EQ(combo.Value(), 1u);
    combo.SetEntry("else");
    EXPECT_EQ(combo.Value(), 3u) << "no item";
    display.click(110, 20).tap(key::end).tap(key::enter);
    EXPECT_THAT(Told(), ElementsAre("test/combo 2 2"));
    EXPECT_EQ(combo.Entry(), "Three");
    combo.SetComboOptions(kCombo_NoOptions);
    combo.SetFocus();
    display.tap(key::up);
    EXPECT_THAT(Told(), ElementsAre("test/combo 2 1"));
}

TEST_F(combos, ZoomIsTypedOrChosen)
{
    auto &combo = pane.Make<CZoomProgressCombo>(CRect{10, 10, 180, 34});
    combo.SetId("test/zoom");
    for (const auto &[factor, text] :
         {std::pair{1.0, "100%"}, {2 / 3.0, "66%"}, {0.0625, "6%"}, {0.29, "29%"}, {0.005, "0.5%"}, {16.0, "1600%"}})
    {
        combo.SetZoom(factor);
        EXPECT_EQ(combo.Field().Value(), text);
    }
    combo.Press();
    display.type("50").tap(key::enter).type("9999 %").tap(key::enter).type("none").tap(key::enter);
    EXPECT_THAT(Told(), ElementsAre("test/zoom 8 0.5", "test/zoom 8 16"));
    EXPECT_EQ(combo.Field().Value(), "1600%");
    pane.zoom = &combo; // the receiver has a zoom of its own
    display.type("30").tap(key::enter);
    EXPECT_THAT(Told(), ElementsAre("test/zoom 8 0.3"));
    EXPECT_EQ(combo.Field().Value(), "25%");

    auto menu = std::make_shared<CMenu>("test/menu");
    menu->Add("$$$/Test/Fit=Fit", "test/fit");
    combo.SetMenu(menu);
    display.tap(key::down).tap(key::enter);
    EXPECT_THAT(Told(), ElementsAre("command test/fit"));

    combo.SetProgress(0.5);
    EXPECT_TRUE(combo.Progress().IsVisible());
    EXPECT_TRUE(combo.Bounds().Contains(combo.Progress().Frame()));
    combo.EndProgress();
    EXPECT_FALSE(combo.Progress().IsVisible());
}

TEST_F(combos, LayoutsNameThem)
{
    CDialog dialog;
    dialog.LoadText(R"(CDialog(width: 300, height: 300)
    {
        CMenuBarPane(view_id: 'test/bar');
        CZoomProgressCombo(view_id: 'test/zoom', width: 170, view_tabstop: true);
        CComboBox(view_id: 'test/combo', combo_options: kCombo_Editable, width: 90);
        CListBox(view_id: 'test/box', list_multi_select: true, width: 90, height: 60);
        CScroller(view_id: 'test/scroller', scroller_attributes: kScroller_XBar, scroller_gap_left: 30,
            scroller_well_frame: true, scrollbar_style: kScrollbarStyle_FernwayMini, width: 100, height: 60)
        {
            CPane(view_id: 'test/gap', frame_interior: kInterior_ScrollerGapLeft);
            CCellSheet(view_id: 'test/sheet', frame_interior: kInterior_ScrollerPane,
                cell_options: kCellSheet_MultiSelect, view_tabstop: true);
        }
    })");
    dialog.Open();
    auto *const scroller = dialog.Find<CScroller>("test/scroller");
    auto *const sheet = dialog.Find<CCellSheet>("test/sheet");
    ASSERT_TRUE(scroller != nullptr && sheet != nullptr && dialog.Find<CMenuBarPane>("test/bar") != nullptr);
    EXPECT_EQ(scroller->Content(), sheet);
    EXPECT_EQ(scroller->Attributes(), static_cast<std::uint32_t>(kScroller_XBar | kScroller_WellFrame));
    EXPECT_EQ(dialog.Find<CView>("test/gap")->Frame(), scroller->Geometry().gapLeft);
    EXPECT_EQ(scroller->Geometry().gapLeft.Width(), 30);
    EXPECT_EQ(dialog.Find<CListBox>("test/box")->List().Selection().Kind(), CCellSelection::kind::any);
    EXPECT_TRUE(dialog.Find<CComboBox>("test/combo")->IsEditable());
    EXPECT_THAT(dialog.TabOrder(), ElementsAre(&dialog.Find<CZoomProgressCombo>("test/zoom")->Field(),
                                               dialog.Find<CComboBox>("test/combo")->Field(),
                                               &dialog.Find<CListBox>("test/box")->List(), sheet));
}

} // namespace
} // namespace Sarnik::Test
