#include "framework/controls/menus/menuPopup.h"

#include "framework/controls/iconSource.h"

namespace Sarnik
{

CLayoutSize CMenuPopup::NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure)
{
    const CLayoutSize text = measure.Measure(properties.LocalisedText("text"), ReadFont(properties, "menu_font"));
    return {text.width + textCushion + arrowWidth + 2 * CDrawTools::ringRoom, naturalHeight};
}

void CMenuPopup::SetMenu(std::shared_ptr<CMenu> toOpen)
{
    ClosePopup();
    menu = std::move(toOpen);
}

std::vector<CMenuRow> CMenuPopup::PopupRows()
{
    if (menu == nullptr)
        return {};
    std::vector<CMenuRow> rows = menu->Rows(*this);
    openMenu = menu->Id();
    commands.clear();
    for (const CMenuRow &row : rows)
        commands.push_back(row.command);
    return rows;
}

void CMenuPopup::MenuChosen(std::size_t row)
{
    Invalidate();
    CMenu::Choose(*this, openMenu, commands[row]);
}

void CMenuPopup::Draw(CPort &port)
{
    DrawFace(port, toCanvas(PopupAnchor()), Label());
}

CLayoutSize CFlyoutPopup::NaturalSize(const CWyraVariablePropertyList &, const CTextMeasure &)
{
    return {22, 22};
}

void CFlyoutPopup::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CMenuPopup::ReadProperties(placement, properties);
    icon = properties.Text("icon");
}

void CFlyoutPopup::SetIcon(std::string name)
{
    icon = std::move(name);
    Invalidate();
}

void CFlyoutPopup::Draw(CPort &port)
{
    const Platform::rectangle face = toCanvas(PopupAnchor());
    if (Face() == EFace::hot || Face() == EFace::pressed)
        CDrawTools::Face(port, face, Face());
    if (const CIcon picture = CIconSource::Icon(icon, port.Scale()))
        CDrawTools::Icon(port, face, picture, kAlign_Center, IsEnabled() ? 1 : 0.4);
    else
    {
        // On whole pixels: three lines, and a small arrow to their right.
        const double left = face.left + (face.width() - 14) / 2, top = face.top + (face.height() - 8) / 2;
        for (int i = 0; i < 3; ++i)
            port.Canvas().fillRectangle({left, top + 3.0 * i, left + 8, top + 3.0 * i + 1}, Ink());
        port.Canvas().fillTriangle({left + 9.5, top + 2.5}, {left + 14.5, top + 2.5}, {left + 12, top + 5.5}, Ink());
    }
    if (ShowsRing())
        CDrawTools::FocusRing(port, face);
}

} // namespace Sarnik
