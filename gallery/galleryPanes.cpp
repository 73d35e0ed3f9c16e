#include "gallery/galleryPanes.h"

#include "framework/controls/panes/disclosurePane.h"
#include "gallery/galleryMenus.h"

#include <utility>

namespace Stillmark
{

using namespace Sarnik;

namespace
{

constexpr Platform::colour colours[] = {{120, 84, 72}, {76, 110, 84}, {74, 94, 136}};

} // namespace

contextPane::contextPane()
    : menu("gallery/menu/context", "$$$/Gallery/Menu/Context=Context", galleryCommand::colourBlock())
{
    for (const char *const name :
         {"$$$/Gallery/Menu/Red=&Red", "$$$/Gallery/Menu/Green=&Green", "$$$/Gallery/Menu/Blue=&Blue"})
        menu.AddNumbered(name);
}

bool contextPane::ReceiveKeyboard(CKeyboardMessage &message)
{
    using Platform::key;
    const bool wanted =
        message.Key() == key::menu || (message.Key() == key::f10 && message.Modifiers() == Platform::shiftModifier);
    return message.IsDown() && wanted && context.Open(menu, {8, 8}, true);
}

bool contextPane::UpdateCommand(CCommandMessage &message)
{
    const int index = galleryCommand::colourBlock().IndexOf(message.Id());
    message.enabled = index >= 0;
    message.checked = index == colour;
    return index >= 0;
}

bool contextPane::ReceiveCommand(CCommandMessage &message)
{
    const int index = galleryCommand::colourBlock().IndexOf(message.Id());
    if (index < 0)
        return false;
    colour = index;
    Invalidate();
    return SendValue(kValue_Click, static_cast<unsigned>(index));
}

void contextPane::Draw(CPort &port)
{
    const Platform::rectangle room = Room();
    const Platform::rectangle face{room.left + CDrawTools::ringRoom, room.top + CDrawTools::ringRoom,
                                   room.right - CDrawTools::ringRoom, room.bottom - CDrawTools::ringRoom};
    port.Canvas().fillRectangle(face, colours[colour]);
    CDrawTools::Text(port, room, "right click", Font(), Ink(), kAlign_Center);
    if (ShowsRing())
        CDrawTools::FocusRing(port, face, 0);
}

void fileList::Drop(const CDragData &data, CPoint)
{
    Append(data.files);
    if (dropped)
        dropped(data.files);
}

void fileList::Append(const std::vector<std::string> &paths)
{
    shown.insert(shown.end(), paths.begin(), paths.end());
    List().SetTexts(shown);
    List().RevealCell(List().Count() - 1);
}

void numberCell::Draw(CPort &port, const CRect &cell, const state &)
{
    CDrawTools::Text(port, toCanvas(cell), Text(), CDrawTools::Font(kFont_UILarge), CDrawTools::Colours().text,
                     kAlign_Center);
}

void enterGalleryBuilders()
{
    static const CPaneBuilder<contextPane> context("galleryContextPane");
    static const CPaneBuilder<fileList> files("galleryFileList");
    static const CPaneBuilder<CDisclosurePane> disclosure("galleryDisclosure");
}

} // namespace Stillmark
