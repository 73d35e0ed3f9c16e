#pragma once

#include "framework/controls/control.h"
#include "framework/views/timer.h"

#include <cstdint>

namespace Sarnik
{

/// As layouts write them.
enum EScrollbarStyle : std::int32_t
{
    kScrollbarStyle_Default = 0,
    kScrollbarStyle_Outline = 1,
    kScrollbarStyle_Fernway = 2,
    kScrollbarStyle_FernwayMini = 3 ///< thinner
};

/// Moves a value between 0 and a largest one: a thumb in a track, as long as the part of the whole that can be seen. A
/// press beside the thumb goes a page towards the pointer, again and again until the thumb is there. The classes
/// "CScrollBar" and "CCustomScrollbar" of layouts. It lies along its longer side. Each change by the user climbs as a
/// CScrollMessage of its id, with the value as x or y. It has no focus: keys are for what it scrolls.
class CScrollBar : public CControl
{
public:
    explicit CScrollBar(const CRect &viewFrame = {}) : CControl(viewFrame, kView_NoFocusOnClick) {}

    /// All in units of what is scrolled. total: its length; page: what can be seen of it; both at least 0.
    void SetRange(double total, double page);
    /// What a line and a page move. 0: a tenth of the page, and the page less a line.
    void SetSteps(double line, double page);
    double Value() const { return value; }
    /// Cut to the range. Tells nobody.
    void SetValue(double newValue);
    double Largest() const { return total > page ? total - page : 0; }
    double LineStep() const;
    double PageStep() const;
    bool IsVertical() const { return Bounds().bottom > Bounds().right; }
    EScrollbarStyle Style() const { return style; }
    void SetStyle(EScrollbarStyle to);

    /// The width of a bar of a style.
    static std::int32_t Thickness(EScrollbarStyle style) { return style == kScrollbarStyle_FernwayMini ? 8 : 13; }
    /// Where the thumb lies in the view; empty where there is nothing to scroll.
    Platform::rectangle Thumb() const;

    void Draw(CPort &port) override;
    bool MouseDown(const CMouseEvent &e) override;
    bool MouseWheel(const CMouseEvent &e) override;

    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure);

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;

private:
    class thumbTracker;
    class pageTracker;

    double Along(CPoint p) const { return IsVertical() ? p.y : p.x; }
    double Track() const { return IsVertical() ? Bounds().bottom : Bounds().right; }
    /// The user goes to a value. The bar may be gone afterwards where it was another one.
    void GoTo(double newValue);

    EScrollbarStyle style = kScrollbarStyle_Default;
    double total = 0, page = 0, value = 0;
    double lineStep = 0, pageStep = 0;
    bool dragging = false;
};

} // namespace Sarnik
