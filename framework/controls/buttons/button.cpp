#include "framework/controls/buttons/button.h"

#include "framework/base/localisedString.h"
#include "framework/views/tracker.h"

#include <algorithm>
#include <cmath>

namespace Sarnik
{

/// A press by the pointer: the button is down as long as the pointer is over it.
class CButton::pressTracker final : public CTracker
{
public:
    explicit pressTracker(CButton &b) : CTracker(b), button(b) {}

    bool Begin() override
    {
        Track();
        return true;
    }
    void Track() override { button.SetPressed(toCanvas(button.Bounds()).contains(CurrentPoint())); }
    void End(bool) override
    {
        if (View() == nullptr)
            return;
        inside = button.IsPressed() && button.IsVisible() && button.IsEnabled();
        button.SetPressed(false);
    }
    bool Inside() const { return inside; }

private:
    CButton &button;
    bool inside = false;
};

void CButton::SetStyle(EButtonStyle to)
{
    style = to;
    Invalidate();
}

void CButton::SetValue(EButtonValue to)
{
    if (value == to || kind == kPushButton || kind == kCTAGroupButton)
        return;
    value = to;
    Invalidate();
    if (kind == kRadioButton && to == kOn)
        for (CButton *const other : Group())
            if (other != this)
                other->SetValue(kOff);
}

void CButton::SetIcon(std::string name, std::string nameWhenOn)
{
    if (icons[0] == name && icons[1] == nameWhenOn)
        return;
    icons[0] = std::move(name);
    icons[1] = std::move(nameWhenOn);
    Invalidate();
}

void CButton::SetPressed(bool down)
{
    if (pressed == down)
        return;
    pressed = down;
    Invalidate();
}

void CButton::Press()
{
    if (!IsEnabled() || !IsVisible())
        return;
    const std::weak_ptr<const void> alive = Life();
    if (kind == kCheckButton || kind == kRadioButton)
        SetFocus();
    if (!alive.expired())
        Click(1);
}

bool CButton::MouseDown(const CMouseEvent &e)
{
    spaceDown = false;
    const int clicks = e.clicks;
    pressTracker press(*this);
    // Where the button has gone meanwhile, the tracker was aborted.
    if (press.Run(e) && press.Inside())
        Click(clicks);
    return true;
}

bool CButton::ReceiveKeyboard(CKeyboardMessage &message)
{
    using Platform::key;
    const bool down = message.IsDown();
    if (spaceDown && down && message.Key() == key::escape)
    {
        spaceDown = false;
        SetPressed(false);
        return true;
    }
    if (message.Key() == key::space)
    {
        if (down && message.Modifiers() == 0)
        {
            spaceDown = spaceDown || !message.Repeat();
            SetPressed(spaceDown);
            return true;
        }
        if (!spaceDown || message.Id() != CKeyboardMessage::KeyUp)
            return false;
        spaceDown = false;
        SetPressed(false);
        Click(1);
        return true;
    }
    if (kind != kRadioButton || !down || message.Modifiers() != 0)
        return false;
    const bool back = message.Key() == key::left || message.Key() == key::up;
    return (back || message.Key() == key::right || message.Key() == key::down) && MoveInGroup(back ? -1 : 1);
}

/// To the next button of the group that can be chosen, around the ends.
bool CButton::MoveInGroup(int step)
{
    std::vector<CButton *> group = Group();
    std::erase_if(group, [](const CButton *b) { return !b->CanFocus(); });
    const auto at = std::find(group.begin(), group.end(), this) - group.begin();
    const auto count = static_cast<std::ptrdiff_t>(group.size());
    if (at == count || count < 2)
        return false;
    CButton *const next = group[static_cast<std::size_t>((at + step + count) % count)];
    if (next->SetFocus())
        next->Click(1);
    return true;
}

std::vector<CButton *> CButton::Group()
{
    std::vector<CButton *> group;
    if (Container() == nullptr)
        return {this};
    for (const auto &child : Container()->Children())
        if (auto *const button = dynamic_cast<CButton *>(child.get());
            button != nullptr && button->kind == kRadioButton && button->GroupId() == GroupId())
            group.push_back(button);
    return group;
}

bool CButton::IsTabStop() const
{
    if (!CControl::IsTabStop() || kind != kRadioButton || value == kOn)
        return CControl::IsTabStop();
    // Of a group without a choice the first one that can have the focus.
    const std::vector<CButton *> group = const_cast<CButton *>(this)->Group();
    for (const CButton *const other : group)
        if (other->value == kOn && other->CanFocus())
            return false;
    const auto first = std::find_if(group.begin(), group.end(), [](const CButton *b) { return b->CanFocus(); });
    return first != group.end() && *first == this;
}

void CButton::FocusChanged(bool has)
{
    if (!has && spaceDown)
    {
        spaceDown = false;
        SetPressed(false);
    }
    CControl::FocusChanged(has);
}

void CButton::StateChanged()
{
    if (spaceDown && !(IsEnabled() && IsVisible()))
    {
        spaceDown = false;
        SetPressed(false);
    }
    CControl::StateChanged();
}

void CButton::Click(int)
{
    switch (kind)
    {
    case kCheckButton:
        SetValue(value == kOff ? kOn : value == kOn ? (triState ? kNeutral : kOff) : triState ? kOff : kOn);
        break;
    case kRadioButton:
        if (value == kOn)
            return;
        SetValue(kOn);
        break;
    default:
        // Who takes a message may delete its sender; nobody did.
        if (!SendValue(kValue_Click, kOn))
            SendClick();
        return;
    }
    SendValue(kValue_Click, value);
}

EButtonStyle CButton::OwnStyle() const
{
    return kind == kCheckButton ? kButtonStyle_Check : kind == kRadioButton ? kButtonStyle_Radio : kButtonStyle_Push;
}

void CButton::Draw(CPort &port)
{
    CButtonLook look;
    look.style = style == kButtonStyle_Default ? OwnStyle() : style;
    look.value = value;
    look.enabled = IsEnabled();
    look.hot = IsHot() && look.enabled;
    look.pressed = pressed;
    look.prominent = IsProminent();
    look.ring = ShowsRing();
    look.label = Label();
    look.font = Font();
    look.icon = value == kOn && !icons[1].empty() ? icons[1] : icons[0];
    look.iconX = iconX;
    look.iconY = iconY;
    look.Draw(port, Room());
}

void CButton::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CControl::ReadProperties(placement, properties);
    if (std::int32_t number = 0; properties.ReadInteger("button_kind", &number) && number >= 0 && number <= 3)
        kind = static_cast<EButtonKind>(number);
    if (std::int32_t number = 0; properties.ReadInteger("button_style", &number) && number >= 0 && number <= 11)
        style = static_cast<EButtonStyle>(number);
    triState = properties.Boolean("tri_state", triState);
    icons[0] = properties.Text("icon");
    const std::int32_t offset = properties.Integer("icon_offset");
    iconX = properties.Integer("icon_offset_x", offset);
    iconY = properties.Integer("icon_offset_y", offset);
}

CLayoutSize CButton::NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure)
{
    const std::int32_t kind = properties.Integer("button_kind");
    return NaturalSize(properties, measure,
                       kind == kCheckButton   ? kButtonStyle_Check
                       : kind == kRadioButton ? kButtonStyle_Radio
                                              : kButtonStyle_Push,
                       "push_button_font");
}

CLayoutSize CButton::NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure,
                                 EButtonStyle ownStyle, std::string_view fontProperty)
{
    CLayoutSize text, icon;
    if (const std::string words = properties.LocalisedText("text"); !words.empty())
        text = measure.Measure(words, ReadFont(properties, fontProperty));
    if (const CIcon picture = CIconSource::Icon(properties.Text("icon"), 1))
        icon = {static_cast<std::int32_t>(std::ceil(picture.Width())),
                static_cast<std::int32_t>(std::ceil(picture.Height()))};
    const std::int32_t number = properties.Integer("button_style");
    return CButtonLook::Size(number > 0 && number <= 11 ? static_cast<EButtonStyle>(number) : ownStyle, text, icon);
}

} // namespace Sarnik
