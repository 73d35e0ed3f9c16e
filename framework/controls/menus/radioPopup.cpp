#include "framework/controls/menus/radioPopup.h"

#include "framework/base/localisedString.h"
#include "framework/layout/layoutFlags.h"

namespace Sarnik
{

CLayoutSize CRadioPopup::NaturalSize(const CWyraVariablePropertyList &, const CTextMeasure &)
{
    return {100, naturalHeight};
}

void CRadioPopup::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CPopupControl::ReadProperties(placement, properties);
    radioBits = static_cast<std::uint32_t>(ReadFlags(properties, "radio_options"));
}

void CRadioPopup::SetItems(std::vector<std::string> texts)
{
    ClosePopup();
    items = std::move(texts);
    disabled.assign(items.size(), false);
    if (value >= items.size())
        value = 0;
    Invalidate();
}

void CRadioPopup::AddItem(std::string text)
{
    ClosePopup();
    items.push_back(std::move(text));
    disabled.push_back(false);
    Invalidate();
}

void CRadioPopup::EnableItem(unsigned index, bool enabled)
{
    if (index < items.size())
        disabled[index] = !enabled;
}

std::string CRadioPopup::ItemText(unsigned index) const
{
    return index < items.size() ? CDrawTools::SplitLabel(Localize(items[index])).text : std::string();
}

void CRadioPopup::SetValue(unsigned index)
{
    if (index == value)
        return;
    value = index;
    Invalidate();
}

std::vector<CMenuRow> CRadioPopup::PopupRows()
{
    std::vector<CMenuRow> rows;
    for (unsigned i = 0; i < items.size(); ++i)
    {
        CMenuRow row{.text = CDrawTools::SplitLabel(Localize(items[i])),
                     .keys = {},
                     .enabled = ItemEnabled(i),
                     .checked = i == value,
                     .command = {}};
        if ((radioBits & kRadio_CustomItems) != 0)
            row.draw = [this, i](CPort &port, const Platform::rectangle &room, Platform::colour ink) {
                DrawItem(port, room, i, ink);
            };
        rows.push_back(std::move(row));
    }
    return rows;
}

void CRadioPopup::MenuChosen(std::size_t row)
{
    Invalidate();
    Choose(static_cast<unsigned>(row));
}

void CRadioPopup::Choose(unsigned index)
{
    if (index == value && (radioBits & kRadio_ReportAll) == 0)
        return;
    SetValue(index);
    SendValue(kValue_Click, index);
}

void CRadioPopup::Draw(CPort &port)
{
    const Platform::rectangle face = toCanvas(PopupAnchor());
    const bool custom = (radioBits & kRadio_CustomItems) != 0;
    DrawFace(port, face, {custom ? std::string() : ItemText(value)});
    if (custom && value < items.size())
        DrawItem(port, {face.left + textCushion, face.top, face.right - arrowWidth, face.bottom}, value, Ink());
}

bool CRadioPopup::ReceiveKeyboard(CKeyboardMessage &message)
{
    using Platform::key;
    if (message.IsChar() && message.Modifiers() != Platform::altModifier && message.Character() > U' ')
    {
        const std::size_t found = typeAhead.Find(
            message.Character(), items.size(), value < items.size() ? value : CTypeAhead::none, [this](std::size_t i) {
                const auto index = static_cast<unsigned>(i);
                return ItemEnabled(index) ? ItemText(index) : std::string();
            });
        if (found == CTypeAhead::none)
            return false;
        if (found != value)
            Choose(static_cast<unsigned>(found));
        return true;
    }
    if (!message.IsDown() || message.Modifiers() != 0)
        return CPopupControl::ReceiveKeyboard(message);

    const int last = static_cast<int>(items.size()) - 1;
    const int now = value < items.size() ? static_cast<int>(value) : -1;
    int to = now, step = 1;
    switch (message.Key())
    {
    case key::up:
    case key::left:
        to = now < 0 ? last : now - 1;
        step = -1;
        break;
    case key::down:
    case key::right:
        to = now + 1;
        break;
    case key::home:
        to = 0;
        break;
    case key::end:
        to = last;
        step = -1;
        break;
    default:
        return CPopupControl::ReceiveKeyboard(message);
    }
    while (to >= 0 && to <= last && !ItemEnabled(static_cast<unsigned>(to)))
        to += step;
    if (to >= 0 && to <= last && to != now)
        Choose(static_cast<unsigned>(to));
    return true;
}

} // namespace Sarnik
