#pragma once

#include "framework/controls/buttons/button.h"

namespace Sarnik
{

/// A box with a mark and a label. tri_state: it has a neutral value too.
class CCheckButton : public CButton
{
public:
    explicit CCheckButton(const CRect &viewFrame = {}) : CButton(viewFrame, kCheckButton) {}

    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure)
    {
        return CButton::NaturalSize(properties, measure, kButtonStyle_Check, {});
    }

protected:
    std::string_view FontProperty() const override { return {}; }
};

/// One of several with the same parent is on. Arrows move the choice, the tab key stops at the one that is on.
class CRadioButton : public CButton
{
public:
    explicit CRadioButton(const CRect &viewFrame = {}) : CButton(viewFrame, kRadioButton) {}

    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure)
    {
        return CButton::NaturalSize(properties, measure, kButtonStyle_Radio, {});
    }

protected:
    std::string_view FontProperty() const override { return {}; }
};

} // namespace Sarnik
