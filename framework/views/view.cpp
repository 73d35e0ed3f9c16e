#include "framework/views/view.h"

#include "framework/views/tracker.h"
#include "framework/views/window.h"

namespace Sarnik
{

CMouseEvent CMouseEvent::For(const CView &view) const
{
    CMouseEvent result = *this;
    result.at = view.FromWindow(inWindow);
    return result;
}

CView::~CView()
{
    // The tree is whole still: what the window remembers of descendants goes as well.
    if (CWindow *const window = CView::Window())
        window->Forget(*this);
    CTracker::ViewGone(*this);
    DeleteChildren();
}

bool CView::IsWithin(const CView &other) const
{
    for (const CView *at = this; at != nullptr; at = at->ParentView())
        if (at == &other)
            return true;
    return false;
}

void CView::SetFrame(const CRect &newFrame)
{
    if (newFrame == frameRect)
        return;
    Invalidate();
    const CRect old = Bounds();
    frameRect = newFrame;
    Invalidate();
    BoundsChanged(old);
    FrameChanged();
}

CRect CView::Bounds() const
{
    return {0, 0, CRect::Clamped(frameRect.Width()), CRect::Clamped(frameRect.Height())};
}

CPoint CView::ToWindow(CPoint p) const
{
    for (const CView *at = this; at != nullptr; at = at->ParentView())
        p = {p.x + at->frameRect.left, p.y + at->frameRect.top};
    return p;
}

CPoint CView::FromWindow(CPoint p) const
{
    const CPoint origin = ToWindow(CPoint{});
    return {p.x - origin.x, p.y - origin.y};
}

CRect CView::ToWindow(const CRect &r) const
{
    CRect result = r;
    for (const CView *at = this; at != nullptr; at = at->ParentView())
        result = result.Moved(at->frameRect.left, at->frameRect.top);
    return result;
}

CRect CView::VisibleInWindow() const
{
    CRect visible = Bounds();
    for (const CView *at = this; at != nullptr; at = at->ParentView())
    {
        if (at->HasOption(kView_Invisible) || at->container == nullptr)
            return {};
        visible = visible.Intersected(at->Bounds()).Moved(at->frameRect.left, at->frameRect.top);
    }
    const CWindow *const window = Window();
    return window == nullptr ? CRect{} : visible.Intersected(window->Bounds());
}

CView *CView::ViewAt(CPoint p)
{
    if (HasOption(kView_Invisible) || HasOption(kView_IgnoreMouseEvents) || !toCanvas(Bounds()).contains(p))
        return nullptr;
    for (auto child = Children().rbegin(); child != Children().rend(); ++child)
        if (CView *const found = (*child)->ViewAt({p.x - (*child)->frameRect.left, p.y - (*child)->frameRect.top}))
            return found;
    return this;
}

void CView::SetOptions(std::uint32_t bits)
{
    constexpr std::uint32_t state = kView_Invisible | kView_Disabled;
    optionBits = (optionBits & state) | (bits & ~state);
}

void CView::SetState(std::uint32_t bit, bool set)
{
    if (HasOption(bit) == set)
        return;
    Invalidate();
    optionBits ^= bit;
    Invalidate();
    TellState();
    // Last: what loses the focus may say something that deletes this view.
    if (CWindow *const window = Window())
        window->ViewStateChanged(*this);
}

void CView::TellState()
{
    for (const auto &child : Children())
        child->TellState();
    StateChanged();
}

void CView::Show(bool visible)
{
    SetState(kView_Invisible, !visible);
}

void CView::Enable(bool enabled)
{
    SetState(kView_Disabled, !enabled);
}

bool CView::AncestorsLack(std::uint32_t bit) const
{
    for (const CView *at = this; at != nullptr; at = at->ParentView())
        if (at->HasOption(bit))
            return false;
    return true;
}

bool CView::IsVisible() const
{
    return AncestorsLack(kView_Invisible);
}

bool CView::IsEnabled() const
{
    return AncestorsLack(kView_Disabled);
}

bool CView::CanFocus() const
{
    return HasOption(kView_Target) && Window() != nullptr && IsVisible() && IsEnabled();
}

bool CView::HasFocus() const
{
    const CWindow *const window = Window();
    return window != nullptr && window->Focus() == this;
}

bool CView::SetFocus()
{
    CWindow *const window = Window();
    return window != nullptr && window->SetFocus(this);
}

bool CView::HasPress() const
{
    const CWindow *const window = Window();
    return window != nullptr && window->Pressed() == this;
}

void CView::Invalidate()
{
    Invalidate(Bounds());
}

void CView::Invalidate(const CRect &part)
{
    if (CWindow *const window = Window())
        window->InvalidateRect(ToWindow(part.Intersected(Bounds())).Intersected(VisibleInWindow()));
}

void CView::SetTip(std::string enabledText, std::string disabledText)
{
    tips[0] = disabledText.empty() ? enabledText : std::move(disabledText);
    tips[1] = std::move(enabledText);
}

void CView::SetHelp(std::string enabledText, std::string disabledText)
{
    helps[0] = disabledText.empty() ? enabledText : std::move(disabledText);
    helps[1] = std::move(enabledText);
}

bool CView::TakesAccessKey(char32_t letter) const
{
    const char32_t own = AccessKey();
    return letter != 0 && letter == (own >= U'A' && own <= U'Z' ? own + (U'a' - U'A') : own);
}

CPoint CView::ContextPoint() const
{
    return {Bounds().right / 2.0, Bounds().bottom / 2.0};
}

bool CView::GetTip(CPoint, CTip &tip)
{
    const bool enabled = IsEnabled();
    tip = {tips[enabled], helps[enabled], Bounds()};
    return !tip.text.empty() || !tip.help.empty();
}

} // namespace Sarnik
