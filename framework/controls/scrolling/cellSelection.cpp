#include "framework/controls/scrolling/cellSelection.h"

#include <algorithm>
#include <utility>

namespace Sarnik
{

void CCellSelection::SetKind(kind to)
{
    allowed = to;
    if (to == kind::single && SelectedCount() > 1)
        Select(current);
    else if (to == kind::range && current != none && SelectedCount() > 1)
        Extend(current);
}

std::vector<int> CCellSelection::Selected() const
{
    std::vector<int> cells;
    for (int i = 0; i < Count(); ++i)
        if (IsSelected(i))
            cells.push_back(i);
    return cells;
}

int CCellSelection::SelectedCount() const
{
    return static_cast<int>(std::count(selected.begin(), selected.end(), true));
}

bool CCellSelection::Set(std::vector<bool> to, int newAnchor, int newCurrent)
{
    const bool changed = to != selected || newCurrent != current;
    selected = std::move(to);
    anchor = newAnchor;
    current = newCurrent;
    return changed;
}

bool CCellSelection::Select(int cell)
{
    if (cell < 0 || cell >= Count())
        return Clear();
    std::vector<bool> to(selected.size());
    to[static_cast<std::size_t>(cell)] = true;
    return Set(std::move(to), cell, cell);
}

bool CCellSelection::Toggle(int cell)
{
    if (allowed != kind::any || cell < 0 || cell >= Count())
        return Select(cell);
    std::vector<bool> to = selected;
    to[static_cast<std::size_t>(cell)].flip();
    return Set(std::move(to), cell, cell);
}

bool CCellSelection::Extend(int cell)
{
    if (allowed == kind::single || anchor == none || cell < 0 || cell >= Count())
        return Select(cell);
    std::vector<bool> to(selected.size());
    std::fill(to.begin() + std::min(anchor, cell), to.begin() + std::max(anchor, cell) + 1, true);
    return Set(std::move(to), anchor, cell);
}

bool CCellSelection::MakeCurrent(int cell)
{
    if (cell < 0 || cell >= Count())
        cell = none;
    return Set(selected, cell, cell);
}

bool CCellSelection::SelectAll()
{
    if (allowed == kind::single || selected.empty())
        return false;
    return Set(std::vector<bool>(selected.size(), true), 0, current == none ? 0 : current);
}

bool CCellSelection::Clear()
{
    return Set(std::vector<bool>(selected.size()), current, current);
}

void CCellSelection::Reset(int count)
{
    Set(std::vector<bool>(static_cast<std::size_t>(std::max(0, count))), none, none);
}

void CCellSelection::Insert(int at)
{
    at = std::clamp(at, 0, Count());
    selected.insert(selected.begin() + at, false);
    for (int *const place : {&anchor, &current})
        if (*place >= at)
            ++*place;
    // A new cell within a range would break it.
    if (allowed == kind::range && at > 0 && IsSelected(at - 1) && IsSelected(at + 1))
        selected[static_cast<std::size_t>(at)] = true;
}

void CCellSelection::Remove(int cell)
{
    if (cell < 0 || cell >= Count())
        return;
    selected.erase(selected.begin() + cell);
    for (int *const place : {&anchor, &current})
        if (*place > cell || *place == Count())
            --*place;
}

void CCellSelection::Move(int from, int to)
{
    if (from < 0 || from >= Count())
        return;
    to = std::clamp(to, 0, Count() - 1);
    const auto begin = selected.begin();
    if (from < to)
        std::rotate(begin + from, begin + from + 1, begin + to + 1);
    else
        std::rotate(begin + to, begin + from, begin + from + 1);
    for (int *const place : {&anchor, &current})
    {
        if (*place == from)
            *place = to;
        else if (from<to && * place> from && *place <= to)
            --*place;
        else if (to < from && *place >= to && *place < from)
            ++*place;
    }
    if (allowed == kind::range && SelectedCount() > 1)
        Select(current);
}

} // namespace Sarnik
