#pragma once

#include "framework/controls/control.h"
#include "framework/controls/fields/editNumber.h"
#include "framework/controls/sliders/customSlider.h"

namespace Sarnik
{

/// A slider and a field that show the same number, perhaps behind a label. The class "CEditSlider" of layouts. Tells of
/// the changes of both under its own id, in their phases. The tab key stops at the field, which knows the keys of both.
class CEditSlider : public CControl
{
public:
    explicit CEditSlider(const CRect &viewFrame = {}, std::uint32_t viewOptions = kView_NoOptions);

    double Value() const { return slider->Value(); }
    /// Cut to the range. Tells nobody.
    void SetValue(double to);
    const CNumberRange &Range() const { return slider->Range(); }
    void SetRange(double least, double most);
    /// Dragged values get as many digits as the field shows.
    void SetFormat(const CNumberFormat &format);
    void SetResponse(CSliderResponse response) { slider->SetResponse(std::move(response)); }

    CCustomSlider &Slider() { return *slider; }
    CEditNumber &Field() { return *field; }
    const CCustomSlider &Slider() const { return *slider; }
    const CEditNumber &Field() const { return *field; }

    void Draw(CPort &port) override;
    void FrameChanged() override { Arrange(); }
    bool CanFocus() const override { return false; }
    /// Its access key leads to the field.
    void Press() override { field->SetFocus(); }
    bool ReceiveValue(CValueMessage &message) override;

    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure);

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;

private:
    void Arrange();

    CCustomSlider *slider;
    CEditNumber *field;
    std::int32_t labelWidth = 0, fieldWidth = 56;
};

} // namespace Sarnik
