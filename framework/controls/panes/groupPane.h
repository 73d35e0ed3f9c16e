#pragma once

#include "framework/controls/drawTools.h"
#include "framework/controls/panes/framePane.h"

#include <string>

namespace Sarnik
{

/// A frame around what belongs together, with a title in its first titleHeight units where it has a text. The title's
/// access key hands the focus to the first view within that can have it.
class CGroupPane : public CFramePane
{
public:
    /// What layouts leave free above the content.
    static constexpr std::int32_t titleHeight = 22;

    explicit CGroupPane(const CRect &viewFrame = {}) : CFramePane(viewFrame, kFramePrimaryGroup) {}

    /// To be localised; "&" marks the access key.
    void SetText(std::string text);
    const std::string &Text() const { return rawText; }

    char32_t AccessKey() const override { return title.key; }
    void Press() override;
    void StateChanged() override { Invalidate(); }
    void Draw(CPort &port) override;

    /// Of the title.
    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure);

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;

private:
    std::string rawText;
    CDrawTools::label title;
    std::int32_t fontNumber = kFont_UIMediumBold;
};

} // namespace Sarnik
