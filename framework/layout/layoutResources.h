#pragma once

#include <span>
#include <string_view>

namespace Sarnik
{

/// A layout text of resources/, as it was when the program was built.
struct CLayoutResource
{
    std::string_view name; ///< with its ".wyra"
    std::string_view text;
};

std::span<const CLayoutResource> LayoutResources();

/// The text of that name. Throws CError if there is none.
std::string_view LayoutResource(std::string_view name);

} // namespace Sarnik
