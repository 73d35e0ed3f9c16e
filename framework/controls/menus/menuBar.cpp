#include "framework/controls/menus/menuBar.h"

#include "framework/base/localisedString.h"

#include <algorithm>
#include <cmath>

namespace Sarnik
{
namespace
{

constexpr std::int32_t leftEdge = 4, titleCushion = 9;

bool isLetter(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9');
}

char32_t lowerCase(char c)
{
    return static_cast<unsigned char>(c >= 'A' && c <= 'Z' ? c + ('a' - 'A') : c);
}

} // namespace

CMenu &CMenuBar::Add(std::unique_ptr<CMenu> menu)
{
    menus.push_back(std::move(menu));
    return *menus.back();
}

void CMenuBarPane::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CControl::ReadProperties(placement, properties);
    menuFont = ReadFont(properties, "menu_font");
}

void CMenuBarPane::SetMenuBar(std::unique_ptr<CMenuBar> newBar)
{
    CloseMenu();
    bar = std::move(newBar);
    Arrange();
    if (CWindow *const window = Window(); window != nullptr && bar != nullptr)
    {
        window->SetMenuView(this);
        for (const auto &menu : bar->Menus())
            for (const CMenu::item &item : menu->Items())
                if (item.command && item.keys.key != Platform::key::none)
                    window->AddShortcut(item.keys, item.command);
    }
    Invalidate();
}

void CMenuBarPane::Arrange()
{
    titles.clear();
    hot = none;
    std::int32_t x = leftEdge;
    if (bar != nullptr)
        for (const auto &menu : bar->Menus())
        {
            CDrawTools::label text = CDrawTools::SplitLabel(Localize(menu->Title()));
            const auto width = static_cast<std::int32_t>(std::ceil(Platform::textBlock(text.text, Font()).width()));
            titles.push_back(
                {std::move(text), {x, 0, x + width + 2 * titleCushion, Bounds().bottom}, !menu->IsEmpty()});
            x += width + 2 * titleCushion;
        }
    AssignKeys();
}

/// Titles that mark none get the first of their letters that is free.
void CMenuBarPane::AssignKeys()
{
    for (title &t : titles)
        for (std::size_t i = 0; t.usable && t.text.key == 0 && i < t.text.text.size(); ++i)
        {
            const char32_t key = lowerCase(t.text.text[i]);
            if (!isLetter(t.text.text[i]) || WithKey(key) != none)
                continue;
            t.text.key = key;
            t.text.underlined = static_cast<std::ptrdiff_t>(i);
        }
}

std::size_t CMenuBarPane::WithKey(char32_t letter) const
{
    for (std::size_t i = 0; i < titles.size(); ++i)
        if (titles[i].usable && letter != 0 && titles[i].text.key == letter)
            return i;
    return none;
}

std::size_t CMenuBarPane::Usable(std::size_t from, bool forward) const
{
    for (std::size_t i = 0, at = from; i < titles.size(); ++i)
    {
        at = at == none ? 0 : (at + (forward ? 1 : titles.size() - 1)) % titles.size();
        if (titles[at].usable)
            return at;
    }
    return none;
}

std::size_t CMenuBarPane::TitleAt(CPoint p) const
{
    for (std::size_t i = 0; i < titles.size(); ++i)
        if (toCanvas(titles[i].place).contains(p))
            return i;
    return none;
}

void CMenuBarPane::OpenMenu(std::size_t index, bool byKeyboard)
{
    CWindow *const window = Window();
    if (window == nullptr || !window->IsOpen() || !IsVisible() || !IsEnabled() || index >= titles.size() ||
        !titles[index].usable || (IsOpen() && opened == index))
        return;
    CloseMenu();
    std::vector<CMenuRow> rows = bar->Menus()[index]->Rows(window->Leaf());
    if (rows.empty())
        return;
    commands.clear();
    for (const CMenuRow &row : rows)
        commands.push_back(row.command);
    const CRect place = ToWindow(TitleRect(index));
    const CPoint corner = window->ToScreen({});
    popup = std::make_unique<CMenuWindow>(std::move(rows), menuFont, static_cast<CMenuListener &>(*this));
    popup->OpenMenu(*window, place.Moved(std::llround(corner.x), std::llround(corner.y)));
    if (byKeyboard)
        popup->LightFirst();
    opened = index;
    Invalidate();
}

void CMenuBarPane::CloseMenu()
{
    if (IsOpen())
        popup->Dismiss();
}

void CMenuBarPane::MenuChosen(std::size_t row)
{
    const CObjID menu = bar->Menus()[opened]->Id(), command = commands[row];
    opened = none;
    Invalidate();
    if (CWindow *const window = Window())
        CMenu::Choose(window->Leaf(), menu, command);
}

void CMenuBarPane::MenuDismissed()
{
    opened = none;
    Invalidate();
}

void CMenuBarPane::MenuSideways(bool forward)
{
    OpenMenu(Usable(opened, forward));
}

bool CMenuBarPane::MouseDown(const CMouseEvent &e)
{
    const std::size_t at = TitleAt(e.at);
    if (at == none)
        return false;
    OpenMenu(at, false);
    return true;
}

void CMenuBarPane::MouseMove(const CMouseEvent &e)
{
    const std::size_t at = TitleAt(e.at);
    Heat(at);
    if (at != none && (HasPress() || IsOpen()))
        OpenMenu(at, false);
    if (HasPress() && IsOpen())
        popup->DragTo(OnScreen(e.at));
}

void CMenuBarPane::MouseUp(const CMouseEvent &e)
{
    // A release over a title leaves its menu open: a click has opened it.
    if (!IsOpen() || TitleAt(e.at) != none)
        return;
    const CPoint at = OnScreen(e.at);
    if (popup->Contains(at))
        popup->DragEnd(at);
    else
        CloseMenu();
}

void CMenuBarPane::MouseLeave()
{
    Heat(none);
}

void CMenuBarPane::Heat(std::size_t index)
{
    if (index == hot)
        return;
    hot = index;
    Invalidate();
}

bool CMenuBarPane::TakesAccessKey(char32_t letter) const
{
    return WithKey(letter) != none;
}

void CMenuBarPane::PressAccessKey(char32_t letter)
{
    OpenMenu(WithKey(letter));
}

void CMenuBarPane::Press()
{
    OpenMenu(Usable(none, true));
}

void CMenuBarPane::StateChanged()
{
    if (!IsVisible() || !IsEnabled())
        CloseMenu();
    CControl::StateChanged();
}

void CMenuBarPane::Draw(CPort &port)
{
    const CPalette &c = CDrawTools::Colours();
    const Platform::rectangle all = toCanvas(Bounds());
    port.Canvas().fillRectangle(all, c.menu);
    CDrawTools::Line(port, {0, all.bottom - 0.5}, {all.right, all.bottom - 0.5}, c.edge);
    const CWindow *const window = Window();
    const bool marks = window != nullptr && window->ShowsFocus();
    for (std::size_t i = 0; i < titles.size(); ++i)
    {
        const title &t = titles[i];
        Platform::rectangle place = toCanvas(t.place);
        place.bottom -= 1;
        const bool open = Opened() == i, lit = open || (hot == i && t.usable && IsEnabled());
        if (lit)
            port.Canvas().fillRounded({place.left, place.top + 2, place.right, place.bottom - 2}, CDrawTools::corner,
                                      open ? c.accent : c.face);
        CDrawTools::label text = t.text;
        if (!marks)
            text.underlined = -1;
        CDrawTools::Text(port, place, text, Font(), t.usable && IsEnabled() ? c.text : c.textDim, kAlign_Center);
    }
}

} // namespace Sarnik
