#include "gallery/galleryMenus.h"

#include <string>

namespace Stillmark
{

using namespace Sarnik;

namespace galleryCommand
{

const CObjID open("gallery/command/open"), save("gallery/command/save"), quit("gallery/command/quit"),
    undo("sarnik/command/undo"), redo("sarnik/command/redo"), about("gallery/command/about");

const CBlockID &zoomBlock()
{
    static const CBlockID block("gallery/command/zoom/Base", std::size(zoomPercents));
    return block;
}

const CBlockID &colourBlock()
{
    static const CBlockID block("gallery/command/colour/Base", 3);
    return block;
}

} // namespace galleryCommand

namespace
{

constexpr std::uint32_t ctrl = Platform::ctrlModifier, shift = Platform::shiftModifier;

void addZooms(CMenu &menu)
{
    for (const int percent : zoomPercents)
        menu.AddNumbered(std::to_string(percent) + '%');
}

} // namespace

std::unique_ptr<CMenuBar> makeGalleryMenuBar()
{
    using Platform::key;
    auto bar = std::make_unique<CMenuBar>();
    CMenu &file = bar->Add(std::make_unique<CMenu>("gallery/menu/file", "$$$/Gallery/Menu/File=&File"));
    file.Add("$$$/Gallery/Menu/Open=&Open...", galleryCommand::open, {key::o, ctrl});
    file.Add("$$$/Gallery/Menu/Save=&Save as...", galleryCommand::save, {key::s, ctrl});
    file.AddSeparator();
    file.Add("$$$/Gallery/Menu/Quit=&Quit", galleryCommand::quit, {key::q, ctrl});

    CMenu &edit = bar->Add(std::make_unique<CMenu>("gallery/menu/edit", "$$$/Gallery/Menu/Edit=E&dit"));
    edit.Add("$$$/Gallery/Menu/Undo=&Undo", galleryCommand::undo, {key::z, ctrl});
    edit.Add("$$$/Gallery/Menu/Redo=&Redo", galleryCommand::redo, {key::z, ctrl | shift});
    edit.AddSeparator();
    edit.Add("$$$/Gallery/Menu/Cut=Cu&t", "sarnik/command/cut", {key::x, ctrl});
    edit.Add("$$$/Gallery/Menu/Copy=&Copy", "sarnik/command/copy", {key::c, ctrl});
    edit.Add("$$$/Gallery/Menu/Paste=&Paste", "sarnik/command/paste", {key::v, ctrl});
    edit.Add("$$$/Gallery/Menu/SelectAll=Select &all", "sarnik/command/selectAll", {key::a, ctrl});

    addZooms(bar->Add(
        std::make_unique<CMenu>("gallery/menu/view", "$$$/Gallery/Menu/View=&View", galleryCommand::zoomBlock())));

    CMenu &help = bar->Add(std::make_unique<CMenu>("gallery/menu/help", "$$$/Gallery/Menu/Help=&Help"));
    help.Add("$$$/Gallery/Menu/About=&About the gallery", galleryCommand::about, {key::f1, 0});
    return bar;
}

std::shared_ptr<CMenu> makeZoomMenu()
{
    auto menu = std::make_shared<CMenu>("gallery/menu/zoom", "", galleryCommand::zoomBlock());
    addZooms(*menu);
    return menu;
}

std::shared_ptr<CMenu> makeActionMenu()
{
    auto menu = std::make_shared<CMenu>("gallery/menu/action");
    menu->Add("$$$/Gallery/Menu/Undo=&Undo", galleryCommand::undo);
    menu->Add("$$$/Gallery/Menu/About=&About the gallery", galleryCommand::about);
    return menu;
}

} // namespace Stillmark
