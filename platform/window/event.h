#pragma once

#include "platform/canvas/geometry.h"
#include "platform/keys.h"

#include <cstdint>
#include <string>
#include <vector>

namespace Platform
{

/// Names a window among those that are or were open; 0 is none, and no number comes twice.
using windowId = std::uint32_t;

enum class eventKind
{
    pointerMove,  ///< at; several in a row may come as the last of them
    pointerDown,  ///< at, button, clicks
    pointerUp,    ///< at, button
    pointerLeave, ///< the pointer is over no window of ours, or another one
    wheel,        ///< at, wheelX, wheelY
    keyDown,      ///< pressed, character, repeat
    keyUp,        ///< pressed, character
    text,         ///< characters that were typed, after their keyDown
    expose,       ///< what was presented is lost
    resize,       ///< the window has its new size and scale already; its pixels are lost
    close,        ///< the user wants the window to go
    focusIn,
    focusOut,
    dropFiles,  ///< at, files: dragged here from another program and let go
    displayLost ///< the connection to the display has ended: nothing else will come
};

/// What the user or the display did. Only what the kind names is set, and the modifiers.
struct event
{
    eventKind kind = eventKind::pointerMove;
    windowId window = 0;
    point at = {};     ///< view units of the window; may lie outside while a button is held
    int button = 0;    ///< 1 left, 2 middle, 3 right
    int clicks = 1;    ///< 2 with the second press of a double click, and so on
    double wheelX = 0; ///< notches to the right
    double wheelY = 0; ///< notches away from the user
    key pressed = key::none;
    char32_t character = 0; ///< what the key alone writes, 27 for Escape and the like, 0 for keys such as F1
    bool repeat = false;    ///< sent again as the key is held
    std::uint32_t modifiers = 0;
    std::string text = {}; ///< UTF-8
    std::vector<std::string> files = {};
};

} // namespace Platform
