#include "framework/controls/menus/popupControl.h"

#include <cmath>

namespace Sarnik
{

CRect CPopupControl::PopupAnchor() const
{
    const CRect all = Bounds();
    constexpr std::int32_t ring = CDrawTools::ringRoom;
    return {all.left + ring, all.top + ring, all.right - ring, all.bottom - ring};
}

void CPopupControl::OpenPopup(bool byKeyboard)
{
    if (IsOpen() || Window() == nullptr || !Window()->IsOpen() || !IsVisible() || !IsEnabled())
        return;
    std::vector<CMenuRow> rows = PopupRows();
    if (rows.empty())
        return;
    const CRect anchor = ToWindow(PopupAnchor());
    const CPoint corner = Window()->ToScreen({});
    popup = std::make_unique<CMenuWindow>(std::move(rows), FontNumber(), static_cast<CMenuListener &>(*this));
    popup->OpenMenu(*Window(), anchor.Moved(std::llround(corner.x), std::llround(corner.y)), PopupWidth());
    popup->List().Light(CurrentRow());
    if (byKeyboard)
        popup->LightFirst();
    Invalidate();
}

void CPopupControl::ClosePopup()
{
    if (IsOpen())
        popup->Dismiss();
}

void CPopupControl::Press()
{
    const std::weak_ptr<const void> alive = Life();
    SetFocus();
    if (!alive.expired())
        OpenPopup();
}

bool CPopupControl::MouseDown(const CMouseEvent &e)
{
    if (!OpensAt(e.at))
        return false;
    OpenPopup(false);
    return true;
}

void CPopupControl::MouseMove(const CMouseEvent &e)
{
    if (HasPress() && IsOpen())
        popup->DragTo(OnScreen(e.at));
}

void CPopupControl::MouseUp(const CMouseEvent &e)
{
    if (!IsOpen())
        return;
    // A release over the control leaves the menu open: a click has opened it.
    if (toCanvas(Bounds()).contains(e.at))
        return popup->List().PointNowhere();
    const CPoint at = OnScreen(e.at);
    if (popup->Contains(at))
        popup->DragEnd(at);
    else
        ClosePopup();
}

bool CPopupControl::ReceiveKeyboard(CKeyboardMessage &message)
{
    using Platform::key;
    if (!message.IsDown())
        return false;
    const bool upDown = message.Key() == key::up || message.Key() == key::down;
    const bool plain = message.Modifiers() == 0;
    if (!(plain && (message.Key() == key::space || message.Key() == key::f4)) &&
        !(upDown && message.Modifiers() == Platform::altModifier))
        return false;
    OpenPopup();
    return true;
}

void CPopupControl::StateChanged()
{
    if (!IsVisible() || !IsEnabled())
        ClosePopup();
    CControl::StateChanged();
}

EFace CPopupControl::Face() const
{
    return !IsEnabled() ? EFace::disabled : IsOpen() ? EFace::pressed : IsHot() ? EFace::hot : EFace::normal;
}

void CPopupControl::DrawFace(CPort &port, const Platform::rectangle &face, const CDrawTools::label &text) const
{
    CDrawTools::Face(port, face, Face());
    CDrawTools::Text(port, {face.left + textCushion, face.top, face.right - arrowWidth, face.bottom}, text, Font(),
                     Ink());
    CDrawTools::Chevron(port, {face.right - arrowWidth, face.top, face.right, face.bottom}, CDrawTools::direction::down,
                        Ink());
    if (ShowsRing())
        CDrawTools::FocusRing(port, face);
}

} // namespace Sarnik
