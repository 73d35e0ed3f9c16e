#pragma once

#include "framework/controls/fields/numberFormat.h"
#include "framework/controls/menus/comboField.h"
#include "framework/controls/menus/menuPopup.h"
#include "framework/controls/panes/progressBar.h"

namespace Sarnik
{

/// A zoom factor as a percentage, typed or chosen from a menu, and beside it a thin bar while something is computed.
/// The class "CZoomProgressCombo" of layouts. A typed zoom is told by CValMsg<CNumber> of phase kValue_EditEnd, as a
/// factor cut to the range; what the menu's items do is their commands' business, which climb from here.
class CZoomProgressCombo : public CMenuPopup
{
public:
    explicit CZoomProgressCombo(const CRect &viewFrame = {});

    /// 1 is 100%. The percentage is shown without its fraction, as a menu of zooms names them: two thirds are 66%.
    /// Tells nobody.
    void SetZoom(double factor);
    double Zoom() const { return zoom; }
    /// Of typed zooms.
    void SetRange(double least, double most) { range = {least, most}; }

    /// 0 to 1 while something is under way; the bar shows.
    void SetProgress(double share);
    void EndProgress();
    CProgressBar &Progress() const { return *bar; }
    CComboField &Field() const { return *field; }

    static std::string Percentage(double factor);

    void Draw(CPort &port) override;
    bool ReceiveKeyboard(CKeyboardMessage &message) override;
    void FrameChanged() override;
    void FocusWithinChanged() override { Invalidate(); }
    void Press() override { field->SetFocus(); }

    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &, const CTextMeasure &)
    {
        return {170, naturalHeight};
    }

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;
    CRect PopupAnchor() const override;
    bool OpensAt(CPoint p) const override { return p.x < PopupAnchor().right + CDrawTools::ringRoom; }

private:
    void Typed(EValuePhase phase);

    CComboField *field;
    CProgressBar *bar;
    double zoom = 1;
    CNumberRange range{0.001, 16};
};

} // namespace Sarnik
