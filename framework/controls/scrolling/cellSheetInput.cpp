#include "framework/controls/scrolling/cellSheet.h"
#include "framework/views/tracker.h"

#include <algorithm>

namespace Sarnik
{

template <class Change> void CCellSheet::ChangeByUser(Change change)
{
    const int before = selection.Current();
    if (!change())
        return;
    Invalidate();
    if (selection.Current() != before && selection.Current() >= 0)
        RevealCell(selection.Current());
    SelectionChanged();
}

void CCellSheet::SelectionChanged()
{
    const int current = selection.IsSelected(selection.Current()) ? selection.Current() : Count();
    SendValue(kValue_Click, static_cast<unsigned>(current));
}

bool CCellSheet::Open(int)
{
    return SendCommand(Id());
}

bool CCellSheet::ChangeByPress(int cell, std::uint32_t modifiers)
{
    if ((modifiers & Platform::shiftModifier) != 0)
        return selection.Extend(cell);
    return (modifiers & Platform::ctrlModifier) != 0 ? selection.Toggle(cell) : selection.Select(cell);
}

/// Selects, and goes on selecting under the pointer; outside of what can be seen the timer takes it further.
class CCellSheet::selectTracker final : public CTracker
{
public:
    selectTracker(CCellSheet &inSheet, int pressedCell)
        : CTracker(inSheet), sheet(inSheet), cell(pressedCell), timer(1.0 / 15, Fire, this)
    {
    }

protected:
    bool Begin() override
    {
        // Here, since a tracker notices when its view goes.
        sheet.SelectionPress(cell, Modifiers());
        timer.Start();
        return View() != nullptr;
    }
    void Track() override
    {
        if (View() == nullptr)
            return;
        // The sheet may have been scrolled meanwhile.
        const int under = sheet.Nearest(sheet.FromWindow(CurrentInWindow()));
        if (under < 0 || under == sheet.selection.Current())
            return;
        sheet.ChangeByUser([&] {
            return sheet.Has(kCellSheet_TrackRange) ? sheet.selection.Extend(under) : sheet.selection.Select(under);
        });
    }
    void End(bool) override { timer.Stop(); }

private:
    static void Fire(void *tracker)
    {
        auto &self = *static_cast<selectTracker *>(tracker);
        if (self.Running())
            self.Track();
    }

    CCellSheet &sheet;
    int cell;
    CTimer timer;
};

void CCellSheet::SelectionClick(int cell, const CMouseEvent &e)
{
    if ((cellBits & (kCellSheet_TrackSelect | kCellSheet_TrackRange)) != 0)
        selectTracker(*this, cell).Run(e);
    else
        SelectionPress(cell, e.modifiers);
}

void CCellSheet::SelectionPress(int cell, std::uint32_t modifiers)
{
    ChangeByUser([&] { return ChangeByPress(cell, modifiers); });
}

CPoint CCellSheet::ContextPoint() const
{
    if (selection.Current() < 0)
        return CControl::ContextPoint();
    const CRect r = CellRect(selection.Current());
    return {(r.left + r.right) / 2.0, (r.top + r.bottom) / 2.0};
}

bool CCellSheet::MouseDown(const CMouseEvent &e)
{
    const int cell = CellAt(e.at);
    if (cell < 0)
    {
        if (Has(kCellSheet_DeselectOutside))
            ChangeByUser([this] { return selection.Clear(); });
        return true;
    }
    if (e.clicks == 2 && cell == selection.Current() && !e.Shift() && !e.Ctrl())
        Open(cell);
    else
        SelectionClick(cell, e);
    return true;
}

/// Where a key leads from the current cell; -1 for a key that leads nowhere.
int CCellSheet::KeyTarget(const CKeyboardMessage &message) const
{
    using Platform::key;
    const grid g = Grid();
    const bool right = Has(kCellSheet_FlowRight);
    const int now = selection.Current();
    const int sideways = right ? 1 : g.rows, upright = right ? g.columns : 1;
    const bool canSideways = g.columns > 1, canUpright = g.rows > 1;
    const auto step = [&](int by) { return now < 0 ? (by > 0 ? 0 : Count() - 1) : now + by; };

    CRect seen = Bounds();
    if (const CScroller *const scroller = CScroller::Around(*this))
        seen = scroller->VisibleRect();
    // A page is what can be seen, less a row or column.
    const bool byRows = canUpright && (right || !canSideways);
    const int page = byRows ? std::max(1, static_cast<int>(seen.Height() / g.height) - 1) * upright
                            : std::max(1, static_cast<int>(seen.Width() / g.width) - 1) * sideways;
    // Without a current cell every arrow finds one, a lone one too.
    if (now < 0 && (message.Key() == key::right || message.Key() == key::down))
        return 0;
    if (now < 0 && (message.Key() == key::left || message.Key() == key::up))
        return Count() - 1;
    int to = -1;
    switch (message.Key())
    {
    case key::left:
        to = canSideways ? step(-sideways) : -1;
        return !canSideways ? -1 : to < 0 ? now : to;
    case key::right:
        to = canSideways ? step(sideways) : -1;
        return !canSideways ? -1 : to >= Count() ? now : to;
    case key::up:
        to = canUpright ? step(-upright) : -1;
        return !canUpright ? -1 : to < 0 ? now : to;
    case key::down:
        to = canUpright ? step(upright) : -1;
        return !canUpright ? -1 : to >= Count() ? now : to;
    case key::home:
        return 0;
    case key::end:
        return Count() - 1;
    case key::pageUp:
        return std::max(0, step(-page));
    case key::pageDown:
        return std::min(Count() - 1, step(page));
    default:
        return -1;
    }
}

bool CCellSheet::MoveByKey(const CKeyboardMessage &message)
{
    const bool shift = (message.Modifiers() & Platform::shiftModifier) != 0;
    const bool ctrl = (message.Modifiers() & Platform::ctrlModifier) != 0;
    const int to = KeyTarget(message);
    if (to < 0)
        return false;
    ChangeByUser([&] {
        if (shift)
            return selection.Extend(to);
        if (ctrl && selection.Kind() == CCellSelection::kind::any)
            return selection.MakeCurrent(to);
        return selection.Select(to);
    });
    return true;
}

bool CCellSheet::ReceiveKeyboard(CKeyboardMessage &message)
{
    using Platform::key;
    if (Count() == 0)
        return false;
    const std::uint32_t modifiers = message.Modifiers();
    if (message.IsChar() && (modifiers & (Platform::altModifier | Platform::ctrlModifier)) == 0 &&
        message.Character() > U' ')
    {
        const std::size_t found =
            typeAhead.Find(message.Character(), cells.size(),
                           selection.Current() < 0 ? CTypeAhead::none : static_cast<std::size_t>(selection.Current()),
                           [this](std::size_t i) { return CellText(static_cast<int>(i)); });
        if (found == CTypeAhead::none)
            return false;
        ChangeByUser([&] { return selection.Select(static_cast<int>(found)); });
        return true;
    }
    if (!message.IsDown() || (modifiers & Platform::altModifier) != 0)
        return false;
    const bool ctrl = (modifiers & Platform::ctrlModifier) != 0;
    const int current = selection.Current();
    switch (message.Key())
    {
    case key::a:
        if (!ctrl || selection.Kind() == CCellSelection::kind::single)
            return false;
        ChangeByUser([this] { return selection.SelectAll(); });
        return true;
    case key::space:
        if (current < 0)
            return false;
        ChangeByUser([&] { return ctrl ? selection.Toggle(current) : selection.Select(current); });
        return true;
    case key::enter:
    case key::keypadEnter:
        return modifiers == 0 && current >= 0 && selection.IsSelected(current) && Open(current);
    default:
        return MoveByKey(message);
    }
}

} // namespace Sarnik
