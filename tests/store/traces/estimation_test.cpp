#include "deblur/estimate/kernelEstimator.h"
#include "tests/store/traces/traceFixture.h"
#include "tests/support/matchers.h"

#include <chrono>
#include <random>
#include <tbb/global_control.h>
#include <thread>

namespace Project
{
namespace
{

using CorvaneDeblur::byteArray;
using CorvaneDeblur::floatArray;
using TestSupport::arrayIdentical;
using namespace std::chrono_literals;

class Estimation : public traceTest
{
protected:
    /// What the engine says about a rectangle of the picture.
    floatArray Engine(const Sarnik::CRect &rect, int size, std::uint8_t threshold = 255)
    {
        const int rows = static_cast<int>(rect.Height()), cols = static_cast<int>(rect.Width());
        const auto grey = floatArray::allocate(rows, cols);
        const auto mask = threshold == 255 ? byteArray() : byteArray::allocate(rows, cols);
        picture.ReadGrey(rect, threshold, grey, mask);
        const auto kernel = floatArray::allocate(size, size);
        CorvaneDeblur::kernelEstimator engine;
        engine.imageToKernelRatio = 3;
        engine.estimate(grey, mask, kernel);
        EXPECT_EQ(engine.status(), CorvaneDeblur::estimateStatus::finished);
        return kernel;
    }

    static void PollUntilDone(PEstimatedKernel &trace)
    {
        while (!trace.PollEstimation())
            std::this_thread::sleep_for(1ms);
    }

    const Sarnik::CRect left{30, -20, 110, 100}, right{120, -10, 225, 125};
};

TEST_F(Estimation, FinishedKernelIsTheEngines)
{
    PEstimatedKernel &masked = Add(left, 10), &whole = Add({}, 11);
    masked.Settings().maskThreshold = 200;
    masked.Settings().forcedApply = true;
    masked.StartEstimation(PEstimationRun::Background);
    whole.StartEstimation(PEstimationRun::Background);
    EXPECT_FALSE(traces.AllIdle());
    double last = 0.0;
    EXPECT_TRUE(traces.WaitForEstimations([&](double share) {
        EXPECT_GE(share, last);
        last = share;
        return true;
    }));
    EXPECT_EQ(events.finished, 2);
    EXPECT_TRUE(traces.AllIdle());
    EXPECT_TRUE(arrayIdentical(masked.KernelImage(), Engine(left, 11, 200)));
    EXPECT_TRUE(arrayIdentical(whole.KernelImage(), Engine(picture.Bounds(), 11)));
    EXPECT_EQ(masked.CommittedRegion(), left);
    EXPECT_FALSE(masked.Settings().forcedApply);
    EXPECT_EQ(masked.Progress(), 1.0);

    PEstimatedKernel &here = Add(left, 11);
    here.Settings().maskThreshold = 200;
    here.StartEstimation(PEstimationRun::Here);
    EXPECT_TRUE(arrayIdentical(here.KernelImage(), masked.KernelImage()));
}

/// The main thread only looks on, and the process may use a single thread.
TEST_F(Estimation, OneThreadMakesProgressWhilePolled)
{
    const tbb::global_control one(tbb::global_control::max_allowed_parallelism, 1);
    PKernelCollection few(picture, params, events, "");
    for (int i = 0; i < 3; ++i)
    {
        auto &trace =
            static_cast<PEstimatedKernel &>(few.Insert(std::make_unique<PEstimatedKernel>(few, left, Settings(5)), i));
        trace.StartEstimation(PEstimationRun::Background);
    }
    for (int i = 0; i < 3; ++i)
        PollUntilDone(static_cast<PEstimatedKernel &>(*few.At(i)));
    EXPECT_TRUE(few.At(2)->HasKernel());
}

TEST_F(Estimation, StartWhileEstimatingBeginsAgain)
{
    PEstimatedKernel &trace = Add(left, 15);
    trace.StartEstimation(PEstimationRun::Background);
    trace.SetRegion(right);
    trace.Settings().size = 11;
    trace.StartEstimation(PEstimationRun::Background);
    PollUntilDone(trace);
    EXPECT_FALSE(trace.PollEstimation());
    EXPECT_TRUE(arrayIdentical(trace.KernelImage(), Engine(right, 11)));

    // A stopped run leaves nothing; reverting goes back to what was finished.
    const floatArray finished = trace.KernelImage();
    trace.SetRegion(left);
    trace.Settings().size = 13;
    trace.StartEstimation(PEstimationRun::Background);
    trace.RevertEstimation();
    EXPECT_EQ(trace.EstimationState(), 0);
    EXPECT_EQ(trace.Region(), right);
    EXPECT_EQ(trace.Settings().size, 11);
    EXPECT_EQ(trace.KernelImage().data, finished.data);

    PEstimatedKernel &fresh = Add(left, 13);
    fresh.StartEstimation(PEstimationRun::Background);
    fresh.RevertEstimation();
    EXPECT_EQ(fresh.Region(), left);
    EXPECT_FALSE(fresh.HasKernel());
}

/// What a file may ask for: sizes that are none, regions that are too small or elsewhere, the estimator for text. None
/// of it gives a kernel that renders, and none hangs.
TEST_F(Estimation, SenselessRequestsEndWithoutAResult)
{
    for (const int size : {INT32_MIN, -1, 0, 2, 99, INT32_MAX})
    {
        PEstimatedKernel &trace = Add({30, -20, 38, -12}, size);
        trace.StartEstimation(PEstimationRun::Here);
        EXPECT_FALSE(trace.IsApplied()) << size;
        EXPECT_LE(trace.KernelImage().rows, kLargestEstimate);
    }
    PEstimatedKernel &text = Add(left, 7), &outside = Add({1000, 1000, 1100, 1100}, 7);
    text.Settings().estimatorOptions = 2;
    text.StartEstimation(PEstimationRun::Background);
    outside.StartEstimation(PEstimationRun::Background);
    EXPECT_TRUE(traces.WaitForEstimations());
    EXPECT_EQ(text.KernelImage().cols, 7);
    EXPECT_FALSE(text.IsApplied());
    EXPECT_TRUE(traces.AllIdle());
    EXPECT_FALSE(outside.HasKernel());
}

/// Waiting ends soon when somebody says so, however many traces wait for a worker.
TEST_F(Estimation, CancelledWaitStopsAll)
{
    testPicture large(Blurred(340, 380, 31, 3), 0, 0);
    PKernelCollection list(large, params, events, "");
    for (int i = 0; i < 8; ++i)
    {
        auto trace = std::make_unique<PEstimatedKernel>(list, Sarnik::CRect{}, Settings(99));
        static_cast<PEstimatedKernel &>(list.Insert(std::move(trace), i)).StartEstimation(PEstimationRun::Background);
    }
    int asked = 0;
    double lastShare = 1.0;
    EXPECT_FALSE(list.WaitForEstimations([&](double share) {
        lastShare = share;
        return ++asked < 3;
    }));
    EXPECT_LT(lastShare, 0.5);
    EXPECT_TRUE(list.AllIdle());
    EXPECT_EQ(events.finished, 0);
    for (int i = 0; i < 8; ++i)
        EXPECT_FALSE(list.At(i)->HasKernel());
}

/// Starts, stops, polls, copies and deletes in random order: finished kernels are the engine's, whatever happens around
/// them, and at most one estimation belongs to a trace.
TEST_F(Estimation, RandomOrderOfOperations)
{
    const Sarnik::CRect one{60, 0, 100, 40}, other{120, 10, 170, 55}; // small: thousands of steps in seconds
    const floatArray expected[2] = {Engine(one, 5), Engine(other, 7)};
    const auto variant = [&](const PKernel &trace) { return trace.CommittedRegion() == one ? 0 : 1; };
    std::mt19937 random(11);
    const auto start = std::chrono::steady_clock::now();
    int steps = 0, finished = 0;
    for (; steps < 4000 && std::chrono::steady_clock::now() - start < 20s; ++steps)
    {
        if (traces.Count() < 4 && random() % 4 == 0)
            Add(random() % 2 ? one : other, 3);
        if (traces.Count() == 0)
            continue;
        const int index = static_cast<int>(random() % static_cast<unsigned>(traces.Count()));
        auto &trace = static_cast<PEstimatedKernel &>(*traces.At(index));
        switch (random() % 16)
        {
        case 0:
        case 1:
        case 2:
        {
            const bool first = random() % 2;
            trace.SetRegion(first ? one : other);
            trace.Settings().size = first ? 5 : 7;
            trace.StartEstimation(PEstimationRun::Background);
            break;
        }
        case 3:
            trace.StopEstimation();
            break;
        case 4:
            trace.RevertEstimation();
            break;
        case 5:
            traces.Remove(index);
            continue;
        case 6:
            traces.InsertCopy(trace, index);
            break;
        case 7:
            traces.Move(index, traces.Count() - 1);
            break;
        case 8:
            trace.Join();
            finished += traces.PollAll();
            break;
        case 9:
            if (random() % 16 == 0)
                traces.Clear();
            continue;
        default:
            finished += trace.PollEstimation() ? 1 : 0;
            std::this_thread::sleep_for(std::chrono::microseconds(random() % 2000));
        }
        ASSERT_EQ(trace.EstimationState() == 1, trace.Busy());
        for (int i = 0; i < traces.Count(); ++i)
        {
            const PKernel &each = *traces.At(i);
            ASSERT_TRUE(!each.HasKernel() || arrayIdentical(each.KernelImage(), expected[variant(each)]))
                << "step " << steps;
        }
    }
    EXPECT_GT(finished, 3);
    RecordProperty("steps", steps);
    RecordProperty("finished", finished);
}

TEST_F(Estimation, AutomaticRunHasALoneTrace)
{
    testPicture large(Blurred(360, 440, 9, 3), 7, 9);
    PKernelCollection automatic(large, params, events, "");
    ASSERT_TRUE(automatic.AutoEstimate());
    EXPECT_EQ(automatic.Count(), 0);
    EXPECT_EQ(automatic.ActiveCount(), 1);
    EXPECT_TRUE(automatic.AnyActiveEstimating());
    EXPECT_TRUE(automatic.RenderTraces().empty());
    ASSERT_TRUE(automatic.WaitForEstimations());
    ASSERT_EQ(automatic.RenderTraces(), std::vector<PKernel *>{automatic.LoneTrace()});
    EXPECT_TRUE(large.Bounds().Contains(automatic.LoneTrace()->Region()));
    EXPECT_GT(automatic.AnalysisNoise(), 0.0f);
    EXPECT_EQ(automatic.LargestActiveKernel(), automatic.LoneTrace()->KernelImage().rows);

    // A count from a hostile file ends where the picture has no more places.
    automatic.Clear();
    params.autoTraceCount = UINT32_MAX;
    automatic.AddAutoTraces();
    EXPECT_GE(automatic.Count(), 1);
    EXPECT_LE(automatic.Count(), 9);
    EXPECT_EQ(automatic.ActiveCount(), 1);
    EXPECT_TRUE(large.Bounds().Contains(automatic.suggestRegionAt(200, 150)));

    testPicture flat(TestSupport::noiseImage(300, 300, 1, 0.5f, 0.5f), 0, 0);
    PKernelCollection nothing(flat, params, events, "");
    EXPECT_FALSE(nothing.AutoEstimate());
    nothing.AddAutoTraces();
    EXPECT_EQ(nothing.Count(), 0);
    EXPECT_EQ(params.defaultSettings.size, 10);
}

} // namespace
} // namespace Project
