#include "framework/controls/menus/comboField.h"

namespace Sarnik
{
namespace
{

constexpr std::int32_t textCushion = 5;

} // namespace

CRect CComboField::RoomWithin(const CRect &face)
{
    return {face.left + textCushion, face.top + 1, face.right - arrowWidth, face.bottom - 1};
}

void CComboField::DrawAround(CPort &port, const CRect &face, EFace state, bool ring)
{
    const bool enabled = state != EFace::disabled;
    const Platform::rectangle r = toCanvas(face);
    const CPalette &c = CDrawTools::Colours();
    CDrawTools::Field(port, r, enabled);
    const Platform::rectangle arrow{r.right - arrowWidth, r.top, r.right, r.bottom};
    if (state == EFace::hot || state == EFace::pressed)
        port.Canvas().fillRounded({arrow.left + 1, arrow.top + 2, arrow.right - 2, arrow.bottom - 2},
                                  CDrawTools::corner, state == EFace::hot ? c.menu : c.groove);
    CDrawTools::Chevron(port, arrow, CDrawTools::direction::down, enabled ? c.text : c.textDim);
    if (ring)
        CDrawTools::FocusRing(port, r);
}

} // namespace Sarnik
