#include "framework/base/localisedString.h"

namespace Sarnik
{

std::string localised(std::string_view keyAndText)
{
    if (!keyAndText.starts_with("$$$/"))
        return std::string(keyAndText);
    const std::size_t equals = keyAndText.find('=');
    return equals == std::string_view::npos ? std::string() : std::string(keyAndText.substr(equals + 1));
}

std::string localised(std::string_view keyAndText, std::initializer_list<std::string_view> parameters)
{
    const std::string text = localised(keyAndText);
    std::string filled;
    for (std::size_t i = 0; i < text.size(); ++i)
    {
        const bool place = text[i] == '^' && i + 1 < text.size() && text[i + 1] >= '0' && text[i + 1] <= '9';
        const std::size_t number = place ? static_cast<std::size_t>(text[i + 1] - '0') : 0;
        if (!place || number >= parameters.size())
        {
            filled += text[i];
            continue;
        }
        filled += parameters.begin()[number];
        ++i;
    }
    return filled;
}

} // namespace Sarnik
