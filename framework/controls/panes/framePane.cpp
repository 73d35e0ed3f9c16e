#include "framework/controls/panes/framePane.h"

#include "framework/views/window.h"

namespace Sarnik
{

void CFramePane::SetFrameStyle(EFrameStyle to)
{
    style = to;
    Invalidate();
}

void CFramePane::FocusWithinChanged()
{
    if (style == kFrameTargetRing)
        Invalidate();
}

bool CFramePane::HoldsFocus() const
{
    const CWindow *const window = Window();
    return window != nullptr && window->Focus() != nullptr && window->Focus()->IsWithin(*this);
}

void CFramePane::Draw(CPort &port)
{
    drawFrame(port, toCanvas(Bounds()), style, HoldsFocus());
}

void CFramePane::ReadProperties(const CLayoutPlacement &, const CWyraVariablePropertyList &properties)
{
    style = frameStyleOf(properties.Integer("frame_style", style));
}

} // namespace Sarnik
