#include "framework/controls/navigator/folderList.h"

#include "framework/base/exceptions.h"

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <dirent.h>
#include <filesystem>
#include <memory>
#include <sys/stat.h>

namespace Sarnik
{
namespace
{

bool isDigit(char c)
{
    return c >= '0' && c <= '9';
}

char lower(char c)
{
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

std::string lowered(std::string_view text)
{
    std::string result(text);
    std::transform(result.begin(), result.end(), result.begin(), lower);
    return result;
}

/// The digits at the front, taken off; without leading zeros.
std::string_view takeNumber(std::string_view &text)
{
    std::size_t length = 0;
    while (length < text.size() && isDigit(text[length]))
        ++length;
    std::string_view number = text.substr(0, length);
    text.remove_prefix(length);
    number.remove_prefix(std::min(number.find_first_not_of('0'), number.size()));
    return number;
}

/// Below, at or above 0.
int compareNames(std::string_view a, std::string_view b)
{
    while (!a.empty() && !b.empty())
    {
        if (isDigit(a.front()) && isDigit(b.front()))
        {
            const std::string_view first = takeNumber(a), second = takeNumber(b);
            if (first.size() != second.size())
                return first.size() < second.size() ? -1 : 1;
            if (const int order = first.compare(second); order != 0)
                return order;
            continue;
        }
        const auto x = static_cast<unsigned char>(lower(a.front())), y = static_cast<unsigned char>(lower(b.front()));
        if (x != y)
            return x < y ? -1 : 1;
        a.remove_prefix(1);
        b.remove_prefix(1);
    }
    return static_cast<int>(!a.empty()) - static_cast<int>(!b.empty());
}

enum class kind
{
    folder,
    file,
    other
};

kind kindOf(int folder, const dirent &entry)
{
    if (entry.d_type == DT_DIR)
        return kind::folder;
    if (entry.d_type == DT_REG)
        return kind::file;
    struct stat status;
    if (fstatat(folder, entry.d_name, &status, 0) != 0)
        return kind::other;
    return S_ISDIR(status.st_mode) ? kind::folder : S_ISREG(status.st_mode) ? kind::file : kind::other;
}

} // namespace

bool CFileType::Fits(std::string_view fileName) const
{
    return extensions.empty() ||
           std::find(extensions.begin(), extensions.end(), extensionOf(fileName)) != extensions.end();
}

bool comesBefore(const CFolderEntry &a, const CFolderEntry &b)
{
    if (a.isFolder != b.isFolder)
        return a.isFolder;
    const int order = compareNames(a.name, b.name);
    return order != 0 ? order < 0 : a.name < b.name;
}

std::vector<CFolderEntry> readFolder(const std::string &path, const std::vector<CFileType> &types)
{
    const std::unique_ptr<DIR, int (*)(DIR *)> folder(opendir(path.c_str()), closedir);
    if (!folder)
        throw CError(path + ": " + std::strerror(errno));
    std::vector<CFolderEntry> entries;
    while (const dirent *const entry = readdir(folder.get()))
    {
        const std::string_view name = entry->d_name;
        if (name.starts_with('.'))
            continue;
        const kind what = kindOf(dirfd(folder.get()), *entry);
        const bool shown =
            what == kind::folder ||
            (what == kind::file && (types.empty() || std::any_of(types.begin(), types.end(),
                                                                 [&](const CFileType &t) { return t.Fits(name); })));
        if (shown)
            entries.push_back({std::string(name), what == kind::folder});
    }
    std::sort(entries.begin(), entries.end(), comesBefore);
    return entries;
}

std::string typedPath(const std::string &folder, std::string_view typed)
{
    std::filesystem::path path(typed);
    if (typed == "~" || typed.starts_with("~/"))
    {
        const char *const home = std::getenv("HOME");
        path = home != nullptr && *home != '\0' ? home : "/";
        if (typed.size() > 2)
            path /= typed.substr(2);
    }
    path = (std::filesystem::path(folder) / path).lexically_normal();
    if (path.is_relative())
        path = ("/" / path).lexically_normal();
    return path.has_filename() || path == "/" ? path.string() : path.parent_path().string();
}

std::string parentFolder(const std::string &path)
{
    return std::filesystem::path(path).parent_path().string();
}

std::string fileNameOf(const std::string &path)
{
    return std::filesystem::path(path).filename().string();
}

std::string extensionOf(std::string_view path)
{
    const std::string extension = std::filesystem::path(path).extension().string();
    return extension.empty() ? extension : lowered(std::string_view(extension).substr(1));
}

} // namespace Sarnik
