#pragma once

namespace Stillmark
{

/// The plug-in keeps its preferences and tables in the user's folder for settings, and a run fails when it cannot. For
/// a user who has none that can be written (a service, a container), there is one in the folder for temporary files
/// while this object lives. One at a time; not while other threads look at the environment.
class settingsFolder
{
public:
    settingsFolder();
    settingsFolder(const settingsFolder &) = delete;
    settingsFolder &operator=(const settingsFolder &) = delete;
    ~settingsFolder();

private:
    char made[32] = ""; ///< empty: the user's own serves
};

} // namespace Stillmark
