#pragma once

#include "framework/views/port.h"

#include <cstdint>

namespace Sarnik
{

/// What is drawn along the edge of a pane, as layouts write it.
enum EFrameStyle : std::int32_t
{
    kFrameEmpty = 0,
    kFramePrimaryGroup = 1,   ///< a panel with rounded corners
    kFrameSecondaryGroup = 2, ///< the same, its line alone
    kFrameSolidDark = 3,      ///< one line
    kFrameSolidGray = 4,
    kFrameSolidLight = 5,
    kFrameActiveBorder = 6, ///< a line in the accent colour
    kFrameDimBorder = 7,
    kFrameOut3D = 8, ///< raised
    kFrameIn3D = 9,
    kFrameScrollerWell = 10, ///< sunken, filled as a field
    kFrameEtched = 11,
    kFrameTargetRing = 12, ///< a ring where the focus lies within
    kFramePlacard = 13,    ///< a raised strip

    kDividerLeft = 50, ///< a line at one side
    kDividerTop = 51,
    kDividerRight = 52,
    kDividerBottom = 53,
    kDividerLeftRight = 54,
    kDividerTopBottom = 55,
    kDividerLeftUIB = 60, ///< the same, of two shades
    kDividerTopUIB = 61,
    kDividerRightUIB = 62,
    kDividerBottomUIB = 63
};

/// Draws a frame within a rectangle. `marked`: the focus lies within.
void drawFrame(CPort &port, const Platform::rectangle &place, EFrameStyle style, bool marked = false);

/// The style of a number in a layout; kFrameEmpty for one that is none.
EFrameStyle frameStyleOf(std::int32_t number);

} // namespace Sarnik
