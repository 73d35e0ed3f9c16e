#include "framework/controls/dialog.h"
#include "framework/controls/sliders/angleSlider.h"
#include "framework/controls/sliders/editSlider.h"
#include "tests/framework/controls/valueStage.h"

#include <cmath>
#include <numbers>

using namespace Sarnik;
using namespace Sarnik::Test;
using Platform::key;
using Platform::shiftModifier;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{

struct sliders : valueStage
{
    using valueStage::valueStage;

    /// From 0 to 100 over 200 units: x = 20 + 2 * value.
    CCustomSlider &Slider()
    {
        auto &slider = panel.Make<CCustomSlider>(CRect{12, 10, 228, 32});
        slider.SetQuantum(1);
        return slider;
    }
    static double At(double value) { return 20 + 2 * value; }
};

TEST_F(sliders, DragsBeginGoOnAndEnd)
{
    CCustomSlider &slider = Slider();
    slider.SetValue(30);
    display.press(At(30), 20).release(At(30), 20);
    EXPECT_THAT(Told(), ElementsAre("DragBegin 30", "DragEnd 30")) << "a touch changes nothing";
    display.drag({{At(30) + 3, 20}, {At(40) + 3, 90}, {At(40) + 3, 21}, {-50, 21}});
    EXPECT_THAT(Told(), ElementsAre("DragBegin 30", "Drag 40", "Drag 0", "DragEnd 0")) << "held where it was taken";
    display.press(At(77), 20).move(At(80), 20).tap(key::escape).release(At(80), 20);
    EXPECT_THAT(Told(), ElementsAre("DragBegin 0", "Drag 77", "Drag 80", "DragEnd 0"));
    slider.SetValue(12.25);
    display.click(At(12.25), 20);
    Run();
    EXPECT_EQ(slider.Value(), 12.25);
    slider.SetPositions(5);
    log.clear();
    display.click(At(60), 20);
    EXPECT_THAT(Told(), ElementsAre("DragBegin 12.25", "Drag 50", "DragEnd 50"));
    slider.Enable(false);
    display.click(At(10), 20).wheel(At(10), 20, 1);
    EXPECT_THAT(Told(), IsEmpty());
    // Deleted by a handler.
    for (const EValuePhase phase :
         {kValue_DragBegin, kValue_Drag, kValue_DragEnd, kValue_EditBegin, kValue_Edit, kValue_EditEnd})
    {
        CCustomSlider *gone = &Slider();
        gone->SetFocus();
        panel.onValue = [&](CValueMessage &m) {
            if (m.Phase() == phase && gone != nullptr)
                panel.Remove(*std::exchange(gone, nullptr));
        };
        if (phase < kValue_EditBegin)
            display.drag({{At(50), 20}, {At(60), 20}});
        else
            display.tap(key::right);
        Run();
        EXPECT_EQ(gone, nullptr);
    }
}

TEST_F(sliders, KeysAndTheWheelStep)
{
    CCustomSlider &slider = Slider();
    slider.SetFocus();
    display.keyDown(key::right).keyDown(key::right, true).keyUp(key::right).tap(key::end).tap(key::end);
    EXPECT_THAT(Told(),
                ElementsAre("EditBegin 0", "Edit 1", "Edit 2", "EditEnd 2", "EditBegin 2", "Edit 100", "EditEnd 100"));
    display.tap(key::pageDown).with(shiftModifier).tap(key::down).with(0).tap(key::home);
    Run();
    EXPECT_EQ(slider.Value(), 0);
    log.clear();
    display.wheel(50, 20, 1).wheel(50, 20, 2).after(1).move(51, 20);
    EXPECT_THAT(Told(), ElementsAre("EditBegin 0", "Edit 1", "Edit 3", "EditEnd 3"));
    display.keyDown(key::up);
    Told();
    panel.SetFocus(nullptr);
    EXPECT_THAT(Told(), ElementsAre("EditEnd 4")) << "nobody sees the key go up";
}

TEST_F(sliders, AResponseBendsTheWay)
{
    CCustomSlider &slider = Slider();
    slider.SetRange(5, 499);
    const double r = 50.0 / 494;
    slider.SetResponse(CSliderResponse::Linear({{0.618, r}}));
    EXPECT_NEAR(slider.ValueOf(0.618), 55, 1e-9);
    EXPECT_NEAR(slider.ValueOf(0.309), 30, 1e-9);
    EXPECT_NEAR(slider.ValueOf(0.8), 5 + 494 * (r + 0.182 * (1 - r) / 0.382), 1e-9);
    EXPECT_EQ(slider.ValueOf(0), 5);
    EXPECT_EQ(slider.ValueOf(1), 499);
    for (double t = 0; t <= 1; t += 1.0 / 64)
        EXPECT_NEAR(slider.TravelOf(slider.ValueOf(t)), t, 1e-12);
    display.click(20 + 200 * 0.309, 20);
    Run();
    EXPECT_EQ(slider.Value(), 30);
    slider.SetRange(7, 7);
    EXPECT_EQ(slider.Value(), 7);
    display.drag({{30, 20}, {200, 20}});
    Run();
    EXPECT_EQ(slider.Value(), 7);
}

struct sliderPainting : sliders, testing::WithParamInterface<double>
{
    sliderPainting() : sliders(GetParam()) {}
};

TEST_P(sliderPainting, OnlyWhatChangedIsDrawn)
{
    auto &slider = panel.Make<CEditSlider>(CRect{10, 10, 250, 32});
    auto &upright = panel.Make<CCustomSlider>(CRect{10, 40, 30, 140});
    upright.SetTicks(4);
    slider.SetValue(20);
    Run();
    const CRect knob = slider.Slider().KnobRect(20), field = slider.Field().Frame();
    const std::int64_t most = 2 * knob.Width() * knob.Height() + field.Width() * field.Height() + 4 * 240;
    for (const double value : {21.0, 70.0, 0.0, 100.0, 20.0})
    {
        // Twice, as pixels of scale 2 are four to a unit and Painted divides by two.
        EXPECT_LE(Painted([&] { slider.SetValue(value); }), most * std::int64_t(GetParam())) << value;
        upright.SetValue(value);
        ExpectFreshScreen();
    }
    EXPECT_EQ(Painted([&] { slider.SetValue(20); }), 0);
    slider.Slider().SetFocus();
    display.move(40, 20);
    ExpectFreshScreen();
    display.drag({{60, 20}, {90, 20}, {70, 20}});
    ExpectFreshScreen();
}

INSTANTIATE_TEST_SUITE_P(Scales, sliderPainting, testing::Values(1.0, 2.0));

TEST_F(sliders, ASliderAndItsFieldAreOneControl)
{
    CDialog dialog;
    dialog.LoadText("CDialog(width: 300, height: 100) { CEditSlider(view_id: 'test/size', view_tabstop: true,"
                    " slider_minimum: 5, slider_maximum: 499, slider_positions: 201, number_format: kNumber_Integer,"
                    " text_digits: 3, width: 240); CEditSlider(view_id: 'test/percent', number_format: kNumber_Decimal,"
                    " decimal_digits: 1, text: 'Amount:', width: 240, height: 22); CAngleSlider(view_id: 'test/angle',"
                    " slider_minimum: 0, slider_maximum: '359.9', angle_slider_clockwise: true); CEditString(view_id:"
                    " 'test/text', text: 'abc', max_characters: 2, text_read_only: true); }");
    auto *const size = dialog.Find<CEditSlider>("test/size"), *const percent = dialog.Find<CEditSlider>("test/percent");
    auto *const text = dialog.Find<CEditString>("test/text");
    auto *const angle = dialog.Find<CAngleSlider>("test/angle");
    ASSERT_TRUE(size && percent && text && angle);
    EXPECT_EQ(size->Frame().Width(), 240);
    EXPECT_EQ(size->Frame().Height(), 22);
    EXPECT_EQ(size->Value(), 5);
    EXPECT_GT(percent->Slider().Frame().left, 30) << "behind the label";
    EXPECT_EQ(percent->Slider().Quantum(), 0.1);
    EXPECT_EQ(text->Value(), "ab");
    EXPECT_EQ(angle->AngleOf(90), 270);
    EXPECT_EQ(dialog.TabOrder().size(), 4u) << "one stop for each";

    auto &both = panel.Make<CEditSlider>(CRect{12, 50, 252, 72});
    both.SetId("test/both");
    both.SetRange(0, 200);
    const CRect way = both.Slider().Frame();
    display.click(12 + (way.left + way.right) / 2, 60);
    EXPECT_THAT(Told(), ElementsAre("DragBegin 0", "Drag 100", "DragEnd 100"));
    EXPECT_EQ(panel.last, CObjID("test/both"));
    EXPECT_EQ(both.Field().Value(), "100");
    both.Field().SetFocus();
    display.type("25").tap(key::enter);
    EXPECT_THAT(Told(), ElementsAre("EditBegin 100", "Edit 2", "Edit 25", "EditEnd 25"));
    EXPECT_EQ(both.Slider().Value(), 25);
    both.Enable(false);
    EXPECT_FALSE(both.Field().CanFocus());
}

struct dial : valueStage
{
    dial() : angle(panel.Make<CAngleSlider>(CRect{50, 50, 150, 150})) {}
    /// A place in a direction from the dial's middle.
    static Platform::point In(double degrees)
    {
        const double a = degrees * std::numbers::pi / 180;
        return {100 + 30 * std::cos(a), 100 - 30 * std::sin(a)};
    }
    double Turned(double from, double to)
    {
        display.drag({In(from), In((from + to) / 2), In(to)});
        Run();
        return angle.Value();
    }
    CAngleSlider &angle;
};

TEST_F(dial, TurnsAroundAndSnaps)
{
    EXPECT_EQ(Turned(10, 90.04), 90);
    EXPECT_EQ(Turned(350, 370), 10);
    EXPECT_EQ(Turned(10, -0.04), 0) << "as good as 360";
    EXPECT_EQ(Turned(0, -10.1), 349.9);
    display.with(shiftModifier);
    EXPECT_EQ(Turned(0, 51), 45);
    EXPECT_EQ(Turned(0, -5), 0);
    display.with(0);
    angle.SetFocus();
    angle.SetValue(359.5);
    log.clear();
    display.tap(key::up).tap(key::pageUp).tap(key::down).wheel(100, 100, -1).after(1).move(1, 1);
    EXPECT_THAT(Told(), ElementsAre("EditBegin 359.5", "Edit 0.5", "EditEnd 0.5", "EditBegin 0.5", "Edit 15.5",
                                    "EditEnd 15.5", "EditBegin 15.5", "Edit 14.5", "EditEnd 14.5", "EditBegin 14.5",
                                    "Edit 13.5", "EditEnd 13.5"));
    for (double v = 0; v < 360; v += 7.3)
        for (const std::uint32_t bits : {kAngleSlider_CCW, kAngleSlider_CW})
        {
            angle.SetDialOptions(bits);
            EXPECT_NEAR(angle.ValueOf(angle.AngleOf(v)), v, 1e-9);
        }
}

TEST_F(dial, PinsTakesEitherEndAndScales)
{
    angle.SetDialOptions(kAngleSlider_PinValue);
    EXPECT_EQ(Turned(300, 380), 359.9) << "stays at the end";
    angle.SetDialOptions(kAngleSlider_BiDirectional);
    angle.SetValue(30);
    EXPECT_EQ(Turned(210, 230), 50) << "by its other end";
    angle.SetDialOptions(kAngleSlider_CW);
    EXPECT_EQ(Turned(0, -90), 90);
    // A knob of 270 degrees that begins at the lower left.
    angle.SetRange(0, 10);
    angle.SetScale(-135, 270);
    EXPECT_NEAR(angle.AngleOf(0), 135, 1e-9);
    EXPECT_NEAR(angle.AngleOf(5), 0, 1e-9);
    EXPECT_NEAR(Turned(100, 0), 5, 1e-9);
    EXPECT_EQ(Turned(0, -160), 10) << "in the gap, the nearer end";
    ExpectFreshScreen();
}

} // namespace
