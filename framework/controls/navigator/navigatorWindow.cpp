#include "framework/controls/navigator/navigatorWindow.h"

#include "framework/base/exceptions.h"
#include "framework/base/localisedString.h"
#include "framework/controls/alerts/messageAlert.h"
#include "framework/controls/buttons/pushButton.h"
#include "framework/controls/fields/editString.h"
#include "framework/controls/iconSource.h"
#include "framework/controls/menus/radioPopup.h"
#include "framework/controls/navigator/navigator.h"
#include "framework/controls/scrolling/listBox.h"

#include <algorithm>
#include <utility>

namespace Sarnik
{
namespace
{

const CObjID folderId("Sarnik/Navigator/Folder"), upId("Sarnik/Navigator/Up"), homeId("Sarnik/Navigator/Home"),
    listId("Sarnik/Navigator/List"), nameId("Sarnik/Navigator/Name"), typeId("Sarnik/Navigator/Type"),
    cancelId("Sarnik/Navigator/Cancel"), okId("Sarnik/Navigator/Ok");

const CFileType allFiles{"$$$/Sarnik/Navigator/AllFiles=All files", {}};

/// "Workspace (.dbw)".
std::string typeText(const CFileType &type)
{
    std::string text = Localize(type.label);
    for (std::size_t i = 0; i < type.extensions.size(); ++i)
        text += (i == 0 ? " (." : ", .") + type.extensions[i];
    return type.extensions.empty() ? text : text + ')';
}

/// A picture that says what a file holds.
std::string_view iconOf(const CFolderEntry &entry)
{
    if (entry.isFolder)
        return "Folder";
    const std::string extension = extensionOf(entry.name);
    return extension == "dbw" ? "FileWorkspace" : extension == "knl" ? "FileTrace" : "FilePicture";
}

/// The list: a picture before each name.
class folderSheet final : public CListSheet
{
public:
    explicit folderSheet(const std::vector<CFolderEntry> &shown) : entries(shown) { SetId(listId); }

protected:
    void DrawRow(CPort &port, const Platform::rectangle &room, int index, Platform::colour ink) override
    {
        constexpr double side = 16, gap = 6;
        const auto at = static_cast<std::size_t>(index);
        if (at < entries.size())
            CDrawTools::Icon(port, {room.left, room.top, room.left + side, room.bottom},
                             CIconSource::Icon(iconOf(entries[at]), port.Scale()));
        CListSheet::DrawRow(port, {room.left + side + gap, room.top, room.right, room.bottom}, index, ink);
    }

private:
    const std::vector<CFolderEntry> &entries;
};

} // namespace

CNavigatorWindow::CNavigatorWindow(request wanted) : asked(std::move(wanted))
{
    if (asked.types.empty())
        asked.types.push_back(allFiles);
    asked.typeIndex = std::min(asked.typeIndex, asked.types.size() - 1);

    LoadLayout("CNavigator.wyra");
    if (!asked.title.empty())
        SetTitle(asked.title);
    CView &place = *FindView("Sarnik/Navigator/ListPlace");
    auto &box = place.Make<CListBox>(place.Bounds(), std::make_unique<folderSheet>(entries));
    box.SetBinding(kBind_XSizeable | kBind_YSizeable);
    list = &box.List();
    name = Find<CEditString>(nameId);
    folders = Find<CRadioPopup>(folderId);
    typePopup = Find<CRadioPopup>(typeId);
    if (asked.saving)
        Find<CPushButton>(okId)->SetText("$$$/Sarnik/Navigator/SaveButton=Save");

    std::vector<std::string> texts;
    for (const CFileType &type : asked.types)
        texts.push_back(typeText(type));
    typePopup->SetItems(std::move(texts));
    typePopup->SetValue(static_cast<unsigned>(asked.typeIndex));

    GoToNearest(typedPath("/", asked.folder.empty() ? "~" : asked.folder));
    if (asked.saving)
    {
        name->SetValue(nameForType(asked.name, asked.types[asked.typeIndex], asked.types));
        SetFocus(name);
        // The part that people change.
        name->Select(0, std::min(name->Value().rfind('.'), name->Value().size()));
    }
    else
        SetFocus(list);
}

bool CNavigatorWindow::Ask(CWindow *over, std::string &path)
{
    const bool chosen = RunModal(over) == okId && !taken.empty();
    if (chosen)
        path = taken;
    return chosen;
}

std::vector<CFileType> CNavigatorWindow::ShownTypes() const
{
    return {asked.types[asked.typeIndex]};
}

bool CNavigatorWindow::GoTo(const std::string &path, bool complain, const std::string &select)
{
    std::vector<CFolderEntry> found;
    try
    {
        found = readFolder(path, ShownTypes());
    }
    catch (const CError &e)
    {
        if (complain)
            Refuse(e.ErrorText());
        return false;
    }
    entries = std::move(found);
    folder = path;
    std::vector<std::string> rows;
    rows.reserve(entries.size());
    int selected = -1;
    for (const CFolderEntry &entry : entries)
    {
        if (entry.name == select)
            selected = static_cast<int>(rows.size());
        rows.push_back(entry.name);
    }
    list->SetTexts(rows);
    if (selected >= 0)
        list->SelectIndex(selected);
    ShowFolders();
    return true;
}

void CNavigatorWindow::GoUp()
{
    GoTo(parentFolder(folder), true, fileNameOf(folder));
}

void CNavigatorWindow::GoToNearest(std::string path)
{
    while (!GoTo(path, false) && path != "/")
        path = parentFolder(path);
}

void CNavigatorWindow::ShowFolders()
{
    above.clear();
    for (std::string at = folder;; at = parentFolder(at))
    {
        above.push_back(at);
        if (at == "/" || at.empty())
            break;
    }
    folders->SetItems(above);
    folders->SetValue(0);
}

void CNavigatorWindow::TypeChosen(std::size_t index)
{
    asked.typeIndex = std::min(index, asked.types.size() - 1);
    if (asked.saving)
        name->SetValue(nameForType(name->Value(), asked.types[asked.typeIndex], asked.types));
    GoTo(folder, true);
}

void CNavigatorWindow::Selected(std::size_t row)
{
    if (row < entries.size() && !entries[row].isFolder)
        name->SetValue(entries[row].name);
    else if (!asked.saving)
        name->SetValue("");
}

void CNavigatorWindow::Take(const std::string &typed)
{
    if (typed.empty())
        return;
    const CFileChoice choice = asked.saving ? choiceToSave(folder, typed, asked.types[asked.typeIndex], asked.types)
                                            : choiceToOpen(folder, typed);
    switch (choice.what)
    {
    case CFileChoice::outcome::enterFolder:
        if (GoTo(choice.path, true) && !asked.saving)
            name->SetValue("");
        return;
    case CFileChoice::outcome::refuse:
        Refuse(choice.message);
        return;
    case CFileChoice::outcome::askToReplace:
    {
        CMessageAlert question(this, CAlertIcon::warning,
                               {{CAlertButton::Ok, "$$$/Sarnik/Navigator/ReplaceButton=&Replace"},
                                {CAlertButton::Cancel, "$$$/Sarnik/Alert/CancelButton=Cancel"}},
                               Localize("$$$/Sarnik/Navigator/ReplaceText=\"^0\" is there already. Replace it?",
                                        {fileNameOf(choice.path)}),
                               "$$$/Sarnik/Navigator/ReplaceSubtext=What it holds now will be lost.", Settings().title,
                               CAlertButton::Cancel);
        if (question.Run() != CAlertButton::Ok)
            return;
        break;
    }
    case CFileChoice::outcome::take:
        break;
    }
    taken = choice.path;
    EndModal(okId);
}

void CNavigatorWindow::Refuse(const std::string &message)
{
    CMessageAlert(this, CAlertIcon::warning, alertOk(), message, {}, Settings().title).Run();
}

bool CNavigatorWindow::ReceiveValue(CValueMessage &message)
{
    const auto *const chosen = dynamic_cast<CValMsg<unsigned> *>(&message);
    if (message.Id() == folderId && chosen != nullptr && chosen->Value() < above.size())
        GoTo(std::string(above[chosen->Value()]), true);
    else if (message.Id() == typeId && chosen != nullptr)
        TypeChosen(chosen->Value());
    else if (message.Id() == listId && chosen != nullptr)
        Selected(chosen->Value());
    else if (message.Id() != nameId)
        return CDialog::ReceiveValue(message);
    return true;
}

bool CNavigatorWindow::ReceiveCommand(CCommandMessage &message)
{
    if (message.Id() == upId)
        GoUp();
    else if (message.Id() == homeId)
        GoTo(typedPath("/", "~"), true);
    else if (message.Id() == okId)
        Take(name->Value());
    else if (message.Id() == listId)
    {
        const int row = list->Current();
        if (row >= 0 && static_cast<std::size_t>(row) < entries.size())
            Take(std::string(entries[static_cast<std::size_t>(row)].name));
    }
    else
        return CDialog::ReceiveCommand(message);
    return true;
}

bool CNavigatorWindow::KeyboardFilter(CKeyboardMessage &message)
{
    if (!message.IsDown())
        return false;
    const bool altUp =
        message.Key() == Platform::key::up && message.Modifiers() == std::uint32_t{Platform::altModifier};
    const bool back = message.Key() == Platform::key::backspace && message.Modifiers() == 0 && Focus() == list;
    // The field alone would take Enter as the end of the edit.
    const bool accept =
        (message.Key() == Platform::key::enter || message.Key() == Platform::key::keypadEnter) && Focus() == name;
    if (altUp || back)
        GoUp();
    else if (accept)
        Take(std::string(name->Value()));
    return altUp || back || accept;
}

bool CNavigator::RunWindow(CWindow *parent, bool saving, const std::string &name, std::string &path)
{
    CNavigatorWindow window({saving, title, folder, name, types, typeIndex});
    const bool chosen = window.Ask(parent, path);
    if (chosen)
    {
        typeIndex = window.TypeIndex();
        folder = window.Folder();
    }
    return chosen;
}

} // namespace Sarnik
