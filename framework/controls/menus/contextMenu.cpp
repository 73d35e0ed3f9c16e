#include "framework/controls/menus/contextMenu.h"

#include "framework/views/view.h"

#include <cmath>

namespace Sarnik
{

bool CContextMenu::Open(CMenu &menu, CPoint at, bool byKeyboard)
{
    Close();
    CWindow *const window = view.Window();
    if (window == nullptr || !window->IsOpen())
        return false;
    std::vector<CMenuRow> rows = menu.Rows(view);
    if (rows.empty())
        return false;
    openMenu = menu.Id();
    commands.clear();
    for (const CMenuRow &row : rows)
        commands.push_back(row.command);
    const CPoint corner = window->ToScreen(view.ToWindow(at));
    const auto x = CRect::Clamped(std::llround(corner.x)), y = CRect::Clamped(std::llround(corner.y));
    popup = std::make_unique<CMenuWindow>(std::move(rows), kFont_UIMedium, static_cast<CMenuListener &>(*this));
    popup->OpenMenu(*window, {x, y, x, y});
    if (byKeyboard)
        popup->LightFirst();
    return true;
}

void CContextMenu::Close()
{
    if (IsOpen())
        popup->Dismiss();
}

void CContextMenu::MenuChosen(std::size_t row)
{
    CMenu::Choose(view, openMenu, commands[row]);
}

} // namespace Sarnik
