#pragma once

#include <algorithm>
#include <cstdint>
#include <optional>
#include <string_view>

namespace Project
{

/// The white space of the C locale.
constexpr std::string_view kBlanks = " \t\n\v\f\r";

/// The decimal number that text begins with, after blanks and a sign; nothing without a digit. Numbers beyond the range
/// stop at its ends.
inline std::optional<std::int32_t> ScanNumber(std::string_view text)
{
    std::size_t at = std::min(text.find_first_not_of(kBlanks), text.size());
    const bool negative = at < text.size() && text[at] == '-';
    if (at < text.size() && (text[at] == '-' || text[at] == '+'))
        ++at;

    const std::size_t digits = at;
    std::int64_t value = 0;
    for (; at < text.size() && text[at] >= '0' && text[at] <= '9'; ++at)
        if (value <= INT32_MAX)
            value = value * 10 + (text[at] - '0');
    if (at == digits)
        return std::nullopt;
    if (negative)
        value = -value;
    return static_cast<std::int32_t>(value > INT32_MAX ? INT32_MAX : value < INT32_MIN ? INT32_MIN : value);
}

} // namespace Project
