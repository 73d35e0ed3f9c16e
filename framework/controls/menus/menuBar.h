#pragma once

#include "framework/controls/control.h"
#include "framework/controls/menus/menuWindow.h"

#include <cstddef>
#include <memory>
#include <vector>

namespace Sarnik
{

/// The menus of a window, from left to right.
class CMenuBar
{
public:
    virtual ~CMenuBar() = default;

    CMenu &Add(std::unique_ptr<CMenu> menu);
    const std::vector<std::unique_ptr<CMenu>> &Menus() const { return menus; }

private:
    std::vector<std::unique_ptr<CMenu>> menus;
};

/// Shows the titles of a menu bar and opens its menus: by a press, from which the pointer may go on to other titles and
/// to a row; by F10 and Alt with a title's access key, which is its marked letter or the first one that no other title
/// has. Left and right go between menus. A menu without items is dim and opens nothing. The class "CMenuBarPane" of
/// layouts. Commands go to the view with the focus and climb from there.
class CMenuBarPane : public CControl, private CMenuListener
{
public:
    static constexpr std::size_t none = static_cast<std::size_t>(-1);

    explicit CMenuBarPane(const CRect &viewFrame = {}) : CControl(viewFrame, kView_NoFocusOnClick) {}

    /// In its window: the window learns the shortcuts of the items, and whose F10 is.
    void SetMenuBar(std::unique_ptr<CMenuBar> newBar);
    CMenuBar *MenuBar() const { return bar.get(); }

    void OpenMenu(std::size_t index, bool byKeyboard = true);
    void CloseMenu();
    /// Of the open menu.
    std::size_t Opened() const { return IsOpen() ? opened : none; }
    CMenuWindow *Popup() const { return IsOpen() ? popup.get() : nullptr; }

    CRect TitleRect(std::size_t index) const { return titles[index].place; }
    std::size_t TitleAt(CPoint p) const;

    void Draw(CPort &port) override;
    void MouseLeave() override;
    bool MouseDown(const CMouseEvent &e) override;
    void MouseMove(const CMouseEvent &e) override;
    void MouseUp(const CMouseEvent &e) override;
    bool TakesAccessKey(char32_t letter) const override;
    void PressAccessKey(char32_t letter) override;
    void Press() override;
    void StateChanged() override;

    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &, const CTextMeasure &) { return {0, 26}; }

protected:
    std::string_view FontProperty() const override { return "menu_bar_font"; }
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;

private:
    struct title
    {
        CDrawTools::label text;
        CRect place;
        bool usable;
    };

    bool IsOpen() const { return popup != nullptr && popup->IsOpen(); }
    void Arrange();
    void AssignKeys();
    void Heat(std::size_t index);
    std::size_t WithKey(char32_t letter) const;
    std::size_t Usable(std::size_t from, bool forward) const;
    CPoint OnScreen(CPoint p) const { return Window()->ToScreen(ToWindow(p)); }
    void MenuChosen(std::size_t row) override;
    void MenuDismissed() override;
    void MenuSideways(bool forward) override;

    std::unique_ptr<CMenuBar> bar;
    std::vector<title> titles;
    std::vector<CObjID> commands; ///< of the open menu
    std::size_t opened = none, hot = none;
    std::int32_t menuFont = kFont_UIMedium;
    std::unique_ptr<CMenuWindow> popup;
};

} // namespace Sarnik
