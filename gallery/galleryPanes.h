#pragma once

#include "framework/controls/control.h"
#include "framework/controls/menus/contextMenu.h"
#include "framework/controls/scrolling/listBox.h"
#include "framework/views/dragDrop.h"

#include <functional>
#include <string>
#include <vector>

namespace Stillmark
{

/// A coloured field with a context menu; the menu's commands choose its colour. The class "galleryContextPane" of
/// layouts.
class contextPane final : public Sarnik::CControl
{
public:
    contextPane();

    bool ContextClick(const Sarnik::CMouseEvent &e) override { return context.Open(menu, e.at); }
    bool MouseDown(const Sarnik::CMouseEvent &) override { return SetFocus(); }
    /// The menu key, and Shift with F10.
    bool ReceiveKeyboard(Sarnik::CKeyboardMessage &message) override;
    bool UpdateCommand(Sarnik::CCommandMessage &message) override;
    bool ReceiveCommand(Sarnik::CCommandMessage &message) override;
    void Draw(Sarnik::CPort &port) override;

private:
    int colour = 0;
    Sarnik::CMenu menu;
    Sarnik::CContextMenu context{*this};
};

/// A list of the files that were dropped on it. The class "galleryFileList" of layouts.
class fileList final : public Sarnik::CListBox, public Sarnik::CDropTarget
{
public:
    bool DragEnter(const Sarnik::CDragData &data, Sarnik::CPoint) override { return !data.files.empty(); }
    void Drop(const Sarnik::CDragData &data, Sarnik::CPoint) override;
    void Append(const std::vector<std::string> &paths);

    std::function<void(const std::vector<std::string> &)> dropped;

private:
    std::vector<std::string> shown;
};

/// One number, in its own cell of a sheet.
class numberCell final : public Sarnik::CCellSheetItem
{
public:
    explicit numberCell(int n) : number(n) {}

    void Draw(Sarnik::CPort &port, const Sarnik::CRect &cell, const state &how) override;
    std::string Text() const override { return std::to_string(number); }

private:
    int number;
};

/// Sees to it that layouts know the classes above, and "galleryDisclosure".
void enterGalleryBuilders();

} // namespace Stillmark
