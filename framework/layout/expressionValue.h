#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

namespace Sarnik
{

/// The integer of whatever has none: a name that was never defined, most strings, a division by zero.
constexpr std::int32_t undefinedInteger = INT32_MIN;

/// What an expression of a layout gives: an integer and, for strings, a text. A text lives as long as the layout that
/// it was read from.
struct CExpressionValue
{
    std::int32_t integer = undefinedInteger;
    std::optional<std::string_view> text;

    bool Defined() const { return integer != undefinedInteger; }

    /// A string. One of exactly four characters is a four-character code too: its bytes, the first one highest.
    static CExpressionValue OfText(std::string_view text)
    {
        CExpressionValue value;
        value.text = text;
        if (text.size() == 4)
        {
            std::uint32_t code = 0;
            for (const char c : text)
                code = code << 8 | static_cast<unsigned char>(c);
            value.integer = static_cast<std::int32_t>(code);
        }
        return value;
    }
};

} // namespace Sarnik
