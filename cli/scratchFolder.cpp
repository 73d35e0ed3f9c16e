#include "cli/scratchFolder.h"

#include <cstdlib>
#include <filesystem>

namespace Stillmark
{

std::string scratchFolder()
{
    namespace fs = std::filesystem;
    const auto fromEnvironment = [](const char *name) {
        const char *value = std::getenv(name);
        const fs::path path = value ? value : "";
        return path.is_absolute() ? path : fs::path(); // others are to be ignored (XDG base directories)
    };
    fs::path cache = fromEnvironment("XDG_CACHE_HOME");
    if (cache.empty())
    {
        const fs::path home = fromEnvironment("HOME");
        if (home.empty())
            return {};
        cache = home / ".cache";
    }
    std::error_code failed;
    fs::create_directories(cache / "stillmark", failed);
    return failed ? std::string() : (cache / "stillmark").string();
}

} // namespace Stillmark
