#pragma once

#include "framework/controls/menus/menuList.h"
#include "framework/controls/menus/popup.h"
#include "framework/controls/typeAhead.h"

#include <cstddef>
#include <vector>

namespace Sarnik
{

/// Whoever has opened a menu. Each of these may delete the menu's window.
class CMenuListener
{
public:
    /// The window has closed.
    virtual void MenuChosen(std::size_t row) = 0;
    /// The window has closed, and nothing was chosen.
    virtual void MenuDismissed() {}
    /// Left or right was pressed: to a neighbour, if there is one.
    virtual void MenuSideways(bool) {}

protected:
    ~CMenuListener() = default;
};

/// An open menu. By the pointer: a click on a row, or the release of a press that has opened it. By keys: arrows, page
/// keys, Home and End, access letters, first letters, Enter and space; Escape, Tab and F10 close it. Interface thread.
class CMenuWindow final : public CPopup
{
public:
    /// The listener outlives the window, or closes it.
    CMenuWindow(std::vector<CMenuRow> rows, std::int32_t font, CMenuListener &toTell);

    /// By an anchor in view units of the screen; at least as wide as told.
    void OpenMenu(CWindow &by, const CRect &anchor, std::int32_t leastWidth = 0);
    CMenuList &List() const { return *list; }
    /// Keys have opened it.
    void LightFirst();

    /// While a press outside of it goes on that has opened it: the pointer's place in view units of the screen.
    void DragTo(CPoint onScreen);
    /// Its release: chooses the row there.
    void DragEnd(CPoint onScreen);
    bool Contains(CPoint onScreen) const { return toCanvas(Bounds()).contains(InList(onScreen)); }

    void Dismiss() override;
    bool KeyboardFilter(CKeyboardMessage &message) override;

private:
    CPoint InList(CPoint onScreen) const;
    void Choose(int row);
    bool Key(CKeyboardMessage &message);
    void Letter(char32_t letter);

    CMenuListener &listener;
    CMenuList *list;
    CTypeAhead typeAhead;
};

} // namespace Sarnik
