#pragma once

#include "framework/base/link.h"
#include "framework/base/process.h"
#include "framework/messages/messages.h"
#include "framework/views/context.h"
#include "framework/views/damage.h"
#include "framework/views/mouseEvent.h"
#include "framework/views/port.h"
#include "framework/views/tips.h"
#include "platform/window/display.h"

#include <map>
#include <string>
#include <vector>

namespace Sarnik
{

class CApplication;
class CView;
class CTracker;
class CDragSession;
struct CTip;

/// Bits of a window's features, as layouts write them.
enum EWindowFeatures : std::uint32_t
{
    kWin_CanClose = 1,
    kWin_CanMove = 2,
    kWin_CanSize = 4,
    kWin_OpenHidden = 1024,
    kWin_AutoDelete = 2048, ///< owned by the application from the opening to the closing
    kWin_DropFiles = 8192
};

/// What a window is made as.
struct CWindowSettings
{
    std::string title; ///< to be localised
    Platform::windowKind kind = Platform::windowKind::normal;
    std::uint32_t features = kWin_CanClose | kWin_CanMove;
    /// In view units of the screen. A corner from -100 to -1 is a share of the free room in hundredths: -50, -33 lies
    /// in the middle and a third from above.
    CRect frame{-50, -33, 350, 167};
    Platform::colour background{83, 83, 83};
};

/// A top-level window: the root of a tree of views, with what it shows, the focus, the keyboard's order and a modal
/// loop. Interface thread. Opens on the display of the current CApplication.
class CWindow : public CContext, public CExecutable, public CLink<CWindow>
{
public:
    explicit CWindow(CWindowSettings with = {});
    ~CWindow() override;

    CObjID Id() const { return id; }
    void SetId(CObjID newId) { id = newId; }

    // On the screen.
    /// Shows it, unless kWin_OpenHidden. An owner keeps it in front of itself. Throws CError where there is no display.
    void Open(CWindow *owner = nullptr);
    void Close();
    bool IsOpen() const { return screen != nullptr; }
    void Show(bool visible);
    bool IsVisible() const { return screen != nullptr && screen->visible(); }
    void Activate();
    bool IsActive() const;
    void SetTitle(std::string title);
    /// Of the content, in view units of the screen.
    CRect Frame() const;
    void SetFrame(const CRect &newFrame);
    /// The frame with which an open window, with what the display draws around it, fills the screen less the system's
    /// bars but for a margin.
    CRect LargestFrame(std::int32_t margin = 0) const;
    CRect Bounds() const override;
    CPoint ToScreen(CPoint p) const;
    CWindow *Window() const override { return const_cast<CWindow *>(this); }
    CWindow *Owner() const { return owner; }
    Platform::window *Screen() const { return screen.get(); }
    const CWindowSettings &Settings() const { return settings; }
    /// For the next opening; children follow a changed size. Does nothing to an open window.
    void SetSettings(CWindowSettings with);

    // The modal loop.
    /// As long as it lives the window is open, and other windows but those that this one owns get no input; for who
    /// has work of his own to do between turns of the loop. Closes the window at its end.
    class modalSession
    {
    public:
        /// Opens the window if it is not. Throws CError where there is no display.
        explicit modalSession(CWindow &over, CWindow *owner = nullptr);
        ~modalSession();
        modalSession(const modalSession &) = delete;
        modalSession &operator=(const modalSession &) = delete;

    private:
        CApplication &application;
        CWindow &window;
    };
    /// Opens the window if it is not, and runs until EndModal, End or the closing: with what it ended, none for the
    /// closing. Other windows but those that this one owns get no input. Closes the window. Throws CError where the
    /// display is lost.
    CObjID RunModal(CWindow *owner = nullptr);
    void EndModal(CObjID result);
    /// The user wants it to go.
    virtual void CloseRequested();

    // Views.
    /// The front-most visible view at a point; null for none.
    CView *ViewAt(CPoint p) const;
    CView *Focus() const { return focus; }
    /// Null takes the focus from all. False where the view cannot have it, or has gone with what the one before said
    /// as it lost it; the window may have gone, too.
    bool SetFocus(CView *view);
    /// To the next view in tab order, or the one before, around the ends. False where there is none.
    bool MoveFocus(bool forward);
    std::vector<CView *> TabOrder() const;
    /// Whether the user finds the way by keyboard, so that the view with the focus is marked: from the tab key, an
    /// arrow or Alt until the next press of the pointer.
    bool ShowsFocus() const { return showsFocus; }
    /// The views that Enter and Escape press when nobody else wants these keys. Null for none.
    void SetDefaultView(CView *view) { defaultView = view; }
    void SetCancelView(CView *view) { cancelView = view; }
    /// The one that F10 presses: a menu bar. Null for none.
    void SetMenuView(CView *view) { menuView = view; }
    CView *Hovered() const { return hovered; }
    /// The view that a press goes on in; null for none, and while a tracker runs of no meaning.
    CView *Pressed() const { return pressed; }
    /// A subtree is about to go, or to leave.
    void Forget(CView &view);
    void ViewStateChanged(CView &view);

    // Keyboard: the filter, then the view with the focus and its chain, then shortcuts, then access keys, tab, Enter
    // and Escape.
    /// Sees every key first; true keeps it from all others.
    virtual bool KeyboardFilter(CKeyboardMessage &) { return false; }
    bool HandleKeyboard(CKeyboardMessage &message);
    void AddShortcut(CShortcut keys, CObjID command) { shortcuts[keys] = command; }

    // Commands go to the view with the focus and up from there.
    /// That view; the window itself where none has the focus.
    CMessenger &Leaf();
    bool SendCommand(CObjID command);
    struct commandState
    {
        bool enabled = false, checked = false;
        std::string text; ///< localised
    };
    commandState QueryCommand(CObjID command);

    // Drawing.
    void Invalidate() { InvalidateRect(Bounds()); }
    void InvalidateRect(const CRect &rect);
    const CDamage &Damage() const { return damage; }
    /// Draws and shows what is marked. Whether there was any.
    bool Paint();
    /// When something was first marked after the last paint.
    double DamagedSince() const { return damagedSince; }

    // Help, tips and pointer.
    /// The view under the pointer offers its help; empty where it has none. Localised.
    virtual void SetHelp(const std::string &) {}
    /// What to say at a point where the views there have no tip, or no help.
    virtual bool GetTip(CPoint, CTip &) { return false; }
    /// As if the pointer had moved to where it is: something under it has changed, or a modifier key. While a press or
    /// a tracker has the pointer only its shape is asked for.
    void RefreshPointer();
    /// Where the pointer was last seen.
    CPoint Pointer() const { return pointer; }
    bool PointerInside() const { return pointerInside; }

    /// A press outside while it is the application's front-most popup, or a lost keyboard.
    virtual void Dismiss() { Close(); }
    virtual void ActiveChanged(bool) {}
    virtual void FrameChanged() {}

    void SetDrag(CDragSession *by) { drag = by; }
    void SetTracking(CTracker *by);
    bool IsTracking() const { return tracker != nullptr; }

private:
    friend class CApplication;
    void Handle(const Platform::event &e);
    void HandlePointer(const Platform::event &e);
    void HandleDown(CMouseEvent &e);
    void HandleWheel(CMouseEvent &e);
    void HandleDrop(const Platform::event &e);
    void HandleResize();
    void EndPress();
    void Hover(CView *view, const CMouseEvent &e);
    void UpdateCursor();
    bool PressAccessKey(char32_t character);
    bool ContextClickByKey();
    void SetShowsFocus(bool shows);
    void DrawChildren(const CContext &of, Platform::canvas &canvas, std::span<const CRect> parts, const CRect &clip,
                      CPoint origin);

    CWindowSettings settings;
    CObjID id;
    std::unique_ptr<Platform::window> screen;
    CWindow *owner = nullptr;
    CView *focus = nullptr, *hovered = nullptr, *pressed = nullptr;
    CView *defaultView = nullptr, *cancelView = nullptr, *menuView = nullptr;
    CTracker *tracker = nullptr;
    CDragSession *drag = nullptr;
    CTipWatch tips{*this};
    std::map<CShortcut, CObjID> shortcuts;
    CDamage damage;
    double damagedSince = 0;
    CPoint pointer;
    bool pointerInside = false;
    bool showsFocus = false;
    bool trackerRan = false; ///< within the press that is being handled
    Platform::cursor cursor;
    CObjID modalResult;
};

} // namespace Sarnik
