#include "framework/pixels/pixProcess.h"

#include <gtest/gtest.h>

#include <random>

namespace
{

using namespace Sarnik;

/// A grid is right if its tiles follow one another from edge to edge and every inner edge lies on the grid.
void expectTiling(const CRect &bounds, const CRect &tile)
{
    SCOPED_TRACE(testing::Message() << bounds.left << ".." << bounds.right << " by " << tile.Width() << " from "
                                    << tile.left);
    CPixGrid grid;
    grid.Setup(bounds, tile);
    ASSERT_EQ(grid.Bounds(), bounds);
    ASSERT_GT(grid.columns, 0);
    ASSERT_GT(grid.rows, 0);
    std::int64_t x = bounds.left;
    for (std::int64_t c = 0; c < grid.columns; ++c)
    {
        const CRect r = grid.TileRect(c, 0);
        ASSERT_EQ(r.left, x);
        ASSERT_GT(r.right, r.left);
        ASSERT_LE(r.Width(), grid.tileWidth);
        x = r.right;
        if (c + 1 < grid.columns)
        {
            EXPECT_EQ((x - tile.left) % grid.tileWidth, 0) << "column " << c;
        }
        else
        {
            EXPECT_EQ(r.Width(), grid.columns == 1 ? grid.firstWidth : grid.lastWidth);
        }
    }
    EXPECT_EQ(x, bounds.right);
    std::int64_t y = bounds.top;
    for (std::int64_t r = 0; r < grid.rows; ++r)
    {
        ASSERT_EQ(grid.TileRect(0, r).top, y);
        y = grid.TileRect(0, r).bottom;
        if (r + 1 < grid.rows)
        {
            EXPECT_EQ((y - tile.top) % grid.tileHeight, 0) << "row " << r;
        }
    }
    EXPECT_EQ(y, bounds.bottom);
}

TEST(PixGrid, TilesTheRectangleAlongTheGrid)
{
    std::mt19937 random(7);
    for (int i = 0; i < 400; ++i)
    {
        const auto in = [&](int low, int high) { return std::uniform_int_distribution(low, high)(random); };
        const int left = in(-70, 70), top = in(-70, 70), gx = in(-200, 200), gy = in(-200, 200);
        expectTiling({left, top, left + in(1, 90), top + in(1, 90)}, {gx, gy, gx + in(1, 40), gy + in(1, 40)});
    }
}

TEST(PixGrid, SmallestLargestAndNone)
{
    CPixGrid grid;
    grid.Setup({10, 20, 1034, 532}, {10, 20, 522, 532});
    EXPECT_EQ(grid.firstWidth, 512) << "never 0 at the grid's origin";
    EXPECT_EQ(grid.columns, 2);
    EXPECT_EQ(grid.lastWidth, 512);
    EXPECT_EQ(grid.rows, 1);
    EXPECT_EQ(grid.lastHeight, 0) << "a single row has no last one";

    grid.Setup({5, 5, 5, 90}, {0, 0, 8, 8});
    EXPECT_EQ(grid.columns, 0);
    EXPECT_TRUE(grid.Empty());
    grid.Setup({9, 9, 3, 90}, {0, 0, 8, 8});
    EXPECT_EQ(grid.width, 0);

    expectTiling({INT32_MIN, -3, INT32_MAX, 3}, {-7, INT32_MIN, 1000000000, 5});
    CPixState state;
    EXPECT_ANY_THROW(state.Setup({INT32_MIN, INT32_MIN, INT32_MAX, INT32_MAX}, {0, 0, 1, 1}));
    EXPECT_TRUE(state.Empty());
}

TEST(PixState, AreaOfChangeIsWhatTheRectangleTouches)
{
    CPixState state(true);
    state.Setup({-5, 3, 100, 80}, {0, 0, 16, 16});
    ASSERT_EQ(state.rects.size(), state.states.size());
    std::fill(state.states.begin(), state.states.end(), 4u);

    std::mt19937 random(3);
    for (int i = 0; i < 200; ++i)
    {
        const auto in = [&](int low, int high) { return std::uniform_int_distribution(low, high)(random); };
        const int left = in(-30, 120), top = in(-30, 120);
        const CRect rect{left, top, left + in(0, 50), top + in(0, 50)};
        CPixState changed = CPixState(true);
        changed.Setup({-5, 3, 100, 80}, {0, 0, 16, 16});
        changed.RaiseState(rect, 2);
        const auto touched = [&](std::size_t t) {
            return !rect.Empty() && !changed.rects[t].Intersected(rect).Empty();
        };
        for (std::size_t t = 0; t < changed.states.size(); ++t)
            ASSERT_EQ(changed.states[t], touched(t) ? 2u : 0u);
        changed.RaiseState({-5, 3, 100, 80}, 1);
        changed.LowerState(rect, 1);
        for (const std::uint32_t s : changed.states)
            ASSERT_EQ(s, 1u);
    }
}

/// Two stages: a tile of `later` needs its own rectangle grown by 3 pixels from `earlier`.
class stage : public CPixProcess
{
public:
    explicit stage(std::uint32_t steps, stage *source = nullptr) : CPixProcess(steps), earlier(source) {}

    std::uint64_t ProcessCell(std::int64_t column, std::int64_t row, bool force) override
    {
        if (CellRemaining(column, row) == 0)
            return 0;
        std::uint64_t done = 0;
        if (earlier != nullptr)
        {
            const CRect own = TileRect(column, row);
            const CRect need{own.left - 3, own.top - 3, own.right + 3, own.bottom + 3};
            done = force ? earlier->ForceRect(need) : earlier->StepRect(need);
            if (!force && done != 0)
                return done;
            EXPECT_EQ(earlier->RemainingRegion(earlier->Touched(need)), 0u);
        }
        ++State(column, row);
        return done + 1;
    }

private:
    stage *earlier;
};

TEST(PixProcess, StepsAndForceReachTheSameEnd)
{
    const CRect bounds{-7, 2, 90, 61}, tile{0, 0, 16, 16};
    stage first(2), second(3, &first);
    first.Allocate(bounds, tile);
    second.Allocate(bounds, tile);
    const std::uint64_t all = first.TotalAll() + second.TotalAll();

    std::uint64_t steps = 0;
    while (const std::uint64_t done = second.StepAll())
    {
        ASSERT_EQ(done, 1u);
        ++steps;
        ASSERT_EQ(second.DoneAll() + second.RemainingAll(), second.TotalAll());
    }
    EXPECT_EQ(steps, all);
    EXPECT_EQ(second.RemainingAll(), 0u);

    stage first2(2), second2(3, &first2);
    first2.Allocate(bounds, tile);
    second2.Allocate(bounds, tile);
    EXPECT_EQ(second2.ForceAll(), all);

    second2.LowerState({0, 10, 1, 11}, 1);
    EXPECT_EQ(second2.ForceRect(bounds), 2u) << "one tile lost two of its three steps";
    second2.Reset();
    EXPECT_EQ(second2.TotalAll(), 0u);
    EXPECT_EQ(second2.StepAll(), 0u);
}

TEST(PixProcess, RunStopsWhereTheCallbackSaysSo)
{
    CPixProcess process(2);
    process.Allocate({0, 0, 30, 20}, {0, 0, 10, 10});
    std::uint64_t count = 0;
    EXPECT_FALSE(process.RunAll(count, [](std::uint64_t done) { return done < 5; }));
    EXPECT_EQ(count, 5u);
    EXPECT_EQ(process.states, (std::vector<std::uint32_t>{2, 2, 1, 0, 0, 0})) << "row by row, a tile to its end first";

    EXPECT_TRUE(process.RunAll(count, {}));
    EXPECT_EQ(count, 12u);
    EXPECT_TRUE(process.RunAll(count, [](std::uint64_t) { return false; })) << "nothing left to report";
}

} // namespace
