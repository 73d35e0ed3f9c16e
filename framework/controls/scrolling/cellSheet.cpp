#include "framework/controls/scrolling/cellSheet.h"

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

} // namespace Sarnik
