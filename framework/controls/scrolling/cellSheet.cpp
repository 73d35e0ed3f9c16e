#include "framework/controls/scrolling/cellSheet.h"

#include "framework/views/tracker.h"

#include <algorithm>
#include <cmath>

namespace Sarnik
{
namespace
{

CCellSelection::kind kindOf(std::uint32_t options)
{
    if ((options & kCellSheet_MultiSelect) == 0)
        return CCellSelection::kind::single;
    return (options & kCellSheet_ContiguousSelect) != 0 ? CCellSelection::kind::range : CCellSelection::kind::any;
}

std::int32_t product(int count, std::int32_t size)
{
    // Far below the ends of the coordinates, so that views can be moved by it.
    return static_cast<std::int32_t>(std::min<std::int64_t>(std::int64_t{count} * size, 1 << 30));
}

} // namespace

void CCellSheetItem::Redraw()
{
    if (sheet != nullptr)
        sheet->InvalidateCell(index);
}

CCellSheet::CCellSheet(const CRect &viewFrame, std::uint32_t options) : CControl(viewFrame), cellBits(options)
{
    selection.SetKind(kindOf(options));
}

CCellSheet::~CCellSheet() = default;

void CCellSheet::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CControl::ReadProperties(placement, properties);
    // A sheet is for keys as well, whether or not the layout says that it has the focus.
    SetOptions(Options() | kView_Target);
    SetCellOptions(static_cast<std::uint32_t>(properties.Integer("cell_options", static_cast<std::int32_t>(cellBits))));
}

void CCellSheet::SetCellOptions(std::uint32_t bits)
{
    cellBits = bits;
    selection.SetKind(kindOf(bits));
    CellsChanged();
}

void CCellSheet::SetCellSize(CLayoutSize size)
{
    cellSize = {std::max(1, size.width), std::max(1, size.height)};
    CellsChanged();
}

CCellSheetItem *CCellSheet::Item(int index) const
{
    return index >= 0 && index < Count() ? cells[static_cast<std::size_t>(index)].get() : nullptr;
}

void CCellSheet::Renumber(int from)
{
    for (int i = from; i < Count(); ++i)
    {
        cells[static_cast<std::size_t>(i)]->sheet = this;
        cells[static_cast<std::size_t>(i)]->index = i;
    }
}

void CCellSheet::CellsChanged()
{
    Invalidate();
    if (CScroller *const scroller = CScroller::Around(*this))
        scroller->ContentChanged();
}

CCellSheetItem &CCellSheet::Insert(std::unique_ptr<CCellSheetItem> item, int index)
{
    index = std::clamp(index, 0, Count());
    CCellSheetItem &added = *item;
    cells.insert(cells.begin() + index, std::move(item));
    selection.Insert(index);
    Renumber(index);
    CellsChanged();
    return added;
}

std::unique_ptr<CCellSheetItem> CCellSheet::Remove(int index)
{
    if (Item(index) == nullptr)
        return nullptr;
    std::unique_ptr<CCellSheetItem> removed = std::move(cells[static_cast<std::size_t>(index)]);
    cells.erase(cells.begin() + index);
    removed->sheet = nullptr;
    removed->index = -1;
    selection.Remove(index);
    Renumber(index);
    CellsChanged();
    return removed;
}

void CCellSheet::Move(int from, int to)
{
    if (Item(from) == nullptr)
        return;
    to = std::clamp(to, 0, Count() - 1);
    const auto begin = cells.begin();
    if (from < to)
        std::rotate(begin + from, begin + from + 1, begin + to + 1);
    else
        std::rotate(begin + to, begin + from, begin + from + 1);
    selection.Move(from, to);
    Renumber(std::min(from, to));
    Invalidate();
}

void CCellSheet::RemoveAll()
{
    SetItems({});
}

void CCellSheet::SetItems(std::vector<std::unique_ptr<CCellSheetItem>> items)
{
    cells = std::move(items);
    selection.Reset(Count());
    Renumber(0);
    CellsChanged();
}

void CCellSheet::SelectIndex(int index)
{
    if (selection.Select(index))
        Invalidate();
    if (Item(index) != nullptr)
        RevealCell(index);
}

void CCellSheet::SelectAll()
{
    if (selection.SelectAll())
        Invalidate();
}

// Places.

CCellSheet::grid CCellSheet::GridFor(CLayoutSize room) const
{
    const int count = std::max(1, Count());
    const bool right = Has(kCellSheet_FlowRight);
    if (Has(kCellSheet_OneDimension))
        return right ? grid{count, 1, cellSize.width, std::max(cellSize.height, room.height)}
                     : grid{1, count, std::max(cellSize.width, room.width), cellSize.height};
    const int across = right ? std::max(1, room.width / cellSize.width) : std::max(1, room.height / cellSize.height);
    const int along = (count + across - 1) / across;
    return {right ? across : along, right ? along : across, cellSize.width, cellSize.height};
}

CCellSheet::grid CCellSheet::Grid() const
{
    return GridFor({Bounds().right, Bounds().bottom});
}

CLayoutSize CCellSheet::ContentSize(CLayoutSize seen) const
{
    const grid g = GridFor(seen);
    // In one dimension the cells give way on the other axis.
    const bool one = Has(kCellSheet_OneDimension), right = Has(kCellSheet_FlowRight);
    return {one && !right ? 0 : product(g.columns, g.width), one && right ? 0 : product(g.rows, g.height)};
}

CLayoutSize CCellSheet::ScrollStep() const
{
    return cellSize;
}

CRect CCellSheet::CellRect(int index) const
{
    const grid g = Grid();
    const bool right = Has(kCellSheet_FlowRight);
    const int column = right ? index % g.columns : index / g.rows, row = right ? index / g.columns : index % g.rows;
    const std::int32_t x = product(column, g.width), y = product(row, g.height);
    return {x, y, x + g.width, y + g.height};
}

int CCellSheet::CellAt(CPoint p) const
{
    const grid g = Grid();
    if (p.x < 0 || p.y < 0 || p.x >= 1.0 * g.columns * g.width || p.y >= 1.0 * g.rows * g.height)
        return -1;
    const int column = static_cast<int>(p.x / g.width), row = static_cast<int>(p.y / g.height);
    const int index = Has(kCellSheet_FlowRight) ? row * g.columns + column : column * g.rows + row;
    return index < Count() ? index : -1;
}

/// The cell at a point or, beside the cells, the one that is nearest; -1 for none.
int CCellSheet::Nearest(CPoint p) const
{
    const grid g = Grid();
    const auto cut = [](double v, std::int32_t size, int count) {
        return static_cast<int>(std::clamp(std::floor(v / size), 0.0, count - 1.0));
    };
    const int column = cut(p.x, g.width, g.columns), row = cut(p.y, g.height, g.rows);
    return std::min(Count() - 1, Has(kCellSheet_FlowRight) ? row * g.columns + column : column * g.rows + row);
}

int CCellSheet::InsertionAt(CPoint p) const
{
    const int at = Nearest(p);
    if (at < 0)
        return 0;
    const CRect r = CellRect(at);
    // Cells follow one another to the right where rows do not wrap into columns.
    const grid g = Grid();
    const bool sideways = Has(kCellSheet_FlowRight) || g.rows == 1;
    return at + ((sideways ? p.x >= (r.left + r.right) / 2.0 : p.y >= (r.top + r.bottom) / 2.0) ? 1 : 0);
}

void CCellSheet::RevealCell(int index)
{
    if (CScroller *const scroller = CScroller::Around(*this); scroller != nullptr && scroller->Content() == this)
        scroller->Reveal(CellRect(index));
}

// Drawing.

void CCellSheet::Draw(CPort &port)
{
    const grid g = Grid();
    const CRect &damage = port.Damage();
    const auto first = [](std::int32_t from, std::int32_t size) { return std::max(0, from / size); };
    const auto last = [](std::int32_t to, std::int32_t size, int count) {
        return std::min(count - 1, (to - 1) / size);
    };
    const bool active = HasFocus();
    for (int row = first(damage.top, g.height); row <= last(damage.bottom, g.height, g.rows); ++row)
        for (int column = first(damage.left, g.width); column <= last(damage.right, g.width, g.columns); ++column)
        {
            const int index = Has(kCellSheet_FlowRight) ? row * g.columns + column : column * g.rows + row;
            if (index >= Count())
                continue;
            const CRect cell = CellRect(index);
            const CCellSheetItem::state how{selection.IsSelected(index), selection.Current() == index, active};
            port.Canvas().save();
            port.Canvas().clip(toCanvas(cell));
            DrawCell(port, index, cell, how);
            cells[static_cast<std::size_t>(index)]->Draw(port, cell, how);
            port.Canvas().restore();
        }
}

void CCellSheet::DrawCell(CPort &port, int, const CRect &cell, const CCellSheetItem::state &how)
{
    const CPalette &c = CDrawTools::Colours();
    const Platform::rectangle r = toCanvas(cell);
    const Platform::rectangle inside{r.left + 1, r.top + 1, r.right - 1, r.bottom - 1};
    if (how.selected)
        port.Canvas().fillRounded(inside, CDrawTools::corner, how.active ? c.accent : c.accentDim);
    // Where the keyboard is among several.
    if (how.current && ShowsRing() && (!how.selected || selection.SelectedCount() > 1))
        port.Canvas().drawRounded({inside.left + 0.5, inside.top + 0.5, inside.right - 0.5, inside.bottom - 0.5},
                                  CDrawTools::corner, {.ink = c.ring, .width = 1});
}

// The user.

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
        sheet.ChangeByUser([this] { return sheet.ChangeByPress(cell, Modifiers()); });
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
        ChangeByUser([&] { return ChangeByPress(cell, e.modifiers); });
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
