#pragma once

#include "framework/controls/dialog.h"
#include "framework/controls/navigator/fileChoice.h"

#include <string>
#include <vector>

namespace Sarnik
{

class CEditString;
class CListSheet;
class CRadioPopup;

/// The window of the file dialogs. The list shows a folder; the field has the name of what is selected, or what was
/// typed: a name, a path, or a folder to go to. Enter and a double click open a folder or take a file. Alt+Up, and
/// backspace in the list, lead to the folder above.
class CNavigatorWindow final : public CDialog
{
public:
    struct request
    {
        bool saving = false;
        std::string title, folder, name;
        std::vector<CFileType> types; ///< empty for all files
        std::size_t typeIndex = 0;
    };
    explicit CNavigatorWindow(request wanted);

    /// False where the user gave up.
    bool Ask(CWindow *over, std::string &path);

    const std::string &Folder() const { return folder; }
    std::size_t TypeIndex() const { return asked.typeIndex; }

    bool ReceiveValue(CValueMessage &message) override;
    bool ReceiveCommand(CCommandMessage &message) override;
    bool KeyboardFilter(CKeyboardMessage &message) override;

private:
    /// False, with an alert if `complain`, where it cannot be read; the window stays as it was then.
    bool GoTo(const std::string &path, bool complain, const std::string &select = {});
    void GoUp();
    void GoToNearest(std::string path);
    void ShowFolders();
    void TypeChosen(std::size_t index);
    void Selected(std::size_t row);
    void Take(const std::string &typed);
    void Refuse(const std::string &message);
    std::vector<CFileType> ShownTypes() const;

    request asked;
    std::string folder, taken;
    std::vector<std::string> above; ///< the folder and those above it, the nearest first
    std::vector<CFolderEntry> entries;
    CListSheet *list = nullptr;
    CEditString *name = nullptr;
    CRadioPopup *folders = nullptr, *typePopup = nullptr;
};

} // namespace Sarnik
