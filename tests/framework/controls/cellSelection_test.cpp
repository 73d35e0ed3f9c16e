// Selections against a simple model: a list of cells that carry their own marks.

#include "framework/controls/scrolling/cellSelection.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <random>
#include <vector>

namespace Sarnik::Test
{
namespace
{

using Kind = CCellSelection::kind;

/// Cells with names, so that a mark can be found wherever its cell has gone.
struct model
{
    struct cell
    {
        int name;
        bool selected;
    };
    std::vector<cell> cells;
    int anchor = -1, current = -1; ///< names

    int Name(int at) const { return at < 0 || at >= int(cells.size()) ? -1 : cells[std::size_t(at)].name; }
    int Place(int name) const
    {
        for (std::size_t i = 0; i < cells.size(); ++i)
            if (cells[i].name == name)
                return int(i);
        return -1;
    }
    void Only(int from, int to)
    {
        for (int i = 0; i < int(cells.size()); ++i)
            cells[std::size_t(i)].selected = i >= std::min(from, to) && i <= std::max(from, to);
    }
    void Select(int at)
    {
        Only(at, at);
        anchor = current = Name(at);
    }
    void Extend(int at, Kind kind)
    {
        if (kind == Kind::single || anchor < 0)
            return Select(at);
        Only(Place(anchor), at);
        current = Name(at);
    }
    void Remove(int at)
    {
        // A mark on what goes passes to the next, or to the last.
        const bool last = at + 1 == int(cells.size());
        const int heir = last ? Name(at - 1) : Name(at + 1);
        for (int *const mark : {&anchor, &current})
            if (*mark == Name(at))
                *mark = heir;
        cells.erase(cells.begin() + at);
    }
};

class Selections : public testing::TestWithParam<Kind>
{
};

TEST_P(Selections, FollowTheModel)
{
    const Kind kind = GetParam();
    std::mt19937 random(17);
    const auto any = [&](int most) { return std::uniform_int_distribution(0, most)(random); };
    for (int round = 0; round < 200; ++round)
    {
        CCellSelection selection;
        selection.SetKind(kind);
        model expected;
        int nextName = 0;
        for (int step = 0; step < 60; ++step)
        {
            const int count = int(expected.cells.size()), at = count == 0 ? 0 : any(count - 1);
            const int what = count == 0 ? 0 : any(8);
            switch (what)
            {
            case 0:
            case 1:
            {
                const int place = any(count);
                const bool within = kind == Kind::range && place > 0 && place < count &&
                                    expected.cells[std::size_t(place - 1)].selected &&
                                    expected.cells[std::size_t(place)].selected;
                selection.Insert(place);
                expected.cells.insert(expected.cells.begin() + place, {nextName++, within});
                break;
            }
            case 2:
                selection.Remove(at);
                expected.Remove(at);
                break;
            case 3:
            {
                const int to = any(count - 1);
                selection.Move(at, to);
                const model::cell moved = expected.cells[std::size_t(at)];
                expected.cells.erase(expected.cells.begin() + at);
                expected.cells.insert(expected.cells.begin() + to, moved);
                const auto marked = std::count_if(expected.cells.begin(), expected.cells.end(),
                                                  [](const model::cell &c) { return c.selected; });
                if (kind == Kind::range && marked > 1)
                    expected.Select(expected.Place(expected.current));
                break;
            }
            case 4:
            case 5:
                selection.Select(at);
                expected.Select(at);
                break;
            case 6:
                selection.Extend(at);
                expected.Extend(at, kind);
                break;
            case 7:
                selection.Toggle(at);
                if (kind == Kind::any)
                {
                    expected.cells[std::size_t(at)].selected = !expected.cells[std::size_t(at)].selected;
                    expected.anchor = expected.current = expected.Name(at);
                }
                else
                    expected.Select(at);
                break;
            default:
                selection.MakeCurrent(at);
                expected.anchor = expected.current = expected.Name(at);
            }

            ASSERT_EQ(selection.Count(), int(expected.cells.size()));
            for (int i = 0; i < selection.Count(); ++i)
                ASSERT_EQ(selection.IsSelected(i), expected.cells[std::size_t(i)].selected) << what;
            ASSERT_EQ(expected.Name(selection.Current()), expected.current) << what;
            ASSERT_EQ(expected.Name(selection.Anchor()), expected.anchor) << what;
            const std::vector<int> cells = selection.Selected();
            ASSERT_TRUE(kind != Kind::single || cells.size() <= 1);
            ASSERT_TRUE(kind != Kind::range || cells.empty() || cells.back() - cells.front() + 1 == int(cells.size()));
        }
    }
}

INSTANTIATE_TEST_SUITE_P(kinds, Selections, testing::Values(Kind::single, Kind::range, Kind::any));

} // namespace
} // namespace Sarnik::Test
