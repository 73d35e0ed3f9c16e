#pragma once

#include "framework/controls/iconSource.h"
#include "framework/controls/palette.h"
#include "framework/layout/viewBuilder.h"
#include "framework/pixels/rect.h"
#include "framework/views/port.h"
#include "platform/canvas/text.h"

#include <cstdint>
#include <string_view>

namespace Sarnik
{

/// Fonts as layouts number them: five sizes, each plain, bold, italic, and bold italic.
enum EFont : std::int32_t
{
    kFont_System = 0,
    kFont_Application = 1,
    kFont_UI = 2,
    kFont_UILarge = 6,
    kFont_UIMedium = 10,
    kFont_UIMediumBold = 11,
    kFont_UISmall = 14,
    kFont_UIMicro = 18
};

/// Where a text goes within its room. Values are those of kAlign_... in layouts.
enum EAlign : std::int32_t
{
    kAlign_Default = 0, ///< left, and in the middle of the height
    kAlign_Near = 1,    ///< left, top
    kAlign_Center = 2,
    kAlign_Far = 3, ///< right, bottom
    kAlign_Full = 4
};

/// How a face is drawn.
enum class EFace
{
    normal,
    hot, ///< the pointer is over it
    pressed,
    disabled
};

/// The one look of all controls. What lies on whole view units is drawn on whole pixels at scale 1 and 2. Interface
/// thread.
class CDrawTools
{
public:
    /// Between the frame of a control and what is drawn in it, room for the focus ring.
    static constexpr std::int32_t ringRoom = 2;
    static constexpr double corner = 3;

    static const CPalette &Colours();
    /// A number that is none gives kFont_UI.
    static Platform::font Font(std::int32_t number);

    /// A "&" marks the next letter as the access key; "&&" is one "&".
    struct label
    {
        std::string text;               ///< without the marks
        std::ptrdiff_t underlined = -1; ///< byte offset of the key in `text`; -1 for none
        char32_t key = 0;               ///< lower case; 0 for none
    };
    static label SplitLabel(std::string_view localisedText);

    /// Text of one line, trimmed at its end where the room is too small.
    static void Text(CPort &port, const Platform::rectangle &room, const label &text, const Platform::font &font,
                     Platform::colour ink, EAlign x = kAlign_Near, EAlign y = kAlign_Center,
                     Platform::textTrim trim = Platform::textTrim::end);
    static void Text(CPort &port, const Platform::rectangle &room, std::string_view text, const Platform::font &font,
                     Platform::colour ink, EAlign x = kAlign_Near, EAlign y = kAlign_Center,
                     Platform::textTrim trim = Platform::textTrim::end);
    /// A text block in a room.
    static void Text(CPort &port, const Platform::rectangle &room, const Platform::textBlock &block,
                     Platform::colour ink, EAlign x, EAlign y);

    /// A raised surface with rounded corners; `prominent` in the accent colour.
    static void Face(CPort &port, const Platform::rectangle &r, EFace state, bool prominent = false,
                     double radius = corner);
    /// A picture in a room, in the middle of its height, on whole pixels; `strength` from 0 to 1.
    static void Icon(CPort &port, const Platform::rectangle &room, const CIcon &icon, EAlign x = kAlign_Center,
                     double strength = 1);
    /// A sunken surface for text and lists.
    static void Field(CPort &port, const Platform::rectangle &r, bool enabled, bool hot = false);
    /// Around r, outside of it, within ringRoom.
    static void FocusRing(CPort &port, const Platform::rectangle &r, double radius = corner);
    /// A line, one pixel wide at every scale.
    static void Line(CPort &port, Platform::point from, Platform::point to, Platform::colour ink);
    static void CheckMark(CPort &port, const Platform::rectangle &r, Platform::colour ink);
    enum class direction
    {
        left,
        right,
        up,
        down
    };
    /// A chevron in the middle of r.
    static void Chevron(CPort &port, const Platform::rectangle &r, direction to, Platform::colour ink);
};

/// Sizes of texts for the layout language, in the fonts of CDrawTools; "&" marks count as in labels.
class CDrawMeasure final : public CTextMeasure
{
public:
    CLayoutSize Measure(std::string_view text, std::int32_t font) const override;
};

} // namespace Sarnik
