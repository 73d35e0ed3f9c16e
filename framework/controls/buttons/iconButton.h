#pragma once

#include "framework/controls/buttons/button.h"

namespace Sarnik
{

/// A button with a picture: `icon` by its name, `button_kind` what it does, `button_style` what is drawn around it (a
/// raised face where the layout says nothing). With kButtonStyle_Disclosure an arrow stands for a missing picture.
class CIconButton : public CButton
{
public:
    explicit CIconButton(const CRect &viewFrame = {}, EButtonKind buttonKind = kPushButton,
                         std::uint32_t viewOptions = kView_Target | kView_TabStop)
        : CButton(viewFrame, buttonKind, viewOptions)
    {
    }

    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure)
    {
        return CButton::NaturalSize(properties, measure, kButtonStyle_Bevel, {});
    }

protected:
    EButtonStyle OwnStyle() const override { return kButtonStyle_Bevel; }
    std::string_view FontProperty() const override { return {}; }
};

/// A push button that is its picture alone. A press of the pointer leaves the focus where it is.
class CFlatIconButton : public CIconButton
{
public:
    explicit CFlatIconButton(const CRect &viewFrame = {})
        : CIconButton(viewFrame, kPushButton, kView_Target | kView_TabStop | kView_NoFocusOnClick)
    {
    }

    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure)
    {
        return CButton::NaturalSize(properties, measure, kButtonStyle_Tool, {});
    }

protected:
    EButtonStyle OwnStyle() const override { return kButtonStyle_Tool; }
};

} // namespace Sarnik
