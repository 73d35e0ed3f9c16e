#include "stages/imageHub.h"
#include "tests/stages/wholePicture.h"
#include "tests/support/synthetic.h"

#include <gtest/gtest.h>
#include <tbb/global_control.h>
#include <tbb/task_arena.h>

using namespace TestSupport;
using namespace Project;

namespace
{

class FinalRender : public testing::Test
{
protected:
    bool render(memoryHost &host, int cellSize = 48)
    {
        PImageHub hub(host);
        hub.SetCellSize(cellSize);
        return hub.RenderWithCallbacks();
    }

    stageTraces traces;
};

TEST_F(FinalRender, EqualsTheEnginesCellsBitForBit)
{
    traces.add(shakeKernel(7, 7, 3), {20, 20, 90, 90});
    traces.add(shakeKernel(9, 9, 5), {90, 40, 170, 150});
    const CRect away{37, 21, 37 + 181, 21 + 139}, atZero{0, 0, 150, 97};
    const CRect part{61, 44, 147, 133};
    const pictureKind kinds[] = {{atZero, 8, 3, false, {}},  {away, 8, 3, false, part},  {away, 8, 1, true, {}},
                                 {away, 8, 4, true, part},   {away, 16, 3, false, {}},   {away, 16, 3, true, part},
                                 {atZero, 16, 1, false, {}}, {away, 16, 4, false, part}, {away, 32, 3, false, {}},
                                 {away, 32, 1, true, part}};
    unsigned seed = 1;
    for (const pictureKind &kind : kinds)
        for (const int threads : {1, 2, 8})
        {
            const tbb::global_control limit(tbb::global_control::max_allowed_parallelism,
                                            static_cast<std::size_t>(threads));
            memoryHost host(kind, traces.collection, ++seed);
            host.params.fineResult = kind.depth != 8; // both methods
            if (kind.planes == 4)
                host.params.deconvChannels = {0, 2, 9};
            ASSERT_TRUE(tbb::task_arena(threads).execute([&] { return render(host); }));
            const auto expected = expectedPicture(host, 48);
            EXPECT_EQ(differences(host.written, *expected), 0)
                << kind.depth << " bits, " << kind.planes << " planes, " << threads << " threads";
            EXPECT_GT(differences(host.written, host.picture), 1000) << "something was rendered";
            EXPECT_EQ(host.pages.Live(), 0);

            CRect last{kind.bounds.left, kind.bounds.top - 1, 0, 0};
            for (const CRect &cell : host.writes)
            {
                EXPECT_TRUE(cell.top > last.top || (cell.top == last.top && cell.left > last.left)) << "row order";
                EXPECT_TRUE(host.SelectionBounds().Contains(cell));
                last = cell;
            }
            EXPECT_LE(host.reads, 4 * 4) << "each cell of the source is read once";
            EXPECT_EQ(host.progress.back().first, host.progress.back().second);
        }
}

TEST_F(FinalRender, WithoutATraceNothingChanges)
{
    for (const int kernelSize : {0, 4})
    {
        if (kernelSize > 0)
            traces.add(shakeKernel(kernelSize, kernelSize, 3), {20, 20, 90, 90});
        memoryHost host({{5, 5, 160, 120}, 16, 3, false, {30, 30, 80, 99}}, traces.collection);
        ASSERT_TRUE(render(host));
        EXPECT_EQ(differences(host.written, host.picture), 0);
        EXPECT_FALSE(host.writes.empty());
    }
}

TEST_F(FinalRender, StopsWhenAskedAndPassesFailuresOn)
{
    traces.add(shakeKernel(9, 9, 3), {20, 20, 90, 90});
    for (int i = 1; i < 40; i += 6)
    {
        memoryHost host({{0, 0, 300, 300}, 8, 3, false, {}}, traces.collection);
        host.abortAtPoll = i;
        EXPECT_FALSE(render(host));
        EXPECT_LT(host.writes.size(), 49u);
        host.abortAtPoll = 0;
        host.failAtRead = host.reads + i;
        EXPECT_THROW(render(host), Sarnik::CAbort);
        host.failAtRead = 0;
        EXPECT_TRUE(render(host)) << "and works again";
        EXPECT_EQ(differences(host.written, *expectedPicture(host, 48)), 0);
    }
}

} // namespace
