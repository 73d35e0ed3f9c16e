#pragma once

#include "shell/plugin/tintorelFilter.h"

#include <cstdint>
#include <memory>

namespace Sarnik
{

using CFilterFactory = std::unique_ptr<CTintorelFilter> (*)();

/// What EntryFI does: owns the one filter of a run from the first of Parameters, Prepare and Start until Finish or a
/// selector that fails, and serves the selectors. Each run ends in the same order: the filter, the services in the
/// reverse order of their first use, the heap's allocator.
///
/// *result is always written. A block that is missing or too short gets TNErrParameter, and nothing is touched. Nothing
/// is thrown. Main thread.
void DispatchSelector(CFilterFactory make, std::uint16_t selector, void *block, std::intptr_t *data,
                      std::int16_t *result) noexcept;

} // namespace Sarnik
