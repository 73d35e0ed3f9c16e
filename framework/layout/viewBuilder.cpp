#include "framework/layout/viewBuilder.h"

namespace Sarnik
{

CViewBuilderMap &CViewBuilderMap::Global()
{
    static CViewBuilderMap map;
    return map;
}

void CViewBuilderMap::Enter(const CViewBuilderBase &builder)
{
    builders.erase(builder.ClassName()); // the key is a view of the builder's own name
    builders.emplace(builder.ClassName(), &builder);
}

const CViewBuilderBase *CViewBuilderMap::Find(std::string_view className) const
{
    const auto found = builders.find(className);
    return found == builders.end() ? nullptr : found->second;
}

} // namespace Sarnik
