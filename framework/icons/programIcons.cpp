#include "framework/icons/programIcons.h"

#include "framework/base/service.h"
#include "framework/icons/iconResources.h"

namespace Sarnik
{

CProgramIcons::CProgramIcons() : provider(&IconResource)
{
    CIconSource::SetCurrent(&pictures);
}

CProgramIcons::~CProgramIcons()
{
    if (CIconSource::Current() == &pictures)
        CIconSource::SetCurrent(nullptr);
}

CProgramIcons *CProgramIcons::Get(bool create)
{
    static CServiceT<CProgramIcons> service;
    return service.Get(create);
}

CIcon CProgramIcons::Icon(std::uint32_t id, double scale, std::uint32_t state)
{
    return pictures.Find(NameOf(id), scale, state);
}

ResourceConversionThunk::screenPicture CProgramIcons::OnScreen(std::uint32_t id, double scale)
{
    return pictures.OnScreen(NameOf(id), scale);
}

std::string CProgramIcons::NameOf(std::uint32_t id) const
{
    std::string name;
    provider.GetIconName(id, name);
    return name;
}

} // namespace Sarnik
