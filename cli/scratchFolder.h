#pragma once

#include <string>

namespace Stillmark
{

/// The folder for tables that are kept from one run to the next: stillmark in $XDG_CACHE_HOME or in ~/.cache, made if
/// missing. Empty if there is none; then nothing is kept.
std::string scratchFolder();

} // namespace Stillmark
