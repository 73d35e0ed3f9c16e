#pragma once

#include <cstdint>

namespace Sarnik
{

/// What a button does, as layouts write it.
enum EButtonKind : std::int32_t
{
    kPushButton = 0,    ///< acts once when it is pressed
    kCheckButton = 1,   ///< goes on and off
    kRadioButton = 2,   ///< one of a group is on
    kCTAGroupButton = 3 ///< acts as a push button
};

/// What a button looks like, as layouts write it.
enum EButtonStyle : std::int32_t
{
    kButtonStyle_Default = 0, ///< as the class has it
    kButtonStyle_Bevel = 1,   ///< a raised face around the content
    kButtonStyle_Push = 2,
    kButtonStyle_Check = 3, ///< a box with a mark, and the content to the right of it
    kButtonStyle_Radio = 4, ///< a circle with a dot
    kButtonStyle_Round = 5, ///< a round face
    kButtonStyle_SmallCheck = 6,
    kButtonStyle_SmallRadio = 7,
    kButtonStyle_SmallRound = 8,
    kButtonStyle_Disclosure = 9, ///< an arrow to the right, downwards when on
    kButtonStyle_Tool = 10,      ///< flat: a face only under the pointer and when on
    kButtonStyle_None = 11       ///< the content alone
};

} // namespace Sarnik
