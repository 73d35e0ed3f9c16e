#include "cli/settingsFolder.h"

#include "platform/files.h"
#include "store/preferences.h"

#include <cstdlib>
#include <cstring>
#include <exception>
#include <filesystem>

namespace Stillmark
{
namespace
{

bool usable()
{
    try
    {
        Platform::checkWritable(Project::PreferencesDirectory() + "/.writable");
        return true;
    }
    catch (const std::exception &)
    {
        return false;
    }
}

} // namespace

settingsFolder::settingsFolder()
{
    if (usable())
        return;
    std::strcpy(made, "/tmp/stillmark.XXXXXX");
    if (::mkdtemp(made) != nullptr)
        ::setenv("XDG_CONFIG_HOME", made, 1);
    else
        made[0] = '\0'; // the plug-in tells what is wrong
}

settingsFolder::~settingsFolder()
{
    if (made[0] == '\0')
        return;
    ::unsetenv("XDG_CONFIG_HOME");
    std::error_code ignored;
    std::filesystem::remove_all(made, ignored);
}

} // namespace Stillmark
