#pragma once

#include "framework/controls/menus/menuBar.h"

#include <memory>

namespace Stillmark
{

/// The commands that the gallery's menus send; those of an edit are the program's own.
namespace galleryCommand
{

using Sarnik::CObjID;

extern const CObjID open, save, quit, undo, redo, about;
/// One for each zoom of zoomPercents.
const Sarnik::CBlockID &zoomBlock();
/// Three colours.
const Sarnik::CBlockID &colourBlock();

} // namespace galleryCommand

inline constexpr int zoomPercents[] = {25, 50, 100, 200, 400};

std::unique_ptr<Sarnik::CMenuBar> makeGalleryMenuBar();
std::shared_ptr<Sarnik::CMenu> makeZoomMenu();
/// About and quit.
std::shared_ptr<Sarnik::CMenu> makeActionMenu();

} // namespace Stillmark
