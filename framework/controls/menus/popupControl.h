#pragma once

#include "framework/controls/control.h"
#include "framework/controls/menus/menuWindow.h"

#include <cstdint>
#include <memory>
#include <vector>

namespace Sarnik
{

/// A control that opens a menu beside itself: by a press, by space, F4, or Alt with an arrow up or down. The press may
/// go on to a row and be released there. What is open goes with the control, and when it is hidden or disabled.
class CPopupControl : public CControl, protected CMenuListener
{
public:
    explicit CPopupControl(const CRect &viewFrame = {}, std::uint32_t viewOptions = kView_Target | kView_TabStop)
        : CControl(viewFrame, viewOptions)
    {
    }

    /// Does nothing to an open one, a disabled or hidden control, and one without rows. byKeyboard: a row is lit.
    void OpenPopup(bool byKeyboard = true);
    void ClosePopup();
    bool IsOpen() const { return popup != nullptr && popup->IsOpen(); }
    /// The open menu; null for none.
    CMenuWindow *Popup() const { return IsOpen() ? popup.get() : nullptr; }

    void Press() override;
    bool MouseDown(const CMouseEvent &e) override;
    void MouseMove(const CMouseEvent &e) override;
    void MouseUp(const CMouseEvent &e) override;
    bool ReceiveKeyboard(CKeyboardMessage &message) override;
    void StateChanged() override;
    void FrameChanged() override { ClosePopup(); }

protected:
    virtual std::vector<CMenuRow> PopupRows() = 0;
    /// The row that is lit first; none for the first one, where the keyboard has opened it.
    virtual int CurrentRow() const { return CMenuList::none; }
    /// What the menu opens beside, in the control's coordinates, and its least width.
    virtual CRect PopupAnchor() const;
    virtual std::int32_t PopupWidth() const { return PopupAnchor().right - PopupAnchor().left; }
    /// Whether a press there opens the menu.
    virtual bool OpensAt(CPoint) const { return true; }
    void MenuDismissed() override { Invalidate(); }

    EFace Face() const;
    /// A face with a text and an arrow, as popups have it.
    void DrawFace(CPort &port, const Platform::rectangle &face, const CDrawTools::label &text) const;
    static constexpr std::int32_t naturalHeight = 24, arrowWidth = 20, textCushion = 5;

private:
    CPoint OnScreen(CPoint p) const { return Window()->ToScreen(ToWindow(p)); }

    std::unique_ptr<CMenuWindow> popup;
};

} // namespace Sarnik
