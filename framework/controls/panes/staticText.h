#pragma once

#include "framework/controls/control.h"

#include <memory>

namespace Sarnik
{

/// How a static text is laid out, as layouts write it: words of static_options.
enum EStaticOptions : std::uint32_t
{
    kStatic_Wrap = 1,       ///< in lines as wide as the view
    kStatic_GroupTitle = 2, ///< bold, as the title of what follows
};

/// A text that the user reads. Its access key hands the focus to the next view that can have it, so that it serves as
/// the label of a field. text_align_x, text_align_y, text_trim: where the text goes, and where a line that is too long
/// is cut.
class CStaticText : public CControl
{
public:
    explicit CStaticText(const CRect &viewFrame = {}) : CControl(viewFrame, 0) {}

    void SetStaticOptions(std::uint32_t bits);
    void SetAlign(EAlign x, EAlign y);
    void SetTrim(Platform::textTrim to);

    void Press() override;
    void MouseEnter() override {}
    void MouseLeave() override {}
    void Draw(CPort &port) override;

    /// Of the text; where it wraps and the layout gives a width, with the height of all lines.
    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure);

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;
    std::string_view FontProperty() const override { return "label_font"; }

private:
    Platform::font DrawnFont() const;

    std::uint32_t options = 0;
    EAlign alignX = kAlign_Near, alignY = kAlign_Center;
    Platform::textTrim trim = Platform::textTrim::end;
};

} // namespace Sarnik
