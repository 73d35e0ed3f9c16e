#pragma once

#include "framework/controls/navigator/folderList.h"

#include <string>
#include <vector>

namespace Sarnik
{

class CWindow;

/// Asks the user for a file, in a window of our own: types of files, a folder to start in, paths typed by hand.
/// Interface thread.
///
///     COpenFile open;
///     open.SetTitle("$$$/...=Load");
///     open.AddType({"$$$/...=Workspace", {"dbw"}});
///     std::string path;
///     if (open.Run(&window, path)) ...
class CNavigator
{
public:
    virtual ~CNavigator() = default;

    /// To be localised.
    void SetTitle(std::string text) { title = std::move(text); }
    /// Where it starts; an empty one, or one that cannot be read, means the nearest folder above that can be, or the
    /// user's own.
    void SetFolder(std::string path) { folder = std::move(path); }
    /// Without any, all files are shown.
    void AddType(CFileType type) { types.push_back(std::move(type)); }
    /// The type that is chosen first, and afterwards the one that was chosen last.
    void SetTypeIndex(std::size_t index) { typeIndex = index; }
    std::size_t TypeIndex() const { return typeIndex; }

    /// False where the user gave up. `path` is absolute. Throws CError where there is no display.
    virtual bool Run(CWindow *parent, std::string &path) = 0;

protected:
    CNavigator() = default;
    bool RunWindow(CWindow *parent, bool saving, const std::string &name, std::string &path);

private:
    std::string title, folder;
    std::vector<CFileType> types;
    std::size_t typeIndex = 0;
};

/// A file that is there and can be read.
class COpenFile final : public CNavigator
{
public:
    bool Run(CWindow *parent, std::string &path) override { return RunWindow(parent, false, {}, path); }
};

/// A file to be written; whether one of that name may be replaced has been asked. The name has an extension of
/// one of the types, of the chosen one where the user typed none of them.
class CSaveFile : public CNavigator
{
public:
    /// What is proposed, without a folder.
    void SetName(std::string fileName) { name = std::move(fileName); }

    bool Run(CWindow *parent, std::string &path) override { return RunWindow(parent, true, name, path); }

private:
    std::string name;
};

} // namespace Sarnik
