#pragma once

#include <cstdint>
#include <functional>

namespace Sarnik
{

/// Does the work of a selector and answers with its result word: 0 where it returns true, 1 where it returns false.
/// Whatever it throws ends here: a host's error code becomes the result, for the host to report; everything else is
/// reported to the user and gives 1.
std::int16_t resultOf(const std::function<bool()> &work) noexcept;

} // namespace Sarnik
