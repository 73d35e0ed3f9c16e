#include "tests/store/traces/traceFixture.h"

#include <algorithm>
#include <random>
#include <set>

namespace Project
{
namespace
{

using CorvaneDeblur::floatArray;

/// The list as plain values: the side of its kernel names a trace, 0 is one without.
struct listModel
{
    std::vector<int> names;
    std::set<int> active, saved;
    int selected = -1;

    int Count() const { return static_cast<int>(names.size()); }
    bool Valid(int i) const { return i >= 0 && i < Count(); }
};

class Collection : public traceTest
{
protected:
    /// A name is the left edge of the region; every third trace has no kernel.
    std::unique_ptr<PKernel> Trace(int name)
    {
        std::unique_ptr<PKernel> trace;
        const Sarnik::CRect region{name, 0, name + 30, 30};
        if (name % 2)
            trace = std::make_unique<PReadOnlyKernel>(traces, region, Settings(5));
        else
            trace = std::make_unique<PEstimatedKernel>(traces, region, Settings(5));
        if (Ready(name))
        {
            const int side = 3 + name % 7;
            const floatArray kernel = floatArray::allocate(side, side);
            fill(kernel, 0.0f);
            kernel.at(0, 0) = 1.0f;
            trace->SetKernel(kernel);
        }
        return trace;
    }
    static bool Ready(int name) { return name % 3 != 0; }
    static int NameOf(const PKernel *trace) { return trace->Region().left; }

    void Compare()
    {
        ASSERT_EQ(traces.Count(), model.Count());
        ASSERT_EQ(traces.SelectedIndex(), model.selected);
        ASSERT_EQ(traces.ActiveCount(), static_cast<int>(model.active.size()));
        std::vector<int> renders;
        int largest = 0;
        for (int i = 0; i < model.Count(); ++i)
        {
            const int name = model.names[static_cast<std::size_t>(i)];
            ASSERT_EQ(NameOf(traces.At(i)), name);
            ASSERT_EQ(traces.IndexOf(traces.At(i)), i);
            ASSERT_EQ(traces.IsActive(i), model.active.count(name) == 1);
            if (traces.IsActive(i) && Ready(name))
            {
                renders.push_back(name);
                largest = std::max(largest, 3 + name % 7);
            }
        }
        std::vector<int> rendered;
        for (const PKernel *trace : traces.RenderTraces())
            rendered.push_back(NameOf(trace));
        ASSERT_EQ(rendered, renders);
        ASSERT_EQ(traces.AnyActiveReady(), !renders.empty());
        ASSERT_EQ(traces.LargestActiveKernel(), largest);
        const auto first = traces.SelectedFirst();
        ASSERT_EQ(static_cast<int>(first.size()), model.Count());
        ASSERT_TRUE(model.selected < 0 || first[0] == traces.Selected());
    }

    listModel model;
};

TEST_F(Collection, RandomOperationsAgreeWithAModel)
{
    std::mt19937 random(3);
    int nextName = 1;
    std::vector<std::pair<int, std::unique_ptr<PKernel>>> removed; // as an undo stack holds them
    for (int step = 0; step < 6000; ++step)
    {
        const int i = static_cast<int>(random() % static_cast<unsigned>(model.Count() + 2)) - 1;
        const int j = static_cast<int>(random() % static_cast<unsigned>(model.Count() + 2)) - 1;
        const int before = events.changes;
        int expectedChanges = 0;
        const auto at = [&](int index) { return model.names.begin() + index; };
        const auto inserted = [&](int name) {
            model.names.insert(at(model.Valid(i) ? i : model.Count()), name);
            model.saved.clear();
        };
        const bool ready = model.Valid(i) && Ready(*at(i));
        switch (random() % 13)
        {
        case 0:
        case 1:
            if (model.Count() > 12)
                break;
            traces.Insert(Trace(nextName), i);
            inserted(nextName++);
            break;
        case 2:
            if (removed.empty())
                break;
            traces.Insert(std::move(removed.back().second), i);
            inserted(removed.back().first);
            removed.pop_back();
            break;
        case 3:
            traces.Move(i, j);
            if (!model.Valid(i) || !model.Valid(j))
                break;
            {
                const int name = *at(i);
                model.names.erase(at(i));
                model.names.insert(at(j), name);
                model.saved.clear();
            }
            break;
        case 4:
        {
            auto trace = traces.Remove(i);
            ASSERT_EQ(trace != nullptr, model.Valid(i));
            if (!trace)
                break;
            const int name = *at(i);
            expectedChanges = model.active.erase(name) == 1 && ready;
            model.names.erase(at(i));
            model.saved.clear();
            if (model.selected > i || model.selected == model.Count())
                --model.selected;
            if (random() % 2)
                removed.emplace_back(name, std::move(trace));
            break;
        }
        case 5:
            if (random() % 20)
                break;
            traces.Clear();
            model = {};
            break;
        case 6:
        case 7:
            traces.Activate(i);
            expectedChanges = model.Valid(i) && model.active.insert(*at(i)).second && ready;
            break;
        case 8:
            traces.Deactivate(i);
            expectedChanges = model.Valid(i) && model.active.erase(*at(i)) == 1 && ready;
            break;
        case 9:
            traces.DeactivateAll();
            expectedChanges = !model.active.empty();
            model.active.clear();
            break;
        case 10:
            traces.Select(i);
            model.selected = model.Valid(i) ? i : -1;
            break;
        case 11:
            traces.Solo(i);
            ASSERT_EQ(traces.SoloIndex(), i);
            model.saved = model.active;
            break;
        case 12:
            traces.EndSolo();
            expectedChanges = 1;
            model.active = model.saved;
            model.saved.clear();
            break;
        }
        ASSERT_EQ(events.changes - before, expectedChanges) << "step " << step;
        ASSERT_NO_FATAL_FAILURE(Compare()) << "step " << step;
    }
}

TEST_F(Collection, InvalidateTellsWhatIsShown)
{
    traces.Invalidate(PInvalidation::KeepRough);
    EXPECT_EQ(events.rough, 0);
    EXPECT_FALSE(traces.EndRender());
    traces.Invalidate(PInvalidation::Normal);
    EXPECT_EQ(events.rough, 1);
    params.showPreview = false;
    traces.Invalidate(PInvalidation::Normal);
    EXPECT_EQ(events.rough, 1);
    EXPECT_TRUE(traces.ResultStale());
    EXPECT_TRUE(traces.EndRender());
    params.showPreview = true;
    traces.RefreshPreview();
    EXPECT_EQ(events.rough, 2);
    EXPECT_FALSE(traces.ResultStale());
    EXPECT_FALSE(traces.HasChanged());
}

/// An undo record as a dialog would keep them.
struct recordedChange : PPendingSettings
{
    explicit recordedChange(std::vector<int> &pushed) : stack(pushed) {}
    void SetSource(std::uint32_t) override {}
    void Push(std::unique_ptr<PPendingSettings>, int index) override { stack.push_back(index); }
    std::vector<int> &stack;
};
struct recordingEvents : testEvents
{
    std::unique_ptr<PPendingSettings> BeginSettingsChange(PKernel &, std::uint32_t) override
    {
        return std::make_unique<recordedChange>(stack);
    }
    std::vector<int> stack;
};

/// Changes that a render answers are recorded at once, those that an estimation answers when it has ended well, and as
/// one however many they were; a cancelled estimation records nothing.
TEST_F(Collection, ChangesAreRecordedWhenTheyAreComplete)
{
    recordingEvents recorder;
    PKernelCollection list(picture, params, recorder, "");
    auto &trace = static_cast<PEstimatedKernel &>(
        list.Insert(std::make_unique<PEstimatedKernel>(list, picture.Bounds(), Settings(5)), 0));
    KernelSettings wanted = trace.Settings();
    wanted.smoothing = 0.7f;
    trace.UpdateSettings(kMaskSmoothing, wanted);
    EXPECT_EQ(recorder.stack, std::vector<int>{0});
    EXPECT_TRUE(trace.Changed());
    EXPECT_EQ(trace.PreviousSettings().smoothing, 0.7f);

    EXPECT_TRUE(trace.SetKernelSize(7, 1));
    trace.StartEstimation(PEstimationRun::Background);
    EXPECT_TRUE(trace.SetKernelSize(9, 1));
    trace.StartEstimation(PEstimationRun::Background);
    list.Insert(std::make_unique<PReadOnlyKernel>(list, Sarnik::CRect{}, Settings(5)), 0);
    EXPECT_EQ(recorder.stack.size(), 1u);
    EXPECT_TRUE(list.WaitForEstimations());
    EXPECT_EQ(recorder.stack, (std::vector<int>{0, 1}));
    EXPECT_EQ(trace.PreviousSettings().size, 9);

    EXPECT_TRUE(trace.SetKernelSize(11, 1));
    trace.StartEstimation(PEstimationRun::Background);
    trace.StopEstimation();
    EXPECT_EQ(recorder.stack.size(), 2u);
    EXPECT_FALSE(trace.HasPendingChange());
}

} // namespace
} // namespace Project
