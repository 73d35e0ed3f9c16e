#include "stages/displayConversion.h"
#include "stages/imageHub.h"
#include "stages/preview.h"
#include "stages/progressWindow.h"
#include "stages/result.h"
#include "stages/scaledStage.h"
#include "stages/source.h"
#include "stages/stageView.h"
#include "tests/stages/wholePicture.h"
#include "tests/support/synthetic.h"

#include <gtest/gtest.h>

#include <chrono>
#include <thread>

using namespace TestSupport;
using namespace Project;
using namespace CorvaneDeblur;

namespace
{

class testView final : public PStageView
{
public:
    bool Active() const override { return true; }
    CRect Visible() const override { return visible; }
    CRect Focus() const override { return focus; }
    void Redraw(const CRect &area) override { drawn.push_back(area); }
    void RedrawIndicator() override { indicators.push_back(hub->Indicator()); }
    void ShowProgress(double done) override { progress = done; }
    void WantIdle(bool wanted) override { wantsIdle = wanted; }

    PImageHub *hub = nullptr;
    CRect visible, focus;
    std::vector<CRect> drawn;
    std::vector<int> indicators;
    double progress = -1.0;
    bool wantsIdle = false;
};

void finish(PImageHub &hub)
{
    for (int slices = 0; hub.Idle(0.02); ++slices)
    {
        ASSERT_LT(slices, 100000);
        std::this_thread::sleep_for(std::chrono::microseconds(200));
    }
}

/// Every finished cell of a stage holds the same bytes as the other stage.
void expectFinishedCellsEqual(const PStage &stage, PStage &whole, const char *what)
{
    for (std::int64_t row = 0; row < stage.rows; ++row)
        for (std::int64_t column = 0; column < stage.columns; ++column)
        {
            if (stage.CellRemaining(column, row) != 0)
                continue;
            const CRect cell = stage.TileRect(column, row);
            CMemoryPixmap a(cell, stage.Pixmap().GetDepth(), stage.Pixmap().GetPlaneCount());
            CMemoryPixmap b(cell, stage.Pixmap().GetDepth(), stage.Pixmap().GetPlaneCount());
            copyPlanes(a, 0, stage.Pixmap(), 0, a.GetPlaneCount(), cell);
            copyPlanes(b, 0, whole.Pixmap(), 0, b.GetPlaneCount(), cell);
            ASSERT_EQ(differences(a, b), 0) << what << ", cell " << column << ", " << row;
        }
}

/// All of a hub's picture, computed at once on this thread by a hub that has seen no change.
class freshHub
{
public:
    freshHub(memoryHost &host, const PImageHub &like) : hub(host)
    {
        hub.SetCellSize(like.CellSize());
        for (PResult *stage : {&hub.ResultRough(), &hub.ResultFull(), &hub.ResultFast()})
            stage->SetUseWorker(false);
        hub.ResultFull().ForceAll();
        hub.SetView(like.ViewBounds(), like.Reduction());
        hub.ResultRough().ForceAll();
        hub.ResultFast().ForceAll();
        for (PPreview *preview : {&hub.PreviewRough(), &hub.PreviewFast(), &hub.PreviewAccurate()})
            preview->ForceAll();
    }
    PImageHub hub;
};

void expectNothingOld(PImageHub &hub, memoryHost &host)
{
    freshHub fresh(host, hub);
    const PStageSet &is = hub.Stages(), &other = fresh.hub.Stages();
    const auto compare = [&](const auto &stage, const auto &whole, const char *what) {
        if (stage && stage->HasPixmap() && whole && whole->HasPixmap())
            expectFinishedCellsEqual(*stage, *whole, what);
    };
    compare(is.source, other.source, "source");
    compare(is.resultFull, other.resultFull, "resultFull");
    compare(is.resultRough, other.resultRough, "resultRough");
    compare(is.previewRough, other.previewRough, "previewRough");
    compare(is.previewFast, other.previewFast, "previewFast");
    compare(is.previewAccurate, other.previewAccurate, "previewAccurate");
}

class ImageHub : public testing::Test
{
protected:
    void SetUp() override { traces.add(shakeKernel(9, 9, 3), {20, 20, 90, 90}); }
    void show(PImageHub &hub, const CRect &rect, double reduction, const CRect &visible)
    {
        view.hub = &hub;
        view.visible = visible;
        hub.SetViewObject(&view);
        hub.SetView(rect, reduction);
    }

    stageTraces traces;
    testView view; // outlives the hubs
};

TEST_F(ImageHub, ClimbsTheLadderToTheFinalPicture)
{
    // A view of 80 percent whose lower levels work at half its size, one of the picture's own size, and an enlargement.
    const CRect image{37, 21, 37 + 187, 21 + 141};
    struct
    {
        CRect rect;
        double reduction;
        std::vector<int> indicators;
    } const cases[] = {{{-3, 5, 147, 118}, 2.0, {1, 2, 3, 4}},
                       {{10, 20, 197, 161}, 1.0, {1, 3, 4}},
                       {{0, 0, 280, 211}, 1.0, {1, 2, 3, 4}}};
    for (const auto &c : cases)
    {
        memoryHost host({image, 16, 3, true, {50, 40, 190, 140}}, traces.collection);
        host.params.outputLog = true;
        PImageHub hub(host);
        hub.SetCellSize(48);
        view = {};
        show(hub, c.rect, c.reduction, c.rect);
        EXPECT_TRUE(view.wantsIdle);
        EXPECT_LT(view.progress, 0.5);
        finish(hub);
        EXPECT_EQ(view.indicators, c.indicators);
        EXPECT_FALSE(view.wantsIdle);
        EXPECT_EQ(view.progress, 1.0);
        EXPECT_EQ(hub.DoneWork(), hub.TotalWork());

        // What is shown is the engine's picture, reduced in one piece.
        const auto whole = expectedPicture(host, 48);
        CMemoryPixmap scaled(c.rect, 16, 4), expected(c.rect, 32, 1), drawn(c.rect, 32, 1);
        Sarnik::CPixmapScaler(image, c.rect).Scale(*whole, 0, scaled, 0, 4);
        ConvertForDisplay({host.Format(), true, nullptr}, scaled, expected);
        hub.DrawPreview(drawn, c.rect);
        EXPECT_EQ(differences(drawn, expected), 0);
        expectNothingOld(hub, host);
    }
}

TEST_F(ImageHub, VisibleCellsComeFirst)
{
    memoryHost host({{0, 0, 600, 600}, 8, 3, false, {}}, traces.collection);
    PImageHub hub(host);
    hub.SetCellSize(64);
    view.focus = {300, 300, 310, 310};
    show(hub, {0, 0, 400, 400}, 1.0, {200, 200, 330, 330});
    while (view.drawn.empty())
        ASSERT_TRUE(hub.Idle(0.005));
    EXPECT_FALSE(view.drawn[0].Intersected(view.focus).Empty()) << "the focus";
    EXPECT_EQ(hub.Indicator(), 1);
    while (view.drawn.size() < 9)
        ASSERT_TRUE(hub.Idle(0.005));
    for (std::size_t i = 0; i < 9; ++i)
        EXPECT_FALSE(view.drawn[i].Intersected(view.visible).Empty()) << "then what can be seen";
    EXPECT_LT(host.reads, 100) << "without the rest of the picture";
}

TEST_F(ImageHub, RandomChangesNeverLeaveAnythingOld)
{
    std::mt19937 random(11);
    const auto below = [&](int n) { return static_cast<int>(random() % static_cast<unsigned>(n)); };
    const CRect image{-20, 13, -20 + 173, 13 + 131};
    for (const int depth : {8, 16, 32})
    {
        memoryHost host({image, depth, depth == 8 ? 1 : 3, depth == 32, depth == 16 ? CRect{0, 30, 120, 110} : CRect{}},
                        traces.collection);
        PImageHub hub(host);
        hub.SetCellSize(48);
        show(hub, {0, 0, 101, 77}, 1.0, {0, 0, 101, 77});
        const auto changed = [&] { hub.InvalidateResults(true, true, true); };
        for (int step = 0; step < 40; ++step)
        {
            switch (below(10))
            {
            case 0: // the host's pixels
            {
                const int left = image.left + below(150), top = image.top + below(110);
                const CRect area = CRect{left, top, left + 1 + below(30), top + 1 + below(30)}.Intersected(image);
                CMemoryPixmap other(area, depth, host.picture.GetPlaneCount());
                memoryHost::fill(other, random());
                copyPlanes(host.picture, 0, other, 0, other.GetPlaneCount(), area);
                hub.Source().Invalidate(area);
                break;
            }
            case 1: // a slider
                traces.collection.At(0)->Settings().smoothing = static_cast<float>(below(100)) / 100.0f;
                changed();
                break;
            case 2: // traces come and go
                if (traces.collection.Count() < 3)
                    traces.add(shakeKernel(7 + 2 * below(3), 11, random()), {below(100), below(80), 120, 120});
                else
                    traces.collection.Remove(1);
                changed();
                break;
            case 3:
            case 9:
            {
                const int width = 40 + below(160);
                const CRect rect{below(50) - 25, below(50) - 25, 0, 0};
                const CRect sized{rect.left, rect.top, rect.left + width, rect.top + width * 3 / 4};
                view.visible = sized;
                hub.SetView(below(4) == 0 ? image.Moved(below(9), below(9)) : sized, 1.0 + 0.5 * below(4));
                break;
            }
            case 4:
                host.params.fineResult = !host.params.fineResult;
                changed();
                break;
            case 5:
                host.params.showPreview = !host.params.showPreview;
                hub.Refresh(false);
                break;
            case 6:
                host.params.accuratePreview = !host.params.accuratePreview;
                hub.MarkDirty();
                break;
            case 7: // one stage alone, as by a change that keeps the rough result
                hub.InvalidateResults(false, true, true);
                break;
            default:
                hub.SetSuppressed(below(2));
                break;
            }
            const int pause = below(400);
            for (int slices = below(12); slices > 0 && hub.Idle(0.001); --slices)
                std::this_thread::sleep_for(std::chrono::microseconds(pause));
            if (step % 10 == 9)
                finish(hub);
            if (step % 2 == 0)
                continue;
            ASSERT_NO_FATAL_FAILURE(expectNothingOld(hub, host)) << depth << " bits, step " << step;
            if (step % 20 == 19)
            {
                copyPlanes(host.written, 0, host.picture, 0, host.picture.GetPlaneCount(), image);
                ASSERT_TRUE(hub.RenderWithCallbacks());
                EXPECT_EQ(differences(host.written, *expectedPicture(host, 48)), 0);
            }
        }
    }
}

TEST_F(ImageHub, WhatAJobFoundBeforeAChangeIsNeverShown)
{
    memoryHost host({{0, 0, 200, 150}, 8, 3, false, {}}, traces.collection);
    for (const int pause : {0, 60}) // milliseconds: the job is under way, or done and not yet fetched
    {
        PImageHub hub(host);
        hub.SetCellSize(96);
        show(hub, {0, 0, 160, 120}, 1.0, {0, 0, 160, 120});
        while (hub.Indicator() != 1)
            ASSERT_TRUE(hub.Idle(0.001));
        hub.Idle(0.001); // ends with a cell that is under way
        std::this_thread::sleep_for(std::chrono::milliseconds(pause));
        traces.collection.At(0)->Settings().smoothing = pause == 0 ? 0.9f : 0.1f;
        hub.InvalidateResults(true, true, true);
        while (hub.PreviewRough().RemainingAll() != 0)
            hub.Idle(0.001);
        expectNothingOld(hub, host);
    }
}

class testWindow final : public PProgressWindow
{
public:
    void Open(const std::string &title, const std::string &text, std::uint64_t, std::uint64_t) override
    {
        opened = title + ": " + text;
    }
    void Show(std::uint64_t, std::uint64_t) override {}
    bool Cancelled() override { return ++asked > cancelAt; }
    void Close() override { ++closed; }
    std::string opened;
    int asked = 0, cancelAt = 1 << 30, closed = 0;
};

TEST_F(ImageHub, RendersUnderAWindow)
{
    memoryHost host({{0, 0, 200, 150}, 8, 3, false, {}}, traces.collection);
    PImageHub hub(host);
    hub.SetCellSize(48);
    show(hub, {0, 0, 100, 75}, 1.0, {0, 0, 100, 75});
    testWindow one, two, cancelled;
    EXPECT_TRUE(hub.RenderWithDialog(one));
    EXPECT_EQ(one.opened, "Progress: Applying Stillmark with 1 Blur Trace.");
    traces.add(shakeKernel(7, 7, 5), {100, 50, 170, 120});
    EXPECT_TRUE(hub.RenderWithDialog(two));
    EXPECT_EQ(two.opened, "Progress: Applying Stillmark with 2 Blur Traces.");
    EXPECT_EQ(two.closed, 1);
    hub.InvalidateResults(true, true, true);
    cancelled.cancelAt = 3;
    EXPECT_FALSE(hub.RenderWithDialog(cancelled));
    EXPECT_EQ(cancelled.closed, 1);
    EXPECT_TRUE(view.wantsIdle) << "previews go on";
}

} // namespace
