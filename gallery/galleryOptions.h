#pragma once

#include <optional>
#include <span>
#include <stdexcept>
#include <string>

namespace Stillmark
{

/// The command line: [--scale N] [--screenshot F.png] [--log]
struct galleryOptions
{
    std::optional<double> scale; ///< 1 to 4 pixels per view unit; otherwise as the screen has it, without a screen 1
    std::string screenshot;      ///< a picture is drawn without a screen, and that is all; empty for none
    bool log = false;            ///< to stdout
    bool help = false;

    static constexpr const char *usage = "usage: stillmark_gallery [--scale N] [--screenshot F.png] [--log]\n";
};

/// what() is one line for the user.
class usageError : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

/// Without the program's name. Throws usageError.
galleryOptions parseGalleryOptions(std::span<char *const> arguments);

} // namespace Stillmark
