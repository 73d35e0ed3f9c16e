#include "framework/controls/navigator/fileChoice.h"

#include "framework/base/localisedString.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <sys/stat.h>
#include <unistd.h>

namespace Sarnik
{
namespace
{

CFileChoice refused(const std::string &path, int error)
{
    return {CFileChoice::outcome::refuse, path, path + ": " + std::strerror(error)};
}

CFileChoice refused(const std::string &path, std::string_view pattern)
{
    return {CFileChoice::outcome::refuse, path, Localize(pattern, {fileNameOf(path)})};
}

bool hasExtensionOf(const std::vector<CFileType> &types, std::string_view name)
{
    return std::any_of(types.begin(), types.end(),
                       [&](const CFileType &t) { return !t.extensions.empty() && t.Fits(name); });
}

constexpr std::string_view notAFile = "$$$/Sarnik/Navigator/NotAFile=\"^0\" is not a file.";

} // namespace

CFileChoice choiceToOpen(const std::string &folder, std::string_view typed)
{
    const std::string path = typedPath(folder, typed);
    struct stat status;
    if (stat(path.c_str(), &status) != 0)
        return refused(path, errno);
    if (S_ISDIR(status.st_mode))
        return {CFileChoice::outcome::enterFolder, path, {}};
    if (!S_ISREG(status.st_mode))
        return refused(path, notAFile);
    if (access(path.c_str(), R_OK) != 0)
        return refused(path, errno);
    return {CFileChoice::outcome::take, path, {}};
}

CFileChoice choiceToSave(const std::string &folder, std::string_view typed, const CFileType &type,
                         const std::vector<CFileType> &known)
{
    std::string path = typedPath(folder, typed);
    struct stat status;
    if (stat(path.c_str(), &status) == 0 && S_ISDIR(status.st_mode))
        return {CFileChoice::outcome::enterFolder, path, {}};
    // "name/" can only have meant a folder.
    if (typed.ends_with('/'))
        return refused(path, ENOENT);
    if (!type.extensions.empty() && !type.Fits(path) && !hasExtensionOf(known, path))
        path += '.' + type.extensions.front();
    if (stat(path.c_str(), &status) == 0)
    {
        if (!S_ISREG(status.st_mode))
            return refused(path, notAFile);
        return {CFileChoice::outcome::askToReplace, path, {}};
    }
    if (errno != ENOENT)
        return refused(path, errno);
    const std::string parent = parentFolder(path);
    if (stat(parent.c_str(), &status) != 0)
        return refused(parent, errno);
    if (access(parent.c_str(), W_OK | X_OK) != 0)
        return refused(parent, errno);
    return {CFileChoice::outcome::take, path, {}};
}

std::string nameForType(std::string_view name, const CFileType &type, const std::vector<CFileType> &known)
{
    if (type.extensions.empty() || name.empty() || type.Fits(name))
        return std::string(name);
    const std::string extension = extensionOf(name);
    if (!extension.empty() && hasExtensionOf(known, name))
        name.remove_suffix(extension.size() + 1);
    return std::string(name) + '.' + type.extensions.front();
}

} // namespace Sarnik
