#include "framework/layout/layoutResources.h"

#include "framework/base/exceptions.h"

#include <algorithm>
#include <string>

namespace Sarnik
{

std::string_view LayoutResource(std::string_view name)
{
    const auto all = LayoutResources();
    const auto found =
        std::find_if(all.begin(), all.end(), [name](const auto &resource) { return resource.name == name; });
    if (found == all.end())
        throw CError("There is no layout resource \"" + std::string(name) + "\".");
    return found->text;
}

} // namespace Sarnik
