#pragma once

#include <string>

namespace Platform
{

/// Where programs keep what belongs to this user: $XDG_CONFIG_HOME if it is an absolute path, else ~/.config. Home is
/// $HOME or, without that, what the system's list of users says. The folder need not exist. Throws fileError when the
/// user has no home.
std::string userDataFolder();

} // namespace Platform
