#pragma once

namespace Sarnik
{

/// Sees to it that the builders of all controls are among the program's (CViewBuilderMap::Global): they stand in a
/// library, from which a linker takes only what somebody names.
void enterControlBuilders();

} // namespace Sarnik
