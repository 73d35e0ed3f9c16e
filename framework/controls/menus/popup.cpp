#include "framework/controls/menus/popup.h"

#include "framework/views/application.h"

#include <algorithm>

namespace Sarnik
{

CRect popupFrame(const CRect &anchor, std::int32_t width, std::int32_t height, const CRect &area, std::int32_t least)
{
    const std::int64_t below = std::int64_t{area.bottom} - anchor.bottom;
    const std::int64_t above = std::int64_t{anchor.top} - area.top;
    const bool under = below >= height || below >= above;
    std::int64_t tall = std::min<std::int64_t>(height, std::max<std::int64_t>(under ? below : above, least));
    tall = std::min(tall, area.Height());
    const std::int64_t wide = std::min<std::int64_t>(width, area.Width());

    const auto within = [](std::int64_t v, std::int64_t low, std::int64_t high) {
        return std::max(low, std::min(v, high));
    };
    const std::int64_t left = within(anchor.left, area.left, area.right - wide);
    const std::int64_t top = within(under ? anchor.bottom : anchor.top - tall, area.top, area.bottom - tall);
    return {CRect::Clamped(left), CRect::Clamped(top), CRect::Clamped(left + wide), CRect::Clamped(top + tall)};
}

CPopup::CPopup(Platform::colour background)
    : CWindow(CWindowSettings{{}, Platform::windowKind::popup, 0, {}, background})
{
}

CRect CPopup::WorkArea()
{
    return wholeWithin(CApplication::Current()->Display().workArea());
}

void CPopup::OpenBy(CWindow &by, const CRect &anchor, std::int32_t width, std::int32_t height, std::int32_t least)
{
    if (IsOpen())
        return;
    CRect frame = popupFrame(anchor, width, height, WorkArea(), least);
    CWindowSettings with = Settings();
    with.frame = frame;
    SetSettings(std::move(with));
    Open(&by);
    // On a screen to the left or above, where coordinates are negative, these would count as shares of the room.
    SetFrame(frame);
    CApplication::Current()->PushPopup(*this);
}

bool CPopup::KeyboardFilter(CKeyboardMessage &message)
{
    if (!message.IsDown() || message.Key() != Platform::key::escape)
        return false;
    Dismiss();
    return true;
}

} // namespace Sarnik
