#include "platform/json.h"

#include <array>
#include <charconv>
#include <cmath>
#include <cstdint>

namespace Platform
{
namespace
{

/// Length of the UTF-8 sequence at the beginning of text, 0 if there is none (RFC 3629: shortest form, no surrogates,
/// up to U+10FFFF).
std::size_t sequenceLength(std::string_view text)
{
    const auto byte = [&](std::size_t i) { return i < text.size() ? static_cast<std::uint8_t>(text[i]) : 0u; };
    const auto follows = [&](std::size_t i, unsigned low = 0x80, unsigned high = 0xbf) {
        return byte(i) >= low && byte(i) <= high;
    };
    const unsigned lead = byte(0);
    if (lead < 0x80)
        return 1;
    if (lead >= 0xc2 && lead <= 0xdf)
        return follows(1) ? 2 : 0;
    if (lead >= 0xe0 && lead <= 0xef)
        return follows(1, lead == 0xe0 ? 0xa0 : 0x80, lead == 0xed ? 0x9f : 0xbf) && follows(2) ? 3 : 0;
    if (lead >= 0xf0 && lead <= 0xf4)
        return follows(1, lead == 0xf0 ? 0x90 : 0x80, lead == 0xf4 ? 0x8f : 0xbf) && follows(2) && follows(3) ? 4 : 0;
    return 0;
}

template <typename Number> std::string shortest(Number value)
{
    std::array<char, 40> text{};
    return {text.data(), std::to_chars(text.data(), text.data() + text.size(), value).ptr};
}

} // namespace

std::string jsonString(std::string_view text)
{
    constexpr const char *digits = "0123456789abcdef";
    std::string out = "\"";
    while (!text.empty())
    {
        const std::size_t length = sequenceLength(text);
        const auto first = static_cast<std::uint8_t>(text.front());
        if (length == 0)
            out += "\xef\xbf\xbd";
        else if (first == '"' || first == '\\')
            (out += '\\') += static_cast<char>(first);
        else if (first < 0x20 || first == 0x7f)
            ((out += "\\u00") += digits[first >> 4]) += digits[first & 15];
        else
            out += text.substr(0, length);
        text.remove_prefix(length == 0 ? 1 : length);
    }
    return out + '"';
}

std::string jsonNumber(double value)
{
    return std::isfinite(value) ? shortest(value) : "null";
}

std::string jsonNumber(float value)
{
    return std::isfinite(value) ? shortest(value) : "null";
}

std::string jsonBool(bool value)
{
    return value ? "true" : "false";
}

std::string jsonArray(const std::vector<std::string> &values)
{
    std::string out;
    for (const std::string &value : values)
        out += (out.empty() ? "" : ", ") + value;
    return "[" + out + "]";
}

std::string jsonObject(std::initializer_list<std::pair<std::string_view, std::string>> members)
{
    std::string out;
    for (const auto &[key, value] : members)
        out += (out.empty() ? "" : ", ") + jsonString(key) + ": " + value;
    return "{" + out + "}";
}

} // namespace Platform
