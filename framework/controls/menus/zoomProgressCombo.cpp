#include "framework/controls/menus/zoomProgressCombo.h"

#include <algorithm>
#include <cmath>

namespace Sarnik
{
namespace
{

/// Of the combo, ring included, in a control that has room for the bar beside it.
constexpr std::int32_t comboWidth = 84, gap = 8, leastBar = 24, barHeight = 6;

} // namespace

CZoomProgressCombo::CZoomProgressCombo(const CRect &viewFrame)
    : CMenuPopup(viewFrame, kView_NoOptions), field(&Make<CComboField>()), bar(&Make<CProgressBar>())
{
    field->told = [this](EValuePhase phase) { Typed(phase); };
    bar->Show(false);
    SetZoom(1);
    FrameChanged();
}

void CZoomProgressCombo::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CMenuPopup::ReadProperties(placement, properties);
    SetOptions(Options() & ~std::uint32_t{kView_Target}); // the field has the focus
    field->SetFont(FontNumber());
    FrameChanged();
}

std::string CZoomProgressCombo::Percentage(double factor)
{
    const double percent = std::clamp(std::isnan(factor) ? 0 : factor * 100, 0.0, 1e9);
    // A little more, since 0.29 times 100 is a little less than 29.
    const auto whole = static_cast<long long>(percent + 1e-6);
    return (whole > 0 ? std::to_string(whole) : CNumberFormat{kNumber_Decimal, 1, 0}.Text(percent)) + "%";
}

void CZoomProgressCombo::SetZoom(double factor)
{
    zoom = factor;
    const std::string text = Percentage(zoom);
    if (field->Value() == text)
        return;
    field->SetValue(text);
    // What is typed next replaces it.
    if (field->HasFocus())
        field->Select(0, text.size());
}

void CZoomProgressCombo::Typed(EValuePhase phase)
{
    if (phase != kValue_EditEnd)
        return;
    std::string text = field->Value();
    std::erase(text, '%');
    const std::optional<double> percent = CNumberFormat::Parse(text);
    const double wanted = percent && *percent > 0 ? range.Cut(*percent / 100) : zoom;
    const bool changed = Percentage(wanted) != Percentage(zoom) || std::abs(wanted - zoom) > 0.005;
    // What the receiver makes of it comes back by SetZoom; without one the text is the zoom's own.
    SetZoom(changed ? wanted : zoom);
    if (changed)
        SendValue(kValue_EditEnd, CNumber{wanted});
}

void CZoomProgressCombo::SetProgress(double share)
{
    bar->SetValue(share);
    bar->Show(bar->Frame().Width() >= leastBar);
}

void CZoomProgressCombo::EndProgress()
{
    bar->Show(false);
}

CRect CZoomProgressCombo::PopupAnchor() const
{
    CRect face = CMenuPopup::PopupAnchor();
    if (Bounds().right >= comboWidth + gap + leastBar)
        face.right = comboWidth - CDrawTools::ringRoom;
    return face;
}

void CZoomProgressCombo::FrameChanged()
{
    CMenuPopup::FrameChanged();
    const CRect face = PopupAnchor();
    field->SetFrame(CComboField::RoomWithin(face));
    const std::int32_t left = face.right + CDrawTools::ringRoom + gap, top = (Bounds().bottom - barHeight) / 2;
    bar->SetFrame({left, top, std::max(left, Bounds().right), top + barHeight});
}

bool CZoomProgressCombo::ReceiveKeyboard(CKeyboardMessage &message)
{
    // Up and down have no other use in the field.
    using Platform::key;
    if (message.IsDown() && message.Modifiers() == 0 && (message.Key() == key::down || message.Key() == key::up))
    {
        OpenPopup();
        return true;
    }
    return CMenuPopup::ReceiveKeyboard(message);
}

void CZoomProgressCombo::Draw(CPort &port)
{
    CComboField::DrawAround(port, PopupAnchor(), Face(), field->HasFocus());
}

} // namespace Sarnik
