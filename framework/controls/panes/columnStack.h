#pragma once

#include "framework/views/context.h"

#include <cstdint>

namespace Sarnik
{

/// Stacks the visible children of a column one below the other in their order, from the top of the first child's frame
/// at its first layout (`top`), each `spacing` units below the one before. A child whose binding makes it grow in
/// height (kBind_YSizeable) shares the room that the others leave down to the column's bottom less `top`; all others
/// keep their heights. Lefts and widths stay.
void stackColumn(CContext &column, std::int32_t top, std::int32_t spacing);

} // namespace Sarnik
