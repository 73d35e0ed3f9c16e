#include "tests/dialog/tasks/undoFixture.h"

namespace Project
{
namespace
{

/// All that undoing restores, as plain values.
struct traceState
{
    const PKernel *object;
    bool active;
    KernelSettings settings, previousSettings;
    Sarnik::CRect region, drawnRegion;
    std::vector<float> kernel;
    PLinePoint start, end;
    friend bool operator==(const traceState &, const traceState &) = default;
};

struct state
{
    bool fineResult;
    std::vector<traceState> traces;
    friend bool operator==(const state &, const state &) = default;
};

class Tasks : public undoTest
{
protected:
    state Now()
    {
        state now{params.fineResult, {}};
        for (int i = 0; i < traces.Count(); ++i)
        {
            const PKernel &trace = *traces.At(i);
            std::vector<float> samples;
            for (int y = 0; y < trace.KernelImage().rows; ++y)
                for (int x = 0; x < trace.KernelImage().cols; ++x)
                    samples.push_back(trace.KernelImage().at(y, x));
            const auto *line = dynamic_cast<const PManualKernel *>(&trace);
            now.traces.push_back({&trace, traces.IsActive(i), trace.Settings(), trace.PreviousSettings(),
                                  trace.Region(), trace.DrawnRegion(), samples, line ? line->LineStart() : PLinePoint{},
                                  line ? line->LineEnd() : PLinePoint{}});
        }
        return now;
    }
    int Below(int bound) { return static_cast<int>(random() % static_cast<unsigned>(bound)); }

    /// Some change with an undo step. False for none.
    bool Change()
    {
        const int count = traces.Count(), i = Below(count + 1);
        PKernel *trace = traces.At(i);
        const int kind = Below(13);
        if (kind < 3)
        {
            if (count > 6)
                return false;
            auto made = Ready(static_cast<PKernelKind>(1 + kind), Below(100));
            Push<PAddKernelTask>(made.get(), Below(2) ? -1 : i);
            return true;
        }
        if (kind == 3 && count < 7)
        {
            Push<PAddKernelTask>(static_cast<const PKernel *>(nullptr), -1);
            return true;
        }
        if (kind == 4)
        {
            Push<PFineResultTask>(!params.fineResult);
            return true;
        }
        if (!trace)
            return false;
        switch (kind)
        {
        case 5:
            if (!trace->HasKernel() || count > 6)
                return false;
            Push<PDuplicateKernelTask>(PReadOnlyKernel::Of(*trace).get(), i + 1);
            return true;
        case 6:
            Push<PRemoveKernelTask>(i);
            return true;
        case 7:
            Push<PMoveKernelTask>(i, Below(count));
            return true;
        case 8:
        {
            KernelSettings wanted = trace->Settings();
            wanted.smoothing = static_cast<float>(Below(100)) / 100.0f;
            trace->UpdateSettings(kMaskSmoothing, wanted, 7);
            return true;
        }
        case 9:
            trace->Settings().forcedApply = !trace->Settings().forcedApply;
            trace->RecordSettingChange(kMaskForcedApply, 0);
            return true;
        case 10:
            if (auto *line = dynamic_cast<PManualKernel *>(trace))
            {
                const std::uintptr_t position = stack->Position();
                Nudge(*line);
                return stack->Position() != position;
            }
            return false;
        default:
            break;
        }
        const Sarnik::CRect moved =
            trace->Region().Empty() ? Sarnik::CRect{40, 0, 80, 40} : trace->Region().Moved(1, 1);
        if (trace->KernelType() == PKernelKind::Estimated)
        {
            if (kind == 11)
            {
                trace->SetRegion(moved);
                Estimated(*trace).StartEstimation(PEstimationRun::Background);
                trace->RecordSettingChange(kMaskGeometry, 0);
            }
            else
                ChangeNoise(*trace, trace->Settings().noiseLevel ^ 1, "Test/Noise");
            EXPECT_TRUE(traces.WaitForEstimations());
        }
        else
        {
            trace->RecordSettingChange(kMaskGeometry, 0);
            trace->SetRegion(moved);
        }
        return true;
    }

    std::mt19937 random{21};
};

/// Sequences of everything that can be undone, views that fail included: an undo is the state before, a redo the state
/// after, a failure no change at all.
TEST_F(Tasks, RandomSequencesGoBackAndForth)
{
    std::vector<state> states{Now()};
    std::size_t at = 0, overflows = 0, failures = 0;
    bool back = false;
    const auto check = [&] {
        ASSERT_TRUE(Now() == states[at]);
        ASSERT_EQ(stack->CanUndo(), at > 0);
        ASSERT_EQ(stack->CanRedo(), at + 1 < states.size());
        ASSERT_EQ(view.thumbnails.size(), states[at].traces.size());
        for (std::size_t i = 0; i < view.thumbnails.size(); ++i)
            ASSERT_EQ(view.thumbnails[i], traces.At(static_cast<int>(i)));
        ASSERT_TRUE(traces.SelectedIndex() < 0 || traces.SelectedIndex() == view.selected);
    };
    for (int step = 0; step < 2500; ++step)
    {
        const int what = Below(10);
        view.failAt = Below(6) == 0 ? 1 + Below(4) : 0;
        try
        {
            if (what < 6)
            {
                if (Change())
                {
                    states.resize(++at);
                    states.push_back(Now());
                    back = false;
                }
                else
                    states[at] = Now(); // a further nudge
                if (states.size() > 101)
                {
                    states.erase(states.begin());
                    --at;
                    ++overflows;
                }
            }
            else if (what < 8 && at > 0)
            {
                stack->Undo();
                --at;
                back = true;
            }
            else if (what == 8 && at + 1 < states.size())
            {
                stack->Redo();
                ++at;
                back = false;
            }
            else if (what == 9)
            {
                const bool forth = back && at + 1 < states.size();
                const bool moves = forth || at > 0;
                stack->UndoRedo();
                at += forth ? 1 : 0;
                at -= moves && !forth ? 1 : 0;
                back = moves && !forth;
            }
        }
        catch (const Sarnik::CError &)
        {
            ++failures;
        }
        ASSERT_NO_FATAL_FAILURE(check()) << "step " << step;
    }
    view.failAt = 0;
    EXPECT_GT(overflows, 20u);
    EXPECT_GT(failures, 50u);
    while (at > 0)
    {
        stack->Undo();
        --at;
        ASSERT_NO_FATAL_FAILURE(check());
    }
    while (stack->CanRedo())
    {
        stack->Redo();
        ++at;
        ASSERT_NO_FATAL_FAILURE(check());
    }
}

TEST_F(Tasks, TracesComeBackAsTheyLeft)
{
    Add(PKernelKind::Estimated, 0);
    Add(PKernelKind::ReadOnly, 20);
    EXPECT_TRUE(traces.IsActive(1));
    EXPECT_EQ(traces.SelectedIndex(), 1);
    traces.Deactivate(1);
    stack->Undo();
    EXPECT_EQ(traces.SelectedIndex(), 0);
    stack->Redo();
    EXPECT_FALSE(traces.IsActive(1)); // as at the undo
    Push<PMoveKernelTask>(0, 1);
    EXPECT_EQ(traces.SelectedIndex(), 1);
    stack->Undo();
    EXPECT_EQ(traces.SelectedIndex(), 0);

    // A trace is taken out while it estimates.
    ChangeNoise(*traces.At(0), 2, "Test/Noise");
    Push<PRemoveKernelTask>(0);
    EXPECT_TRUE(traces.AllIdle());
    stack->Undo();
    EXPECT_EQ(traces.At(0)->EstimationState(), 0);
    EXPECT_FALSE(traces.At(0)->HasPendingChange());

    // Traces that went without a task leave tasks behind that do nothing.
    traces.Clear();
    view.RebuildThumbnails();
    while (stack->CanUndo())
        stack->Undo();
    while (stack->CanRedo())
        stack->Redo();
    EXPECT_EQ(traces.Count(), 0);
}

TEST_F(Tasks, AreNamed)
{
    const auto name = [](const Sarnik::CTask &task) {
        std::string text;
        EXPECT_TRUE(task.GetUndoText(text));
        return text;
    };
    const PKernel &trace = Add(PKernelKind::Manual, 0);
    EXPECT_EQ(name(*stack->LastDone()), "Undo Add Blur Trace");
    EXPECT_EQ(name(PDuplicateKernelTask(*this, &trace, 0)), "Undo Duplicate Blur Trace");
    EXPECT_EQ(name(PMoveKernelTask(*this, 0, 1)), "Undo Move Blur Trace");
    EXPECT_EQ(name(PRemoveKernelTask(*this, 0)), "Undo Remove Blur Trace");
    EXPECT_EQ(name(PKernelSettingsTask(*this, trace, 0, "Project/Tool/ManualKernel")), "Undo Nudge");
    EXPECT_EQ(name(PKernelSettingsTask(*this, trace, 0, {})), "Undo Blur Estimation Setting");
    EXPECT_EQ(name(PFineResultTask(*this, true)), "Undo Enable Artifact Suppression");
    EXPECT_EQ(name(PFineResultTask(*this, false)), "Undo Disable Artifact Suppression");
}

} // namespace
} // namespace Project
