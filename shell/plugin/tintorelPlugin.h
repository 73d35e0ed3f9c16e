#pragma once

#include "framework/base/process.h"
#include "shell/plugin/hostProperties.h"
#include "shell/plugin/hostSuites.h"

#include <cstdint>

namespace Sarnik
{

/// What any plug-in of the host needs: its suites and properties, and how the host's windows look. At most one is
/// current: the one built last, none once that has gone. Main thread, Current() excepted.
class CTintorelPlugin : public CProcess
{
public:
    CTintorelPlugin();
    ~CTintorelPlugin() override;

    static CTintorelPlugin *Current() noexcept;

    /// Takes the host's tables, which may be null. They stay good until the plug-in is gone.
    void SetHost(const TNPropertyProcs *properties, const TNSuiteProcs *suites, const TNHandleProcs *handles);

    const CHostProperties &Properties() const { return properties; }
    CHostSuites &Suites() { return suites; }
    const TNHandleProcs *Handles() const { return handles; }

    /// How the host draws its windows; for the framework's own drawing.
    struct hostLook
    {
        int density = 0;              ///< 0, 1, 2: the high-density scale mode
        std::uint32_t brightness = 2; ///< 0, the darkest, to 3
        bool colouredHighlight = false;
        bool lightTitles = false;
        bool scaleWindows = false;
    };
    const hostLook &Look() const { return look; }
    /// Reads all of it but scaleWindows. Once per plug-in.
    void ReadHostLook();
    void ReadWindowScale();

protected:
    /// Bits of pluginFlags.
    static constexpr std::uint32_t flagFilterBlock = 1u << 3, flagAbout = 1u << 5;
    std::uint32_t pluginFlags = 0;

private:
    CHostProperties properties;
    const TNHandleProcs *handles = nullptr;
    CHostSuites suites;
    hostLook look;
    bool densitySet = false;
};

} // namespace Sarnik
