#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace Sarnik
{

/// One kind of file that a file dialog offers.
struct CFileType
{
    std::string label;                   ///< to be localised; "Workspace"
    std::vector<std::string> extensions; ///< in lower case, without a dot; empty for files of any name

    bool Fits(std::string_view fileName) const;
};

/// What a file dialog shows of a folder.
struct CFolderEntry
{
    std::string name;
    bool isFolder = false;

    friend bool operator==(const CFolderEntry &, const CFolderEntry &) = default;
};

/// Folders first, each in the order that people expect: letters of either case alike, numbers by their value, so that
/// "img9" comes before "IMG10".
bool comesBefore(const CFolderEntry &a, const CFolderEntry &b);

/// The folders in a folder, and its files that fit one of the types; what begins with a dot is left out. Links count as
/// what they point to, broken ones and devices are left out. Throws CError with a line for the user where the folder
/// cannot be read.
std::vector<CFolderEntry> readFolder(const std::string &path, const std::vector<CFileType> &types);

/// The absolute path that somebody who is in `folder` means by what he types: "~" is the user's own folder, "." and
/// ".." are taken out, an end "/" too.
std::string typedPath(const std::string &folder, std::string_view typed);
/// The folder that holds it; of "/" itself "/".
std::string parentFolder(const std::string &path);
/// After the last "/".
std::string fileNameOf(const std::string &path);
/// In lower case, without the dot: "dbw" of "/a/b.DBW"; empty without one. A dot at the beginning of a name counts not.
std::string extensionOf(std::string_view path);

} // namespace Sarnik
