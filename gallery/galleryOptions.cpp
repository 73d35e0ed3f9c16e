#include "gallery/galleryOptions.h"

#include <charconv>
#include <string_view>

namespace Stillmark
{
namespace
{

double scaleOf(std::string_view text)
{
    double scale = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), scale);
    if (error != std::errc() || end != text.data() + text.size() || !(scale >= 1 && scale <= 4))
        throw usageError("--scale takes a number from 1 to 4");
    return scale;
}

} // namespace

galleryOptions parseGalleryOptions(std::span<char *const> arguments)
{
    galleryOptions options;
    for (std::size_t i = 0; i < arguments.size(); ++i)
    {
        const std::string_view name = arguments[i];
        const auto value = [&]() -> std::string_view {
            if (++i == arguments.size())
                throw usageError(std::string(name) + " takes a value");
            return arguments[i];
        };
        if (name == "--scale")
            options.scale = scaleOf(value());
        else if (name == "--screenshot")
            options.screenshot = value();
        else if (name == "--log")
            options.log = true;
        else if (name == "--help")
            options.help = true;
        else
            throw usageError("unknown argument: " + std::string(name));
    }
    return options;
}

} // namespace Stillmark
