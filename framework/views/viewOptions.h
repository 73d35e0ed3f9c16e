#pragma once

#include <cstdint>

namespace Sarnik
{

/// Bits of a view's options, as layouts write them.
enum EViewOptions : std::uint32_t
{
    kView_NoOptions = 0,
    kView_Invisible = 1,
    kView_Disabled = 2,
    kView_Target = 4, ///< takes the focus
    kView_Bullseye = 8,
    kView_TabStop = 16, ///< the tab key stops here
    kView_TargetRing = 32,
    kView_ContextClick = 64,       ///< is asked about clicks of the other button
    kView_InvalidOnActivate = 128, ///< looks different in an active window
    kView_DrawBuffer = 256,
    kView_DrawParts = 512, ///< draws by damaged rectangles instead of one around them
    kView_ChunkyScroll = 1024,
    kView_EntireScroll = 2048,
    kView_BigCoordinates = 4096,
    kView_IgnoreMouseEvents = 8192, ///< the pointer finds what lies behind
    kView_MultiOnMouseUp = 16384,
    kView_NoFocusOnClick = 32768,
    kView_NoTabNavigate = 0x10000, ///< the tab key passes by, its children included
    kView_SupressSurrenders = 0x20000
};

/// Bits that tell how a view follows the size of its parent (bindFrame), and how a scroller treats it.
enum EViewBinding : std::uint32_t
{
    kBind_Fixed = 0,
    kBind_XSizeable = 1,
    kBind_YSizeable = 2,
    kBind_XCenter = 4,
    kBind_YCenter = 8,
    kBind_Left = 16,
    kBind_Top = 32,
    kBind_Right = 64,
    kBind_Bottom = 128
};

} // namespace Sarnik
