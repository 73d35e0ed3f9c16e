#pragma once

#include "framework/controls/buttons/buttonLook.h"
#include "framework/controls/control.h"

#include <string>
#include <vector>

namespace Sarnik
{

/// All buttons, and the class "CButton" of layouts: button_kind says what it does, button_style what it looks like.
///
/// A press by the pointer, by space or by the access key ends in a click. A check button then has its new value, a
/// radio button is on and the others of its group are off; a CValMsg<EButtonValue> of phase kValue_Click tells so. A
/// push button sends one with kOn, and where nobody takes it the command of its id.
///
/// Leaving a button while it is pressed lets it up, coming back presses it again; Escape and a lost keyboard end the
/// press without a click. Interface thread.
class CButton : public CControl
{
public:
    explicit CButton(const CRect &viewFrame = {}, EButtonKind buttonKind = kPushButton,
                     std::uint32_t viewOptions = kView_Target | kView_TabStop)
        : CControl(viewFrame, viewOptions), kind(buttonKind)
    {
    }

    EButtonKind Kind() const { return kind; }
    void SetKind(EButtonKind to) { kind = to; }
    EButtonStyle Style() const { return style; }
    void SetStyle(EButtonStyle to);
    EButtonValue Value() const { return value; }
    /// A radio button that goes on puts the others of its group off. Push buttons have no value.
    void SetValue(EButtonValue to);
    bool IsOn() const { return value == kOn; }
    /// Clicks lead from off to on to neutral; without it a neutral button goes on.
    void SetTriState(bool has) { triState = has; }
    /// A picture by its name (iconSource.h), and another one for the button that is on.
    void SetIcon(std::string name, std::string nameWhenOn = {});
    bool IsPressed() const { return pressed; }

    void Press() override;
    bool IsTabStop() const override;
    bool MouseDown(const CMouseEvent &e) override;
    bool ReceiveKeyboard(CKeyboardMessage &message) override;
    void FocusChanged(bool has) override;
    void StateChanged() override;
    void Draw(CPort &port) override;

    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure);

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;
    std::string_view FontProperty() const override { return "push_button_font"; }

    /// The user has pressed and released it, `clicks` times in a row. The button may be gone afterwards.
    virtual void Click(int clicks);
    /// Tells groups with the same parent apart.
    virtual CObjID GroupId() const { return {}; }
    /// Radio buttons of which one is on, in their order, this one among them: those of the same parent and id.
    virtual std::vector<CButton *> Group();
    /// The style where the layout has none.
    virtual EButtonStyle OwnStyle() const;
    virtual bool IsProminent() const { return false; }
    /// A push button was clicked, and nobody took its value.
    virtual void SendClick() { SendCommand(Id()); }

    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure,
                                   EButtonStyle ownStyle, std::string_view fontProperty);

private:
    class pressTracker;
    void SetPressed(bool down);
    bool MoveInGroup(int step);

    EButtonKind kind;
    EButtonStyle style = kButtonStyle_Default;
    EButtonValue value = kOff;
    bool triState = false;
    bool pressed = false, spaceDown = false;
    std::string icons[2]; ///< off, on
    double iconX = 0, iconY = 0;
};

} // namespace Sarnik
