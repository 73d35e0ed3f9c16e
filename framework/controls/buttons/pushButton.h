#pragma once

#include "framework/controls/buttons/button.h"

namespace Sarnik
{

/// A button with a label. The window's default one (default_button) is drawn prominent, and Enter presses it from
/// anywhere; its cancel one (cancel_button) is pressed by Escape. Enter presses the push button with the focus itself.
///
/// An OK or cancel button (ok_button, cancel_button) whose click nobody takes, neither the value nor the command, ends
/// the modal loop of its window with its own id.
class CPushButton : public CButton
{
public:
    explicit CPushButton(const CRect &viewFrame = {}) : CButton(viewFrame, kPushButton) {}

    void SetDefault(bool is);
    void SetCancel(bool is);
    void SetOk(bool is) { ok = is; }

    bool ReceiveKeyboard(CKeyboardMessage &message) override;
    void LayoutDone() override;

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;
    bool IsProminent() const override { return isDefault; }
    void SendClick() override;

private:
    bool isDefault = false, cancel = false, ok = false;
};

} // namespace Sarnik
