#pragma once

#include "framework/controls/menus/comboField.h"
#include "framework/controls/menus/radioPopup.h"

#include <string>
#include <string_view>

namespace Sarnik
{

/// As layouts write them.
enum EComboOptions : std::uint32_t
{
    kCombo_NoOptions = 0,
    kCombo_Editable = 1,
    kCombo_CustomItems = 2
};

/// One item of several or, with kCombo_Editable, any text. The class "CComboBox" of layouts, with the property
/// combo_options. A chosen item is told as by a CRadioPopup, a typed text by CValMsg<std::string> in the phases of an
/// edit.
class CComboBox : public CRadioPopup
{
public:
    using CRadioPopup::CRadioPopup;

    bool IsEditable() const { return field != nullptr; }
    void SetComboOptions(std::uint32_t bits);
    /// What the field holds, or the chosen item's text.
    std::string Entry() const;
    /// Tells nobody. The value becomes that of the item of this text, or of none.
    void SetEntry(std::string_view text);
    /// As SetValue of a CRadioPopup; the text follows.
    void SetIndex(unsigned index);
    CComboField *Field() const { return field; }

    void Draw(CPort &port) override;
    bool ReceiveKeyboard(CKeyboardMessage &message) override;
    void FrameChanged() override;
    void FocusWithinChanged() override { Invalidate(); }
    void Press() override;

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;
    void MenuChosen(std::size_t row) override;

private:
    unsigned IndexOf(std::string_view text) const;
    void Typed(EValuePhase phase);
    void ShowEntry(std::string_view text);

    CComboField *field = nullptr;
    std::string entered; ///< before what is being typed
};

} // namespace Sarnik
