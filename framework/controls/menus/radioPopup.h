#pragma once

#include "framework/controls/menus/popupControl.h"

#include <cstdint>
#include <string>
#include <vector>

namespace Sarnik
{

/// As layouts write them.
enum ERadioOptions : std::uint32_t
{
    kRadio_NoOptions = 0,
    kRadio_CustomItems = 1, ///< items are drawn by DrawItem
    kRadio_ReportAll = 2    ///< a choice is told even where it is the value already
};

/// One item of several, chosen from a menu. The class "CRadioPopup" of layouts. The value is the item's index, told by
/// CValMsg<unsigned> of phase kValue_Click. While it is closed, arrows, Home and End and first letters change the value
/// at once.
class CRadioPopup : public CPopupControl
{
public:
    using CPopupControl::CPopupControl;

    /// Texts to be localised. The value stays where it is an item's, otherwise the first is chosen.
    void SetItems(std::vector<std::string> texts);
    void AddItem(std::string text);
    const std::vector<std::string> &Items() const { return items; }
    void EnableItem(unsigned index, bool enabled);
    std::uint32_t RadioOptions() const { return radioBits; }
    void SetRadioOptions(std::uint32_t bits) { radioBits = bits; }

    unsigned Value() const { return value; }
    /// Tells nobody. An index of no item shows nothing.
    void SetValue(unsigned index);

    void Draw(CPort &port) override;
    bool ReceiveKeyboard(CKeyboardMessage &message) override;

    /// The width is the layout's business: items come later.
    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure);

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;
    std::string_view FontProperty() const override { return "menu_font"; }
    std::vector<CMenuRow> PopupRows() override;
    int CurrentRow() const override { return static_cast<int>(value); }
    void MenuChosen(std::size_t row) override;

    /// With kRadio_CustomItems: an item in the menu or in the closed control.
    virtual void DrawItem(CPort &, const Platform::rectangle &, unsigned, Platform::colour) {}
    /// The control may be gone afterwards.
    void Choose(unsigned index);
    std::string ItemText(unsigned index) const;

private:
    bool ItemEnabled(unsigned index) const { return index < items.size() && !disabled[index]; }

    std::vector<std::string> items;
    std::vector<bool> disabled;
    std::uint32_t radioBits = kRadio_NoOptions;
    unsigned value = 0;
    CTypeAhead typeAhead;
};

} // namespace Sarnik
