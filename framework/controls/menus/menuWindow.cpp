#include "framework/controls/menus/menuWindow.h"

#include <algorithm>

namespace Sarnik
{
namespace
{

char32_t lowerCase(char32_t c)
{
    return c >= U'A' && c <= U'Z' ? c + (U'a' - U'A') : c;
}

} // namespace

CMenuWindow::CMenuWindow(std::vector<CMenuRow> rows, std::int32_t font, CMenuListener &toTell)
    : listener(toTell), list(&Make<CMenuList>(std::move(rows), font))
{
    list->chosen = [this](int row) { Choose(row); };
}

void CMenuWindow::OpenMenu(CWindow &by, const CRect &anchor, std::int32_t leastWidth)
{
    // Less than the arrows and two rows cannot be used.
    constexpr std::int32_t least = 2 * CMenuList::arrowHeight + 2 * CMenuList::rowHeight;
    OpenBy(by, anchor, std::max(leastWidth, list->WantedWidth()), list->WantedHeight(), least);
    list->SetFrame(Bounds());
}

void CMenuWindow::LightFirst()
{
    if (list->Lit() == CMenuList::none)
        list->Light(list->Neighbour(CMenuList::none, true));
    list->WaitForPointer();
}

CPoint CMenuWindow::InList(CPoint onScreen) const
{
    const CRect frame = Frame();
    return {onScreen.x - frame.left, onScreen.y - frame.top};
}

void CMenuWindow::DragTo(CPoint onScreen)
{
    list->PointTo(InList(onScreen));
}

void CMenuWindow::DragEnd(CPoint onScreen)
{
    DragTo(onScreen);
    if (const int row = list->RowAt(InList(onScreen)); list->CanChoose(row))
        Choose(row);
}

void CMenuWindow::Dismiss()
{
    if (!IsOpen())
        return;
    Close();
    listener.MenuDismissed();
}

void CMenuWindow::Choose(int row)
{
    Close();
    listener.MenuChosen(static_cast<std::size_t>(row));
}

bool CMenuWindow::KeyboardFilter(CKeyboardMessage &message)
{
    if (message.IsDown())
        return Key(message);
    if (message.IsChar())
        Letter(message.Character());
    return true;
}

/// All keys are the menu's; letters come again as what they write.
bool CMenuWindow::Key(CKeyboardMessage &message)
{
    using Platform::key;
    const int lit = list->Lit();
    switch (message.Key())
    {
    case key::up:
    case key::down:
        list->Light(list->Neighbour(lit, message.Key() == key::down));
        return true;
    case key::home:
        list->Light(list->Neighbour(CMenuList::none, true));
        return true;
    case key::end:
        list->Light(list->Neighbour(CMenuList::none, false));
        return true;
    case key::pageUp:
    case key::pageDown:
        list->Light(list->PageFrom(lit, message.Key() == key::pageDown));
        return true;
    case key::left:
    case key::right:
        listener.MenuSideways(message.Key() == key::right);
        return true;
    case key::escape:
    case key::tab:
    case key::f10:
        Dismiss();
        return true;
    case key::space:
        if (typeAhead.IsUnderWay())
        {
            message.WantText();
            return true;
        }
        [[fallthrough]];
    case key::enter:
    case key::keypadEnter:
        if (list->CanChoose(lit))
            Choose(lit);
        else
            Dismiss();
        return true;
    default:
        break;
    }
    if ((message.Modifiers() & Platform::altModifier) != 0 && message.Character() != 0)
        Letter(message.Character());
    else
        message.WantText();
    return true;
}

void CMenuWindow::Letter(char32_t letter)
{
    // A letter that is the access key of one row chooses it; one of several goes from each to the next.
    const auto &rows = list->Rows();
    const auto hasKey = [&](int row) {
        return list->CanChoose(row) && rows[static_cast<std::size_t>(row)].text.key == lowerCase(letter);
    };
    int found = CMenuList::none, several = 0;
    for (int i = 1; i <= static_cast<int>(rows.size()); ++i)
        if (const int row = (list->Lit() + i) % static_cast<int>(rows.size()); hasKey(row) && several++ == 0)
            found = row;
    if (several == 1)
        return Choose(found);
    if (several == 0)
    {
        const std::size_t at = typeAhead.Find(
            letter, rows.size(), list->Lit() < 0 ? CTypeAhead::none : static_cast<std::size_t>(list->Lit()),
            [&](std::size_t row) {
                return list->CanChoose(static_cast<int>(row)) ? rows[row].text.text : std::string();
            });
        found = at == CTypeAhead::none ? CMenuList::none : static_cast<int>(at);
    }
    if (found != CMenuList::none)
        list->Light(found);
}

} // namespace Sarnik
