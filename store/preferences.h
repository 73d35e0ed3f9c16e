#pragma once

#include "store/params.h"

#include <array>
#include <cstdint>
#include <memory>
#include <string>

namespace Project
{

/// Where the dialog's window stood, in the form in which the framework stores a window.
struct PWindowPlacement
{
    std::uint32_t kind = 0;
    std::uint32_t mode = 0;
    std::array<std::int32_t, 8> rectangles{}; ///< two, each left, top, right, bottom
    std::int32_t positionX = -100, positionY = -100;
    std::int32_t offsetX = -50, offsetY = -33;
    std::array<std::uint16_t, 2> flags{2, 2};

    friend bool operator==(const PWindowPlacement &, const PWindowPlacement &) = default;
};

/// What persists between runs. Main thread.
struct PPreferences
{
    std::uint32_t flags = 1;
    PWindowPlacement frame;
    PParams parameters; ///< of which the file holds what CopySelected copies, derivativesType excepted
};

/// The folder of the preferences file, the time log and the behavioral parameters file, three levels below dataFolder;
/// whatever is missing on the way is made. Throws when that fails.
std::string PreferencesDirectory(const std::string &dataFolder);
/// The same below Platform::userDataFolder().
std::string PreferencesDirectory();

/// Ctrl, Alt and Shift held together while the plug-in starts.
enum class ResetGesture
{
    None,
    Held ///< the file is not read
};

/// The stored preferences, or fresh ones when there is no file, it is broken, its format is not ours, or the user asks
/// for a reset; nobody is told which. Throws nothing but std::bad_alloc.
std::unique_ptr<PPreferences> LoadPreferences(const std::string &directory, ResetGesture gesture);
std::unique_ptr<PPreferences> LoadPreferences(ResetGesture gesture);

/// Replaces the file as a whole or not at all. Throws Platform::fileError.
void SavePreferences(const std::string &directory, const PPreferences &preferences);

} // namespace Project
