#pragma once

#include "platform/canvas/geometry.h"

namespace Sarnik
{

/// The colours of the interface: grey without a tint, so that they leave the eye's judgement of a photograph alone, and
/// one accent. Text on `window`, `panel`, `face`, `faceHot`, `field`, `menu` and the accents has a contrast of at
/// least 4.5:1.
struct CPalette
{
    Platform::colour window{83, 83, 83};
    Platform::colour panel{79, 79, 79}; ///< of what belongs together, on the window
    Platform::colour text{238, 238, 238};
    Platform::colour textDim{152, 152, 152}; ///< of what is disabled
    Platform::colour field{56, 56, 56};      ///< behind typed text, lists and progress
    Platform::colour menu{66, 66, 66};
    Platform::colour face{97, 97, 97}; ///< of a button
    Platform::colour faceHot{104, 104, 104};
    Platform::colour facePressed{66, 66, 66};
    Platform::colour edge{48, 48, 48}; ///< around fields and buttons
    Platform::colour edgeLight{116, 116, 116};
    Platform::colour groove{64, 64, 64};
    Platform::colour accent{34, 97, 175}; ///< chosen, selected, filled
    Platform::colour accentHot{42, 107, 189};
    Platform::colour accentPressed{26, 78, 145};
    Platform::colour accentLight{88, 152, 232}; ///< filled parts of thin lines
    Platform::colour ring{110, 172, 255};       ///< around what has the focus
    Platform::colour accentDim{104, 104, 112};  ///< selected in what has no focus
    Platform::colour tip{250, 247, 214};
    Platform::colour tipText{24, 24, 24};
};

} // namespace Sarnik
