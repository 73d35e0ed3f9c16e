#pragma once

#include "framework/controls/menus/menuWindow.h"
#include "framework/views/mouseEvent.h"

#include <memory>
#include <vector>

namespace Sarnik
{

class CView;

/// Opens menus over a view that has it as a member, for ContextClick and the menu key. What is open goes with it. The
/// commands climb from the view. Interface thread.
///
///     bool ContextClick(const CMouseEvent &e) override { return contextMenu.Open(menu, e); }
class CContextMenu final : private CMenuListener
{
public:
    explicit CContextMenu(CView &over) : view(over) {}

    /// At a point of the view. False where the menu has no rows. The menu may be gone or changed while it is open.
    bool Open(CMenu &menu, CPoint at, bool byKeyboard = false);
    /// For a ContextClick.
    bool Open(CMenu &menu, const CMouseEvent &e) { return Open(menu, e.at, e.button == 0); }
    void Close();
    bool IsOpen() const { return popup != nullptr && popup->IsOpen(); }
    CMenuWindow *Popup() const { return IsOpen() ? popup.get() : nullptr; }

private:
    void MenuChosen(std::size_t row) override;

    CView &view;
    CObjID openMenu;
    std::vector<CObjID> commands;
    std::unique_ptr<CMenuWindow> popup;
};

} // namespace Sarnik
