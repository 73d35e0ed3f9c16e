#include "shell/plugin/tintorelPlugin.h"

#include <atomic>

namespace Sarnik
{
namespace
{

std::atomic<CTintorelPlugin *> current{nullptr};

} // namespace

CTintorelPlugin::CTintorelPlugin()
{
    current = this;
}

CTintorelPlugin::~CTintorelPlugin()
{
    current = nullptr;
}

CTintorelPlugin *CTintorelPlugin::Current() noexcept
{
    return current;
}

void CTintorelPlugin::SetHost(const TNPropertyProcs *propertyTable, const TNSuiteProcs *suiteTable,
                              const TNHandleProcs *handleTable)
{
    properties = CHostProperties(propertyTable, handleTable);
    suites.SetHost(suiteTable);
    handles = handleTable;
}

void CTintorelPlugin::ReadHostLook()
{
    if (!densitySet)
    {
        const std::intptr_t density = properties.Number(TN_PROPERTY_HIGH_DENSITY).value_or(0);
        look.density = density >= 0 && density <= 2 ? static_cast<int>(density) : 0;
        densitySet = true;
    }
    const std::intptr_t brightness = properties.Number(TN_PROPERTY_BRIGHTNESS).value_or(2);
    look.brightness = brightness >= 0 && brightness <= 3 ? static_cast<std::uint32_t>(brightness) : 2;
    look.colouredHighlight = properties.Number(TN_PROPERTY_HIGHLIGHT) == 2;
    look.lightTitles = properties.Number(TN_PROPERTY_LIGHT_TEXT) == 1;
}

void CTintorelPlugin::ReadWindowScale()
{
    if (properties.Number(TN_PROPERTY_WINDOW_SCALE).value_or(0) != 0)
        look.scaleWindows = true;
}

} // namespace Sarnik
