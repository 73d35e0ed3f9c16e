#include "framework/base/localisedString.h"

#include "framework/base/stringTable.h"
#include "platform/utf8.h"

#include <algorithm>
#include <optional>
#include <utility>

namespace Sarnik
{
namespace
{

struct sequence
{
    char sign;
    std::string_view text;
};

// clang-format off
constexpr sequence sequences[] = {
    {'!', "\u00AC"}, {'"', "\""}, {'U', "\""}, {'#', "\u2318"}, {'*', "*"}, {'A', "'"}, {'B', "\u2022"},
    {'C', "\u00A9"}, {'D', "\u00B0"}, {'E', "\u00EA"}, {'F', "/"}, {'I', "\u2206"}, {'L', "\\"}, {'l', "\\"},
    {'N', "\r\n"}, {'O', "Control"}, {'o', "control"}, {'P', "Alt"}, {'p', "alt"}, {'Q', "?"}, {'R', "\u00AE"},
    {'S', "\u2211"}, {'T', "\u2122"}, {'V', "|"}, {'[', "\u201C"}, {']', "\u201D"}, {'^', "^"}, {'`', "`"},
    {'b', "\b"}, {'e', "\u00E9"}, {'n', "\n"}, {'r', "\r"}, {'t', "\t"}, {'{', "\u2018"}, {'}', "\u2019"},
};
// clang-format on

/// The unit of "^+20AC" at the front of a text.
std::optional<char32_t> unitOf(std::string_view text)
{
    if (text.size() < 6 || !text.starts_with("^+"))
        return std::nullopt;
    char32_t unit = 0;
    for (const char c : text.substr(2, 4))
    {
        const int digit = c >= '0' && c <= '9'   ? c - '0'
                          : c >= 'a' && c <= 'f' ? c - 'a' + 10
                          : c >= 'A' && c <= 'F' ? c - 'A' + 10
                                                 : -1;
        if (digit < 0)
            return std::nullopt;
        unit = unit * 16 + static_cast<char32_t>(digit);
    }
    return unit;
}

/// What stands for the unit at the front, which a second one may complete, and how many bytes of the text that takes.
std::pair<std::string, std::size_t> character(std::string_view text, char32_t unit)
{
    if (unit < 0xD800 || unit > 0xDFFF)
        return {Platform::utf8Of(unit), 6};
    if (const auto second = unitOf(text.substr(6)); unit < 0xDC00 && second && *second >= 0xDC00 && *second <= 0xDFFF)
        return {Platform::utf8Of(0x10000 + ((unit - 0xD800) << 10) + (*second - 0xDC00)), 12};
    return {Platform::utf8Of(0xFFFD), 6};
}

bool isPlace(std::string_view text, std::size_t at)
{
    return text[at] == '^' && at + 1 < text.size() && text[at + 1] >= '0' && text[at + 1] <= '9';
}

enum class controls
{
    plain,
    translated
};

/// Places and sequences in one pass, so that neither finds what the other has put in.
std::string filled(std::string_view text, controls how, std::initializer_list<std::string_view> parameters)
{
    std::string result;
    for (std::size_t i = 0; i < text.size();)
    {
        if (text[i] != '^' || i + 1 == text.size())
        {
            result += text[i++];
            continue;
        }
        const std::string_view rest = text.substr(i);
        if (const auto number = static_cast<std::size_t>(rest[1] - '0'); isPlace(text, i) && number < parameters.size())
        {
            result += parameters.begin()[number];
            i += 2;
            continue;
        }
        if (const auto unit = unitOf(rest); unit && how == controls::translated)
        {
            const auto [letter, bytes] = character(rest, *unit);
            result += letter;
            i += bytes;
            continue;
        }
        const auto known = std::find_if(std::begin(sequences), std::end(sequences),
                                        [&](const sequence &s) { return s.sign == rest[1]; });
        if (known == std::end(sequences) || how == controls::plain)
        {
            result += text[i++];
            continue;
        }
        result += known->text;
        i += 2;
    }
    return result;
}

} // namespace

std::string Localize(std::string_view keyAndText)
{
    return Localize(keyAndText, {});
}

std::string Localize(std::string_view keyAndText, std::initializer_list<std::string_view> parameters)
{
    if (!keyAndText.starts_with("$$$"))
        return filled(keyAndText, controls::plain, parameters);
    const std::size_t equals = std::min(keyAndText.find('='), keyAndText.size());
    const std::string *const own = CStringTable::Global().Find(keyAndText.substr(0, equals));
    const std::string_view otherwise = keyAndText.substr(std::min(equals + 1, keyAndText.size()));
    return filled(own != nullptr ? std::string_view(*own) : otherwise, controls::translated, parameters);
}

void ReplaceParam(std::string &text, int index, std::string_view value)
{
    std::string result;
    for (std::size_t i = 0; i < text.size(); ++i)
        if (isPlace(text, i) && text[i + 1] - '0' == index)
        {
            result += value;
            ++i;
        }
        else
            result += text[i];
    text = std::move(result);
}

} // namespace Sarnik
