#include "framework/base/localisedString.h"
#include "store/files/traceFile.h"
#include "store/files/workspaceFile.h"
#include "tests/dialog/tasks/undoFixture.h"
#include "tests/support/temporaryFolder.h"

namespace Project
{
namespace
{

class Recording : public undoTest
{
protected:
    int Steps()
    {
        int steps = 0;
        for (; stack->CanUndo(); ++steps)
            stack->Undo();
        for (int i = 0; i < steps; ++i)
            stack->Redo();
        return steps;
    }
};

/// However many changes an estimation answers, they are one step of the trace wherever it stands by then; a cancelled
/// estimation leaves no step, and the value as it is.
TEST_F(Recording, AnEstimationCommitsWhenItEndsWell)
{
    PKernel &trace = Add(PKernelKind::Estimated, 0);
    EXPECT_TRUE(Estimated(trace).SetKernelSize(7, 3));
    Estimated(trace).StartEstimation(PEstimationRun::Background);
    ChangeNoise(trace, 2, "Test/Noise");
    auto other = Ready(PKernelKind::ReadOnly, 10);
    Push<PAddKernelTask>(other.get(), 0);
    EXPECT_TRUE(traces.WaitForEstimations());
    EXPECT_EQ(trace.KernelImage().rows, 7);
    EXPECT_EQ(Steps(), 3);

    const int changes = events.changes;
    events.multiPreview = true;
    stack->Undo();
    EXPECT_EQ(view.multiRefreshes, 1);
    EXPECT_EQ(events.changes, changes);
    events.multiPreview = false;
    stack->Redo();
    stack->Undo();
    EXPECT_GT(events.changes, changes);
    EXPECT_EQ(view.selected, 1);
    EXPECT_EQ(view.focus, Sarnik::CObjID("Test/Noise"));
    EXPECT_EQ(trace.Settings().size, 5);
    EXPECT_EQ(trace.Settings().noiseLevel, 1u);
    EXPECT_EQ(trace.KernelImage().rows, 5);
    stack->Redo();

    ASSERT_TRUE(Estimated(trace).SetKernelSize(9, 3));
    Estimated(trace).StartEstimation(PEstimationRun::Background);
    const std::uintptr_t position = stack->Position();
    traces.StopAll();
    EXPECT_EQ(stack->Position(), position);
    EXPECT_EQ(trace.Settings().size, 9);
    stack->Undo();
    EXPECT_EQ(trace.Settings().size, 5);
}

/// A region that was drawn and never estimated comes back, too.
TEST_F(Recording, TheFirstEstimationsRegionIsKnown)
{
    const Sarnik::CRect drawn{40, 0, 80, 40};
    PEstimatedKernel made(traces, {}, params.defaultSettings);
    made.SetRegion(drawn);
    Push<PAddKernelTask>(static_cast<const PKernel *>(&made), -1);
    traces.Insert(std::make_unique<PEstimatedKernel>(traces, drawn, params.defaultSettings), 1); // as automatic ones
    for (int i = 0; i < 2; ++i)
    {
        PKernel &trace = *traces.At(i);
        Estimated(trace).StartEstimation(PEstimationRun::Background);
        trace.SetRegion(drawn.Moved(10, 10));
        Estimated(trace).StartEstimation(PEstimationRun::Background);
        trace.RecordSettingChange(kMaskGeometry, 0);
        EXPECT_TRUE(traces.WaitForEstimations());
        stack->Undo();
        EXPECT_EQ(trace.Region(), drawn);
        EXPECT_FALSE(trace.HasKernel());
    }
}

TEST_F(Recording, ARunOfNudgesIsOneStep)
{
    auto &one = dynamic_cast<PManualKernel &>(Add(PKernelKind::Manual, 0));
    auto &other = dynamic_cast<PManualKernel &>(Add(PKernelKind::Manual, 30));
    const PLinePoint before = one.LineStart();
    for (int i = 0; i < 3; ++i)
        Nudge(one);
    EXPECT_EQ(Steps(), 3);
    Nudge(other);
    Nudge(one);
    EXPECT_EQ(Steps(), 5);
    stack->Undo();
    stack->Undo();
    EXPECT_TRUE(stack->CanRedo());
    Nudge(one); // a nudge of the same trace lies on top, but what comes after it could be redone
    EXPECT_FALSE(stack->CanRedo());
    EXPECT_EQ(Steps(), 4);
    stack->Undo();
    stack->Undo();
    EXPECT_EQ(one.LineStart(), before);

    // A change of another kind in between.
    Nudge(one);
    one.RecordSettingChange(kMaskSmoothing, 0);
    Nudge(one);
    EXPECT_EQ(Steps(), 5);
}

TEST_F(Recording, CommandsWaitForEstimations)
{
    const char *undo = "sarnik/command/undo", *redo = "sarnik/command/redo", *both = "sarnik/command/undoRedo",
               *backward = "sarnik/command/stepBackward", *forward = "sarnik/command/stepForward";
    EXPECT_EQ(Entry(both), "(Cannot Undo)");
    EXPECT_EQ(Entry(redo), "(Cannot Redo)");
    PKernel &trace = Add(PKernelKind::Estimated, 0);
    Push<PFineResultTask>(false);
    EXPECT_EQ(Entry(both), "Undo Disable Artifact Suppression");
    Command(both);
    EXPECT_EQ(Entry(both), "Redo Disable Artifact Suppression");
    EXPECT_EQ(Entry(undo), "Undo Add Blur Trace");
    Command(both);
    EXPECT_FALSE(params.fineResult);

    const std::uintptr_t position = stack->Position();
    for (const char *command : {undo, redo, backward, forward})
    {
        if (traces.AllIdle())
            ChangeNoise(trace, 2, {});
        EXPECT_EQ(Entry(command).front(), '(');
        Command(command);
        EXPECT_FALSE(traces.AllIdle());
    }
    EXPECT_EQ(Sarnik::Localize(Entry(both)), "Stop All Estimation");
    Command(both);
    EXPECT_TRUE(traces.AllIdle());
    EXPECT_EQ(view.stops, 1);
    EXPECT_EQ(stack->Position(), position);

    const int syncs = view.syncs;
    Command(backward);
    Command(backward);
    EXPECT_EQ(traces.Count(), 0);
    Command(undo);
    Command(forward);
    Command(redo);
    EXPECT_FALSE(params.fineResult);
    EXPECT_GE(view.syncs - syncs, 4);
    EXPECT_FALSE(ReceiveUndoCommand(*this, Sarnik::CCommandMessage("sarnik/command/cut")));
}

TEST_F(Recording, LoadedTracesAreSteps)
{
    const TestSupport::temporaryFolder folder;
    const std::string path = folder.path();
    Add(PKernelKind::ReadOnly, 0);
    EXPECT_TRUE(traces.HasChanged());
    ASSERT_TRUE(SaveTrace(traces, path, "one.knl"));
    ASSERT_TRUE(SaveWorkspace(traces, path, "all.dbw"));
    EXPECT_FALSE(traces.HasChanged());
    ASSERT_TRUE(LoadTrace(traces, path + "/one.knl", 0));
    EXPECT_EQ(traces.Count(), 2);
    EXPECT_TRUE(traces.IsActive(0));
    EXPECT_EQ(traces.SelectedIndex(), 0);
    EXPECT_TRUE(traces.HasChanged());
    stack->Undo();
    EXPECT_FALSE(traces.HasChanged());
    stack->Undo();
    EXPECT_TRUE(traces.HasChanged());
    Add(PKernelKind::ReadOnly, 0); // another task, perhaps at the old one's address
    EXPECT_TRUE(traces.HasChanged());

    ASSERT_TRUE(LoadWorkspace(traces, path + "/all.dbw"));
    EXPECT_FALSE(stack->CanUndo() || stack->CanRedo() || traces.HasChanged());
    events.SetRecorder(nullptr);
    ASSERT_TRUE(LoadTrace(traces, path + "/one.knl", -1));
    EXPECT_EQ(traces.Count(), 2);
    EXPECT_FALSE(stack->CanUndo());
}

} // namespace
} // namespace Project
