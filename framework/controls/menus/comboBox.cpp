#include "framework/controls/menus/comboBox.h"

namespace Sarnik
{

void CComboBox::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CRadioPopup::ReadProperties(placement, properties);
    SetComboOptions(static_cast<std::uint32_t>(properties.Integer("combo_options")));
}

void CComboBox::SetComboOptions(std::uint32_t bits)
{
    SetRadioOptions((bits & kCombo_CustomItems) != 0 ? RadioOptions() | kRadio_CustomItems
                                                     : RadioOptions() & ~std::uint32_t{kRadio_CustomItems});
    const bool editable = (bits & kCombo_Editable) != 0;
    if (editable == IsEditable())
        return;
    if (editable)
    {
        field = &Make<CComboField>();
        field->SetFont(FontNumber());
        ShowEntry(ItemText(Value()));
        field->told = [this](EValuePhase phase) { Typed(phase); };
        // The field has the focus in its place.
        SetOptions(Options() & ~std::uint32_t{kView_Target});
        FrameChanged();
    }
    else
    {
        Remove(*field);
        field = nullptr;
        SetOptions(Options() | kView_Target);
    }
    Invalidate();
}

unsigned CComboBox::IndexOf(std::string_view text) const
{
    for (unsigned i = 0; i < Items().size(); ++i)
        if (ItemText(i) == text)
            return i;
    return static_cast<unsigned>(Items().size());
}

std::string CComboBox::Entry() const
{
    return field != nullptr ? field->Value() : ItemText(Value());
}

void CComboBox::SetEntry(std::string_view text)
{
    CRadioPopup::SetValue(IndexOf(text));
    ShowEntry(text);
}

void CComboBox::SetIndex(unsigned index)
{
    CRadioPopup::SetValue(index);
    ShowEntry(ItemText(index));
}

void CComboBox::Typed(EValuePhase phase)
{
    // The beginning tells what there was before it.
    const std::string text = phase == kValue_EditBegin ? entered : field->Value();
    if (isFinal(phase))
        entered = text;
    CRadioPopup::SetValue(IndexOf(field->Value()));
    SendValue(phase, text);
}

void CComboBox::ShowEntry(std::string_view text)
{
    if (field == nullptr)
        return;
    entered = text;
    field->SetValue(text);
}

void CComboBox::MenuChosen(std::size_t row)
{
    ShowEntry(ItemText(static_cast<unsigned>(row)));
    CRadioPopup::MenuChosen(row);
}

void CComboBox::FrameChanged()
{
    CRadioPopup::FrameChanged();
    if (field != nullptr)
        field->SetFrame(CComboField::RoomWithin(PopupAnchor()));
}

void CComboBox::Press()
{
    if (field == nullptr)
        return CRadioPopup::Press();
    field->SetFocus();
}

bool CComboBox::ReceiveKeyboard(CKeyboardMessage &message)
{
    // Keys that the field does not use: those that open, but not those that choose in a closed popup.
    return field != nullptr ? CPopupControl::ReceiveKeyboard(message) : CRadioPopup::ReceiveKeyboard(message);
}

void CComboBox::Draw(CPort &port)
{
    if (field == nullptr)
        return CRadioPopup::Draw(port);
    CComboField::DrawAround(port, PopupAnchor(), Face(), field->HasFocus());
}

} // namespace Sarnik
