#pragma once

#include "framework/controls/buttons/buttonKinds.h"
#include "framework/controls/drawTools.h"
#include "framework/messages/messages.h"
#include "framework/pixels/rect.h"

#include <string_view>

namespace Sarnik
{

/// How a button of any style is drawn. Interface thread.
struct CButtonLook
{
    EButtonStyle style = kButtonStyle_Push; ///< kButtonStyle_Default is drawn as kButtonStyle_Push
    EButtonValue value = kOff;
    bool hot = false, pressed = false, enabled = true;
    bool prominent = false; ///< the button that Enter presses
    bool ring = false;      ///< around what has the focus
    CDrawTools::label label;
    Platform::font font;
    std::string_view icon; ///< by its name; empty for none
    double iconX = 0, iconY = 0;

    void Draw(CPort &port, const Platform::rectangle &room) const;

    /// Room for the content and what the style draws around it, focus ring included.
    static CLayoutSize Size(EButtonStyle style, CLayoutSize text, CLayoutSize icon);

private:
    Platform::rectangle Mark(const Platform::rectangle &room) const;
    void DrawMark(CPort &port, const Platform::rectangle &box) const;
    void DrawDisclosure(CPort &port, const Platform::rectangle &room) const;
    void DrawFace(CPort &port, const Platform::rectangle &face) const;
    void DrawContent(CPort &port, const Platform::rectangle &room, EAlign align) const;
    Platform::colour Ink() const;
};

} // namespace Sarnik
