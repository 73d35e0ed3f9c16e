#pragma once

#include "framework/controls/drawTools.h"
#include "framework/views/window.h"

#include <cstdint>

namespace Sarnik
{

/// Where a popup of a wanted size opens, in view units of the screen: under the anchor, or above it where only there is
/// room for it, moved sideways into the area. Where neither side has the room it goes to the larger one and is cut to
/// it; `least` is the height below which it is not cut.
CRect popupFrame(const CRect &anchor, std::int32_t width, std::int32_t height, const CRect &area, std::int32_t least);

/// A window without a frame in front of another one. It goes with a press outside of it, with Escape, with the
/// keyboard's leaving its owner, and with its owner. Interface thread.
class CPopup : public CWindow
{
public:
    explicit CPopup(Platform::colour background = CDrawTools::Colours().menu);

    /// Opens by an anchor in view units of the screen, within the display's work area. Throws CError where there is no
    /// display.
    void OpenBy(CWindow &by, const CRect &anchor, std::int32_t width, std::int32_t height, std::int32_t least = 0);

    /// Escape.
    bool KeyboardFilter(CKeyboardMessage &message) override;

    /// The screen that popups may use, in whole view units.
    static CRect WorkArea();
};

} // namespace Sarnik
