#pragma once

#include "framework/controls/control.h"
#include "framework/controls/scrolling/cellSelection.h"
#include "framework/controls/scrolling/scroller.h"
#include "framework/controls/typeAhead.h"

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

namespace Sarnik
{

class CCellSheet;

/// As layouts write them.
enum ECellSheetOptions : std::uint32_t
{
    kCellSheet_NoOptions = 0,
    kCellSheet_FlowRight = 1,    ///< rows from left to right; otherwise columns from top to bottom
    kCellSheet_OneDimension = 2, ///< one row, or one column: cells are as high, or as wide, as the sheet
    kCellSheet_MultiSelect = 32,
    kCellSheet_ContiguousSelect = 64, ///< of several cells, only those that follow one another
    kCellSheet_TrackSelect = 128,     ///< a drag goes on selecting
    kCellSheet_TrackRange = 256,      ///< a drag selects from where it began
    kCellSheet_DeselectOutside = 512  ///< a press beside the cells selects none
};

/// One cell of a sheet. The sheet owns it.
class CCellSheetItem
{
public:
    /// How a cell stands.
    struct state
    {
        bool selected = false, current = false;
        bool active = false; ///< the sheet has the focus
    };

    CCellSheetItem() = default;
    CCellSheetItem(const CCellSheetItem &) = delete;
    CCellSheetItem &operator=(const CCellSheetItem &) = delete;
    virtual ~CCellSheetItem() = default;

    /// Null outside of any.
    CCellSheet *Sheet() const { return sheet; }
    int Index() const { return index; }
    /// Marks the cell for redraw.
    void Redraw();

    /// In the sheet's coordinates, on top of what the sheet draws for a selected cell.
    virtual void Draw(CPort &port, const CRect &cell, const state &how) = 0;
    /// What typed letters find it by.
    virtual std::string Text() const { return {}; }

private:
    friend class CCellSheet;
    CCellSheet *sheet = nullptr;
    int index = -1;
};

/// Cells in rows or columns, to be looked at and selected: by clicks (Ctrl adds, Shift reaches), drags, arrows (with
/// Shift and Ctrl likewise), page keys, Home and End, Ctrl+A, space and first letters. It is made to lie in a
/// CScroller, and grows with its cells. The class "CCellSheet" of layouts.
///
/// A change by the user climbs as a CValMsg<unsigned> of phase kValue_Click, with the current cell (the count for
/// none); Enter and a double click call Open.
class CCellSheet : public CControl, public CScrollContent
{
public:
    explicit CCellSheet(const CRect &viewFrame = {}, std::uint32_t options = kCellSheet_NoOptions);
    ~CCellSheet() override;

    // Cells. What is selected stays so with its cell; nobody is told.
    int Count() const { return static_cast<int>(cells.size()); }
    CCellSheetItem *Item(int index) const;
    /// From 0 to the count.
    CCellSheetItem &Insert(std::unique_ptr<CCellSheetItem> item, int index);
    CCellSheetItem &Append(std::unique_ptr<CCellSheetItem> item) { return Insert(std::move(item), Count()); }
    /// Hands it out; null where there is none.
    std::unique_ptr<CCellSheetItem> Remove(int index);
    /// `to` counts without it.
    void Move(int from, int to);
    void RemoveAll();
    /// All at once.
    void SetItems(std::vector<std::unique_ptr<CCellSheetItem>> items);

    // Selection by the program: nobody is told. The cell comes into sight.
    const CCellSelection &Selection() const { return selection; }
    int Current() const { return selection.Current(); }
    void SelectIndex(int index);
    void SelectAll();
    std::uint32_t CellOptions() const { return cellBits; }
    void SetCellOptions(std::uint32_t bits);

    // Places, in the sheet's coordinates.
    CLayoutSize CellSize() const { return cellSize; }
    /// At least 1 each. With kCellSheet_OneDimension the cells take the sheet's other dimension.
    void SetCellSize(CLayoutSize size);
    CRect CellRect(int index) const;
    /// -1 beside the cells.
    int CellAt(CPoint p) const;
    /// Before which cell something dropped there would come: 0 to the count.
    int InsertionAt(CPoint p) const;
    void RevealCell(int index);
    void InvalidateCell(int index) { Invalidate(CellRect(index)); }

    CLayoutSize ContentSize(CLayoutSize seen) const override;
    CLayoutSize ScrollStep() const override;
    void Scrolled() override {}

    void Draw(CPort &port) override;
    bool MouseDown(const CMouseEvent &e) override;
    CPoint ContextPoint() const override;
    bool ReceiveKeyboard(CKeyboardMessage &message) override;
    void FrameChanged() override { Invalidate(); }

    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &, const CTextMeasure &) { return {40, 20}; }

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;

    /// A press on a cell, as far as the selection goes, with the drag that follows where the options say so. The sheet
    /// may be gone afterwards.
    void SelectionClick(int cell, const CMouseEvent &e);
    /// The same without a drag, for who lets a drag that follows do something else. The sheet may be gone afterwards.
    void SelectionPress(int cell, std::uint32_t modifiers);
    /// Enter or a double click on a cell: by default the command of the sheet's id. Whether anybody wanted it.
    virtual bool Open(int cell);
    /// Below the cell's own drawing: by default what shows that it is selected.
    virtual void DrawCell(CPort &port, int index, const CRect &cell, const CCellSheetItem::state &how);
    /// Of every selection by the user; by default the message. The sheet may be gone afterwards.
    virtual void SelectionChanged();
    virtual std::string CellText(int index) const { return cells[static_cast<std::size_t>(index)]->Text(); }

private:
    class selectTracker;

    struct grid
    {
        int columns, rows;
        std::int32_t width, height; ///< of a cell
    };
    grid GridFor(CLayoutSize room) const;
    grid Grid() const;
    bool Has(ECellSheetOptions bit) const { return (cellBits & bit) != 0; }
    void Renumber(int from);
    void CellsChanged();
    template <class Change> void ChangeByUser(Change change);
    bool ChangeByPress(int cell, std::uint32_t modifiers);
    int Nearest(CPoint p) const;
    int KeyTarget(const CKeyboardMessage &message) const;
    bool MoveByKey(const CKeyboardMessage &message);

    std::vector<std::unique_ptr<CCellSheetItem>> cells;
    CCellSelection selection;
    CLayoutSize cellSize{40, 20};
    std::uint32_t cellBits;
    CTypeAhead typeAhead;
};

} // namespace Sarnik
