#pragma once

#include "shell/tintorel.h"

#include <array>
#include <cstddef>

namespace Sarnik
{

/// One acquired suite, released with the object. Empty where the host has not got it. The host outlives it.
class CSuiteHold
{
public:
    CSuiteHold() = default;
    CSuiteHold(const TNSuiteProcs *host, const char *suiteName, int suiteVersion);
    CSuiteHold(CSuiteHold &&other) noexcept { Swap(other); }
    CSuiteHold &operator=(CSuiteHold &&other) noexcept
    {
        CSuiteHold(static_cast<CSuiteHold &&>(other)).Swap(*this);
        return *this;
    }
    ~CSuiteHold() { Release(); }

    explicit operator bool() const { return table != nullptr; }
    template <class Suite> const Suite *As() const { return static_cast<const Suite *>(table); }
    void Release() noexcept;

private:
    void Swap(CSuiteHold &other) noexcept;

    const TNSuiteProcs *procs = nullptr;
    const char *name = nullptr;
    int version = 0;
    const void *table = nullptr;
};

/// The suites that a plug-in keeps while it lives: each is acquired when it is first asked for (and asked for again
/// while the host refuses it), and all are released together in one fixed order.
class CHostSuites
{
public:
    CHostSuites() = default;
    CHostSuites(const CHostSuites &) = delete;
    CHostSuites &operator=(const CHostSuites &) = delete;
    ~CHostSuites() { ReleaseAll(); }

    /// Where suites come from, from now on; null: from nowhere.
    void SetHost(const TNSuiteProcs *procs) { host = procs; }
    const TNSuiteProcs *Host() const { return host; }

    /// Null where the host has none.
    const TNChannelPortsSuite *ChannelPorts();
    const TNDescriptorSuite *Descriptors();

    void ReleaseAll() noexcept;

private:
    const CSuiteHold &Hold(std::size_t slot);

    static constexpr std::size_t slots = 20;
    const TNSuiteProcs *host = nullptr;
    std::array<CSuiteHold, slots> held;
};

} // namespace Sarnik
