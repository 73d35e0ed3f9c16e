#pragma once

#include "host/plugin/handleTable.h"
#include "host/plugin/hostOptions.h"
#include "host/plugin/runState.h"
#include "shell/tintorel.h"

#include <cstdint>
#include <map>
#include <utility>

namespace Stillmark
{

/// The number that a plug-in may ask for the most threads that it is to use, beside those of TN_PROPERTY_SIGNATURE.
constexpr std::uint32_t threadsSignature = TN_CODE('T', 'N', 'X', 'M');
constexpr std::uint32_t threadsKey = TN_CODE('c', 'o', 'r', 'e');

/// The host's properties in one run.
class propertyTable
{
public:
    propertyTable(runState &run, handleTable &hostMemory, const hostOptions &options);
    propertyTable(const propertyTable &) = delete;
    propertyTable &operator=(const propertyTable &) = delete;

    const TNPropertyProcs *procs() const { return &table; }

private:
    TNError get(std::uint32_t signature, std::uint32_t key, std::intptr_t *number, TNHandle *text);
    TNError set(std::uint32_t signature, std::uint32_t key);

    runState &state;
    handleTable &handles;
    TNPropertyProcs table;
    std::map<std::pair<std::uint32_t, std::uint32_t>, std::intptr_t> numbers; ///< by signature and key
};

} // namespace Stillmark
