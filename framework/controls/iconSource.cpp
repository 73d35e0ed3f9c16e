#include "framework/controls/iconSource.h"

namespace Sarnik
{
namespace
{

CIconSource *current = nullptr;

} // namespace

CIconSource *CIconSource::Current() noexcept
{
    return current;
}

void CIconSource::SetCurrent(CIconSource *source) noexcept
{
    current = source;
}

CIcon CIconSource::Icon(std::string_view name, double scale, std::uint32_t state)
{
    return current == nullptr || name.empty() ? CIcon{} : current->Find(name, scale, state);
}

} // namespace Sarnik
