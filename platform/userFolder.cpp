#include "platform/userFolder.h"

#include "platform/error.h"

#include <cstdlib>
#include <pwd.h>
#include <unistd.h>
#include <vector>

namespace Platform
{

namespace
{

/// The variable's value if it is an absolute path, else nothing: relative ones are to be ignored (XDG base
/// directories).
std::string absoluteFolder(const char *variable)
{
    const char *value = std::getenv(variable);
    return value && value[0] == '/' ? value : "";
}

std::string homeOfUser()
{
    passwd entry{};
    passwd *found = nullptr;
    std::vector<char> text(16384);
    if (::getpwuid_r(::getuid(), &entry, text.data(), text.size(), &found) != 0 || !found || !found->pw_dir)
        return "";
    return found->pw_dir[0] == '/' ? found->pw_dir : "";
}

} // namespace

std::string userDataFolder()
{
    if (const std::string folder = absoluteFolder("XDG_CONFIG_HOME"); !folder.empty())
        return folder;
    std::string home = absoluteFolder("HOME");
    if (home.empty())
        home = homeOfUser();
    if (home.empty())
        throw fileError("the user has no home folder: set HOME or XDG_CONFIG_HOME");
    return home + "/.config";
}

} // namespace Platform
