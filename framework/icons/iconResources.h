#pragma once

#include <cstddef>
#include <span>
#include <string_view>

namespace Sarnik
{

/// The program's own index and stores, as they were built from resources/icons, by the keys of CResourceDataProvider.
/// Empty for another key.
std::span<const std::byte> IconResource(std::string_view key);

} // namespace Sarnik
