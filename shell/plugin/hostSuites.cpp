#include "shell/plugin/hostSuites.h"

#include <utility>

namespace Sarnik
{
namespace
{

struct suiteName
{
    const char *name;
    int version;
};

/// In the order of release.
constexpr suiteName suiteTable[] = {
    {TN_CHANNEL_PORTS_SUITE, 3},
    {TN_DIRECT_VIEW_SUITE, 3},
    {TN_UTILITIES_SUITE, 1},
    {TN_PALETTE_SUITE, 1},
    {TN_STRING_SUITE, 1},
    {TN_UNICODE_STRING_SUITE, 1},
    {TN_UI_HOOKS_SUITE, 1},
    {TN_UI_HOOKS_SUITE, 2},
    {TN_UI_HOOKS_SUITE, 3},
    {TN_UI_HOOKS_SUITE, 4},
    {TN_MOUSE_TRACKING_SUITE, 3},
    {TN_MOUSE_TRACKING_SUITE, 4},
    {TN_HELP_SUITE, 1},
    {TN_FEATURE_SUITE, 1},
    {TN_HELP_SUITE, 2},
    {TN_BUFFER_SUITE, 1},
    {TN_BASIC_SCRIPTING_SUITE, 3},
    {TN_REFERENCE_SUITE, 3},
    {TN_DESCRIPTOR_SUITE, 5},
    {TN_DESCRIPTOR_REGISTRY_SUITE, 3},
};

constexpr std::size_t channelPortsSlot = 0, descriptorSlot = 18;

} // namespace

CSuiteHold::CSuiteHold(const TNSuiteProcs *host, const char *suiteName, int suiteVersion)
    : procs(host), name(suiteName), version(suiteVersion)
{
    if (procs == nullptr || procs->acquire == nullptr)
        return;
    const void *found = nullptr;
    if (procs->acquire(procs->context, name, version, &found) != TNNoError)
        return;
    table = found;
    if (table == nullptr && procs->release != nullptr)
        procs->release(procs->context, name, version); // acquired, but of no use
}

void CSuiteHold::Release() noexcept
{
    if (std::exchange(table, nullptr) != nullptr && procs->release != nullptr)
        procs->release(procs->context, name, version);
}

void CSuiteHold::Swap(CSuiteHold &other) noexcept
{
    std::swap(procs, other.procs);
    std::swap(name, other.name);
    std::swap(version, other.version);
    std::swap(table, other.table);
}

const CSuiteHold &CHostSuites::Hold(std::size_t slot)
{
    static_assert(std::size(suiteTable) == slots);
    if (!held[slot])
        held[slot] = CSuiteHold(host, suiteTable[slot].name, suiteTable[slot].version);
    return held[slot];
}

const TNChannelPortsSuite *CHostSuites::ChannelPorts()
{
    return Hold(channelPortsSlot).As<TNChannelPortsSuite>();
}

const TNDescriptorSuite *CHostSuites::Descriptors()
{
    return Hold(descriptorSlot).As<TNDescriptorSuite>();
}

void CHostSuites::ReleaseAll() noexcept
{
    for (CSuiteHold &hold : held)
        hold.Release();
}

} // namespace Sarnik
