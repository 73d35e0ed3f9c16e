#pragma once

#include "shell/tintorel.h"

#include <cstdint>
#include <optional>

namespace Sarnik
{

/// The host's properties. A host without a table knows none. Main thread.
class CHostProperties
{
public:
    CHostProperties() = default;
    explicit CHostProperties(const TNPropertyProcs *table, const TNHandleProcs *handleTable)
        : procs(table), handles(handleTable)
    {
    }

    /// None where the host does not know the key, or answers with a text.
    std::optional<std::intptr_t> Number(std::uint32_t key, std::uint32_t signature = TN_PROPERTY_SIGNATURE) const;
    /// False where the host does not take it.
    bool Set(std::uint32_t key, std::intptr_t number) const;

private:
    const TNPropertyProcs *procs = nullptr;
    const TNHandleProcs *handles = nullptr;
};

/// The number that the thread limit comes from: signature and key of another of the host's property groups.
constexpr std::uint32_t threadLimitSignature = TN_CODE('T', 'N', 'X', 'M');
constexpr std::uint32_t threadLimitKey = TN_CODE('c', 'o', 'r', 'e');

} // namespace Sarnik
