#pragma once

#include "framework/controls/layoutPane.h"
#include "framework/controls/panes/frameStyle.h"

namespace Sarnik
{

/// A pane with something drawn along its edge (frame_style), behind what lies in it.
class CFramePane : public CLayoutPane
{
public:
    explicit CFramePane(const CRect &viewFrame = {}, EFrameStyle frameStyle = kFrameEmpty)
        : CLayoutPane(viewFrame), style(frameStyle)
    {
    }

    EFrameStyle FrameStyle() const { return style; }
    void SetFrameStyle(EFrameStyle to);

    void FocusWithinChanged() override;
    void Draw(CPort &port) override;

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;
    /// Whether the view with the focus lies within.
    bool HoldsFocus() const;

private:
    EFrameStyle style;
};

} // namespace Sarnik
