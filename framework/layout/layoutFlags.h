#pragma once

#include "framework/layout/wyraProperty.h"

#include <cstdint>
#include <string_view>

namespace Sarnik
{

/// A word of flags of a view: its property `word`, `otherwise` if nothing has it, with single bits set or cleared by
/// their boolean properties. `view_options: kView_DrawParts, view_target: true` gives both bits.
///
/// The words are view_options, window_features, text_options, static_options, list_options, radio_options,
/// number_format, scroller_attributes, and angle_slider, which has boolean properties only. Another word has no boolean
/// properties.
std::int32_t ReadFlags(const CWyraVariablePropertyList &properties, std::string_view word, std::int32_t otherwise = 0);

} // namespace Sarnik
