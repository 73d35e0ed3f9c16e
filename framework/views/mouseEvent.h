#pragma once

#include "platform/canvas/geometry.h"
#include "platform/window/event.h"

#include <cstdint>

namespace Sarnik
{

class CView;

/// What the pointer did, as a view sees it.
struct CMouseEvent
{
    Platform::point at;            ///< in the view's coordinates
    Platform::point inWindow;      ///< the same place in the window's
    int button = 0;                ///< 1 the first, 2 the middle, 3 the other one; 0 for moves and wheels
    int clicks = 1;                ///< 2 with the second press of a double click, and so on
    double wheelX = 0, wheelY = 0; ///< notches to the right and away from the user
    std::uint32_t modifiers = 0;   ///< Platform::modifier

    bool Alt() const { return (modifiers & Platform::altModifier) != 0; }
    bool Ctrl() const { return (modifiers & Platform::ctrlModifier) != 0; }
    bool Shift() const { return (modifiers & Platform::shiftModifier) != 0; }

    /// The same for another view of the window.
    CMouseEvent For(const CView &view) const;
};

} // namespace Sarnik
