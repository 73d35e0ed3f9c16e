#pragma once

#include <vector>

namespace Sarnik
{

/// Which of a row of cells are selected, which one is the current one, and from where a range reaches to it. Cells are
/// numbered from 0; -1 is none.
class CCellSelection
{
public:
    static constexpr int none = -1;

    /// How much can be selected at once: one cell, an unbroken range, or any.
    enum class kind
    {
        single,
        range,
        any
    };
    void SetKind(kind to);
    kind Kind() const { return allowed; }

    int Count() const { return static_cast<int>(selected.size()); }
    bool IsSelected(int cell) const { return cell >= 0 && cell < Count() && selected[static_cast<std::size_t>(cell)]; }
    int Current() const { return current; }
    /// Where a range begins.
    int Anchor() const { return anchor; }
    std::vector<int> Selected() const;
    int SelectedCount() const;

    // Each answers whether anything has changed. Cells that there are not count as none.
    /// This one alone.
    bool Select(int cell);
    /// Into the selection or out of it, where any cells may be selected; otherwise as Select.
    bool Toggle(int cell);
    /// From the anchor to this one, and nothing else, where several may be selected; otherwise as Select.
    bool Extend(int cell);
    /// Without selecting.
    bool MakeCurrent(int cell);
    bool SelectAll();
    /// Nothing selected; the current one stays.
    bool Clear();

    // The cells have changed: what is selected goes with its cell.
    void Reset(int count);
    /// A new cell, not selected, stands at a place from 0 to the count.
    void Insert(int at);
    /// Where the current one goes the next becomes current, or the last; it is not selected by that.
    void Remove(int cell);
    /// A cell comes to stand at another place, counted without it.
    void Move(int from, int to);

private:
    bool Set(std::vector<bool> to, int newAnchor, int newCurrent);

    kind allowed = kind::single;
    std::vector<bool> selected;
    int anchor = none, current = none;
};

} // namespace Sarnik
