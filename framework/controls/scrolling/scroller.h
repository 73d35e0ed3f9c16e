#pragma once

#include "framework/controls/layoutPane.h"
#include "framework/controls/scrolling/scrollBar.h"
#include "framework/controls/scrolling/scrollerGeometry.h"

#include <cstdint>

namespace Sarnik
{

/// More bits of a view's binding: the axes on which a scroller moves it.
enum EScrollBinding : std::uint32_t
{
    kBind_XScrollable = 256,
    kBind_YScrollable = 512,
    kBind_Scrollable = 768
};

/// A view in a scroller that knows how large it is, and wants to know what of it is seen.
class CScrollContent
{
public:
    /// How large it wants to be where so much of it can be seen. What is smaller is given all that can be seen.
    virtual CLayoutSize ContentSize(CLayoutSize seen) const = 0;
    /// What an arrow key moves; a notch of the wheel moves three of them.
    virtual CLayoutSize ScrollStep() const { return {16, 16}; }
    /// Another part of it is seen.
    virtual void Scrolled() {}

protected:
    ~CScrollContent() = default;
};

/// Shows a part of a view that is larger than the room, with scroll bars. The class "CScroller" of layouts, with the
/// content as its kInterior_ScrollerPane child; the content may be a CScrollContent, otherwise it is as large as it
/// came. An axis scrolls where the content's binding says so or, where it says so for none, where there is a bar. The
/// wheel scrolls, with Shift sideways; so do arrows, page keys, Home and End that nobody within wants.
///
/// Positions are whole view units of the content. Where the user scrolls a CScrollMessage of the scroller's id climbs;
/// where the program does nobody but the content is told.
class CScroller : public CLayoutPane
{
public:
    explicit CScroller(const CRect &viewFrame = {}, std::uint32_t scrollerAttributes = kScroller_AllBars);

    static constexpr std::uint32_t kScroller_AllBars = kScroller_XBar | kScroller_YBar;

    /// Takes the place of the one before, or of one that was taken out of its parent view.
    CView &SetContent(std::unique_ptr<CView> view);
    CView *Content() const { return content; }
    std::uint32_t Attributes() const { return attributes; }
    void SetAttributes(std::uint32_t bits);
    void SetStyle(EScrollbarStyle to);
    /// A view beside a bar, as wide or as high as the gap.
    void SetGap(EScrollerInterior where, std::int32_t size);
    const CScrollerGeometry &Geometry() const { return geometry; }

    /// The content wants another size. The position stays as far as it can.
    void ContentChanged() { Arrange(); }
    /// The content's point that is seen at the top left, cut to what can be.
    CPoint Position() const;
    CPoint Largest() const;
    void ScrollTo(CPoint to) { MoveTo(to); }
    /// What of the content is seen, in its coordinates.
    CRect VisibleRect() const;
    /// Scrolls by as little as needed until a part of the content is seen; of what is larger its top and left.
    void Reveal(const CRect &part);

    /// As ScrollTo, by the user: the message tells.
    void UserScrollTo(CPoint to);

    void FrameChanged() override { Arrange(); }
    void FocusWithinChanged() override { Invalidate(); }
    void Draw(CPort &port) override;
    bool MouseWheel(const CMouseEvent &e) override;
    bool ReceiveKeyboard(CKeyboardMessage &message) override;
    bool ReceiveMessage(CMessage &message) override;

    /// The innermost scroller around a view; null for none.
    static CScroller *Around(const CView &view);

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;
    void TakeChild(std::unique_ptr<CView> child, std::int32_t interior) override;
    void ChildLeft(const CView &gapView) override;

private:
    /// Shows of the content what is within.
    class CWell : public CPane
    {
    protected:
        void ChildLeft(const CView &content) override;
    };

    bool Scrolls(std::uint32_t axis, std::uint32_t bar) const;
    CLayoutSize Wanted(CLayoutSize seen) const;
    CLayoutSize Step() const;
    void Arrange();
    bool MoveTo(CPoint to);
    void PlaceContent(CPoint to, CLayoutSize size);

    CWell *well;
    CScrollBar *xBar, *yBar;
    CView *content = nullptr;
    CScrollContent *informed = nullptr; ///< the content, where it is one
    CView *gapViews[4] = {};            ///< left, top, right, bottom
    std::uint32_t attributes;
    EScrollbarStyle style = kScrollbarStyle_Default;
    CScrollerGeometry::gaps gaps;
    CScrollerGeometry geometry;
    CLayoutSize natural; ///< of a content that does not know
    bool arranging = false;
};

} // namespace Sarnik
