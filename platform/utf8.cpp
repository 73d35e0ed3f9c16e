#include "platform/utf8.h"

#include <algorithm>

namespace Platform
{
namespace
{

constexpr char32_t replacement = 0xFFFD;

/// All bytes of a character but its first.
bool isTail(char byte)
{
    return (static_cast<unsigned char>(byte) & 0xC0) == 0x80;
}

} // namespace

std::size_t characterLength(std::string_view utf8)
{
    const auto byte = [&](std::size_t i) { return static_cast<unsigned char>(utf8[i]); };
    const unsigned lead = byte(0);
    if (lead == 0)
        return 0;
    if (lead < 0x80)
        return 1;
    const std::size_t length = lead > 0xF4 ? 0 : lead >= 0xF0 ? 4 : lead >= 0xE0 ? 3 : lead >= 0xC2 ? 2 : 0;
    if (length == 0 || utf8.size() < length)
        return 0;
    for (std::size_t i = 1; i < length; ++i)
        if (!isTail(utf8[i]))
            return 0;
    // Longer forms than needed, surrogates, and what lies above U+10FFFF.
    const unsigned second = byte(1);
    if ((lead == 0xE0 && second < 0xA0) || (lead == 0xED && second > 0x9F) || (lead == 0xF0 && second < 0x90) ||
        (lead == 0xF4 && second > 0x8F))
        return 0;
    return length;
}

std::size_t characterCount(std::string_view utf8)
{
    return utf8.size() - static_cast<std::size_t>(std::count_if(utf8.begin(), utf8.end(), isTail));
}

std::size_t bytesOfCharacters(std::string_view utf8, std::size_t count)
{
    std::size_t at = 0;
    for (; at < utf8.size() && (count > 0 || isTail(utf8[at])); ++at)
        if (!isTail(utf8[at]))
            --count;
    return at;
}

std::size_t characterStart(std::string_view utf8, std::size_t offset)
{
    offset = std::min(offset, utf8.size());
    while (offset > 0 && offset < utf8.size() && isTail(utf8[offset]))
        --offset;
    return offset;
}

std::u32string codePoints(std::string_view utf8)
{
    std::u32string result;
    while (!utf8.empty())
    {
        const std::size_t length = characterLength(utf8);
        constexpr unsigned char leadBits[] = {0, 0x7F, 0x1F, 0x0F, 0x07};
        char32_t c = length == 0 ? replacement : static_cast<unsigned char>(utf8[0]) & leadBits[length];
        for (std::size_t i = 1; i < length; ++i)
            c = c << 6 | (static_cast<unsigned char>(utf8[i]) & 0x3F);
        result += c;
        utf8.remove_prefix(std::max<std::size_t>(1, length));
    }
    return result;
}

std::string utf8Of(char32_t c)
{
    if (c == 0 || c > 0x10FFFF || (c >= 0xD800 && c < 0xE000))
        c = replacement;
    const auto tail = [&](int shift) { return static_cast<char>(0x80 | (c >> shift & 0x3F)); };
    if (c < 0x80)
        return {static_cast<char>(c)};
    if (c < 0x800)
        return {static_cast<char>(0xC0 | c >> 6), tail(0)};
    if (c < 0x10000)
        return {static_cast<char>(0xE0 | c >> 12), tail(6), tail(0)};
    return {static_cast<char>(0xF0 | c >> 18), tail(12), tail(6), tail(0)};
}

std::string cleanText(std::string_view utf8)
{
    std::string clean;
    clean.reserve(utf8.size());
    while (!utf8.empty())
    {
        const std::size_t length = characterLength(utf8);
        if (length == 0)
            clean += utf8Of(replacement);
        else
            clean.append(utf8, 0, length);
        utf8.remove_prefix(std::max<std::size_t>(1, length));
    }
    return clean;
}

} // namespace Platform
