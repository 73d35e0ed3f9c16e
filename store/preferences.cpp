#include "store/preferences.h"

#include "framework/base/container.h"
#include "framework/base/localisedString.h"
#include "platform/files.h"
#include "platform/userFolder.h"
#include "store/preferencesFormat.h"

#include <filesystem>
#include <span>

namespace Project
{

namespace
{

/// The host's release as it stands in folder names.
constexpr const char *kReleaseWord = "14";

/// A file of ours has a few hundred bytes, most of them a folder's name.
constexpr std::size_t kLargestFile = 1 << 20;

std::string FileIn(const std::string &directory)
{
    return directory + "/" + Sarnik::Localize("$$$/Deblur/Prefs/FileName=Stillmark Prefs.tnp");
}

} // namespace

std::string PreferencesDirectory(const std::string &dataFolder)
{
    const std::string release = kReleaseWord;
    const std::filesystem::path directory =
        std::filesystem::path(dataFolder) / Sarnik::Localize("$$$/private/Prefs/Directory/Corvane=Corvane") /
        (Sarnik::Localize("$$$/private/Prefs/Directory/SubDir=Corvane Tintorel ") + release) /
        (Sarnik::Localize("$$$/private/Prefs/Directory/Tintorel=Corvane Tintorel ") + release + " Settings");
    std::filesystem::create_directories(directory);
    return directory.string();
}

std::string PreferencesDirectory()
{
    return PreferencesDirectory(Platform::userDataFolder());
}

std::unique_ptr<PPreferences> LoadPreferences(const std::string &directory, ResetGesture gesture)
{
    if (gesture == ResetGesture::None)
    {
        try
        {
            auto preferences = std::make_unique<PPreferences>();
            // A pipe of that name would be waited for.
            if (std::filesystem::is_regular_file(FileIn(directory)))
            {
                const auto bytes = Platform::readWholeFile(FileIn(directory), kLargestFile);
                Sarnik::CMemoryContainer file(std::as_bytes(std::span(bytes)));
                ReadPreferences(file, *preferences);
            }
            return preferences;
        }
        catch (...)
        {
            // Broken preferences are no reason to stop, nor to bother anybody.
        }
    }
    return std::make_unique<PPreferences>();
}

std::unique_ptr<PPreferences> LoadPreferences(ResetGesture gesture)
{
    std::string directory;
    try
    {
        directory = PreferencesDirectory();
    }
    catch (...)
    {
        gesture = ResetGesture::Held; // nowhere to read from
    }
    return LoadPreferences(directory, gesture);
}

void SavePreferences(const std::string &directory, const PPreferences &preferences)
{
    Sarnik::CMemoryContainer bytes;
    WritePreferences(bytes, preferences);
    Platform::atomicFile file(FileIn(directory));
    file.write(bytes.Content().data(), bytes.Content().size());
    file.commit();
}

} // namespace Project
