#pragma once

#include <cstdint>

namespace Platform
{

/// Bytes of memory that the machine has; 0 when the system does not tell.
std::uint64_t physicalMemory();

} // namespace Platform
