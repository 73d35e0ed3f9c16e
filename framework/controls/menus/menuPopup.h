#pragma once

#include "framework/controls/menus/popupControl.h"

#include <memory>

namespace Sarnik
{

/// A button with a text that opens a menu of commands. The class "CMenuPopup" of layouts. The commands climb from the
/// button.
class CMenuPopup : public CPopupControl
{
public:
    using CPopupControl::CPopupControl;

    /// Null for none: the button then opens nothing.
    void SetMenu(std::shared_ptr<CMenu> toOpen);
    CMenu *Menu() const { return menu.get(); }

    void Draw(CPort &port) override;

    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure);

protected:
    std::string_view FontProperty() const override { return "menu_font"; }
    std::vector<CMenuRow> PopupRows() override;
    std::int32_t PopupWidth() const override { return 0; }
    void MenuChosen(std::size_t row) override;

private:
    std::shared_ptr<CMenu> menu;
    std::vector<CObjID> commands; ///< of the open menu
    CObjID openMenu;
};

/// The same as a small icon: of its name, or three lines. The class "CFlyoutPopup" of layouts.
class CFlyoutPopup : public CMenuPopup
{
public:
    using CMenuPopup::CMenuPopup;

    void SetIcon(std::string name);
    void Draw(CPort &port) override;

    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure);

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;

private:
    std::string icon;
};

} // namespace Sarnik
