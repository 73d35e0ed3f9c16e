#pragma once

#include "framework/views/context.h"
#include "framework/views/mouseEvent.h"
#include "framework/views/port.h"
#include "framework/views/viewOptions.h"
#include "platform/window/display.h"

#include <string>

namespace Sarnik
{

/// What is said about a view. Texts to be localised.
struct CTip
{
    std::string text; ///< in a small window at the pointer
    std::string help; ///< in the window's help line
    CRect rect;       ///< where it holds, in the view's coordinates
};

/// A rectangle of a window that takes part in messages, focus and pointer, and may hold others. Interface thread.
class CView : public CContext
{
public:
    explicit CView(const CRect &viewFrame = {}, std::uint32_t viewOptions = 0)
        : frameRect(viewFrame), optionBits(viewOptions)
    {
    }
    ~CView() override;

    CObjID Id() const { return viewId; }
    void SetId(CObjID newId) { viewId = newId; }

    // Place.
    /// In the parent's coordinates.
    const CRect &Frame() const { return frameRect; }
    /// Children follow by their bindings.
    void SetFrame(const CRect &newFrame);
    CRect Bounds() const override;
    std::uint32_t Binding() const { return bindingBits; }
    void SetBinding(std::uint32_t bits) { bindingBits = bits; }
    CContext *Container() const { return container; }
    /// Null where the container is the window, or there is none.
    CView *ParentView() const { return container == nullptr ? nullptr : container->AsView(); }
    CView *AsView() override { return this; }
    CWindow *Window() const override { return container == nullptr ? nullptr : container->Window(); }
    bool IsWithin(const CView &other) const;
    CPoint ToWindow(CPoint p) const;
    CPoint FromWindow(CPoint p) const;
    CRect ToWindow(const CRect &r) const;
    /// What of it no ancestor's edge cuts off, in the window's coordinates; empty where it or an ancestor is hidden.
    CRect VisibleInWindow() const;
    /// The front-most visible view at a point of this one's coordinates, itself included; null outside.
    CView *ViewAt(CPoint p);

    // State.
    std::uint32_t Options() const { return optionBits; }
    /// Only bits without a state of their own change by this: use Show and Enable for the others.
    void SetOptions(std::uint32_t bits);
    bool HasOption(std::uint32_t bit) const { return (optionBits & bit) != 0; }
    void Show(bool visible);
    void Enable(bool enabled);
    /// With all ancestors.
    bool IsVisible() const;
    bool IsEnabled() const;

    // Focus.
    virtual bool CanFocus() const;
    /// Whether the tab key stops at it, where it can have the focus. Of a group the chosen one does.
    virtual bool IsTabStop() const { return HasOption(kView_TabStop); }
    bool HasFocus() const;
    /// As CWindow::SetFocus.
    bool SetFocus();

    // Drawing.
    /// Marks for redraw, all or a part in its own coordinates. Drawing waits for the next paint.
    void Invalidate();
    void Invalidate(const CRect &part);
    /// Draws itself, without its children, which follow.
    virtual void Draw(CPort &) {}

    // Tips. Empty texts leave it to the parent.
    void SetTip(std::string enabledText, std::string disabledText = {});
    void SetHelp(std::string enabledText, std::string disabledText = {});
    /// What to say at a point; false for nothing.
    virtual bool GetTip(CPoint at, CTip &tip);
    /// Alt with this letter presses the view; 0 for none.
    virtual char32_t AccessKey() const { return 0; }
    /// For views of several access keys; the letter is lower case.
    virtual bool TakesAccessKey(char32_t letter) const;
    virtual void PressAccessKey(char32_t) { Press(); }
    /// Its access key, or as the window's default or cancel view.
    virtual void Press() { SetFocus(); }

    // Pointer. True takes the press; the view then gets the moves and the release, unless it ran a tracker. What nobody
    // takes goes on to the parent view.
    virtual bool MouseDown(const CMouseEvent &) { return false; }
    virtual void MouseUp(const CMouseEvent &) {}
    /// Whether it has taken a press that goes on. One ends without a release where a modal window opens, or the view is
    /// hidden or disabled.
    bool HasPress() const;
    /// While the pointer is over it, or since it took a press.
    virtual void MouseMove(const CMouseEvent &) {}
    virtual void MouseEnter() {}
    virtual void MouseLeave() {}
    virtual bool MouseWheel(const CMouseEvent &) { return false; }
    /// A press of the other button or, with the button 0, the menu key, for views with kView_ContextClick.
    virtual bool ContextClick(const CMouseEvent &) { return false; }
    /// Where the menu key clicks; by default the middle.
    virtual CPoint ContextPoint() const;
    /// The shape of the pointer over it: false leaves it to the parent.
    virtual bool CursorAt(CPoint, Platform::cursor &) { return false; }

    // Told after the fact.
    virtual void FrameChanged() {}
    virtual void FocusChanged(bool) {}
    /// The focus has come to one of its descendants, or left it, or is marked otherwise than before.
    virtual void FocusWithinChanged() {}
    /// The view or an ancestor was shown, hidden, enabled or disabled.
    virtual void StateChanged() {}

private:
    friend class CContext;
    bool AncestorsLack(std::uint32_t bit) const;
    void SetState(std::uint32_t bit, bool set);
    void TellState();

    CContext *container = nullptr;
    CRect frameRect;
    std::uint32_t optionBits, bindingBits = 0;
    CObjID viewId;
    std::string tips[2], helps[2]; ///< disabled, enabled
};

/// A view that draws.
class CPane : public CView
{
public:
    using CView::CView;
};

} // namespace Sarnik
