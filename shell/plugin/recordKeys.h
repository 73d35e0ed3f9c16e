#pragma once

#include "shell/tintorel.h"

#include <cstdint>

/// The keys of a recorded run, in the order in which they are written (docs/files/recorded-run.md).
namespace Project
{

constexpr std::int32_t recordVersion = 5; ///< that of the collection's stream

constexpr std::uint32_t keyVersion = TN_CODE('a', 'c', 't', 'V');
constexpr std::uint32_t keyAutomatic = TN_CODE('a', 'u', 't', 'K');
constexpr std::uint32_t keyFullAutomatic = TN_CODE('f', 'u', 'l', 'A');
constexpr std::uint32_t keyHeight = TN_CODE('i', 'm', 'g', 'H');
constexpr std::uint32_t keyWidth = TN_CODE('i', 'm', 'g', 'W');
constexpr std::uint32_t keyTraceCount = TN_CODE('k', 'n', 'l', 'C');
constexpr std::uint32_t keyActiveCount = TN_CODE('a', 'p', 'p', 'K');
constexpr std::uint32_t keyParameters = TN_CODE('s', 'e', 't', 'S');
constexpr std::uint32_t keyFineResult = TN_CODE('f', 'R', 'e', 't');
constexpr std::uint32_t keyTraces = TN_CODE('k', 'n', 'l', 'M');

} // namespace Project
