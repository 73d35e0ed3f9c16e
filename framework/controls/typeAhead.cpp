#include "framework/controls/typeAhead.h"

#include "framework/views/application.h"
#include "platform/utf8.h"

#include <algorithm>

namespace Sarnik
{
namespace
{

/// Enough for the scripts whose small letters lie a fixed step from the large ones.
char32_t lowerCase(char32_t c)
{
    const bool latin = (c >= U'A' && c <= U'Z') || (c >= 0xC0 && c <= 0xDE && c != 0xD7);
    const bool greekOrCyrillic = (c >= 0x391 && c <= 0x3A9) || (c >= 0x410 && c <= 0x42F);
    return latin || greekOrCyrillic ? c + 32 : c;
}

} // namespace

bool CTypeAhead::IsUnderWay() const
{
    return !word.empty() && CApplication::Now() - last < pause;
}

std::size_t CTypeAhead::Find(char32_t typed, std::size_t count, std::size_t current,
                             const std::function<std::string(std::size_t)> &textOf)
{
    if (!IsUnderWay())
        word.clear();
    last = CApplication::Now();
    word += lowerCase(typed);
    const bool repeated = word.find_first_not_of(word.front()) == std::u32string::npos;
    const std::u32string wanted = repeated ? word.substr(0, 1) : word;
    // A longer word may still be the current entry's.
    const std::size_t first = current == none ? 0 : repeated ? current + 1 : current;
    for (std::size_t i = 0; i < count; ++i)
    {
        const std::size_t at = (first + i) % count;
        std::u32string text = Platform::codePoints(textOf(at));
        std::transform(text.begin(), text.end(), text.begin(), lowerCase);
        if (text.starts_with(wanted))
            return at;
    }
    return none;
}

} // namespace Sarnik
