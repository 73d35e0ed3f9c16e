#pragma once

#include "dialog/tasks/addKernelTask.h"
#include "dialog/tasks/fineResultTask.h"
#include "dialog/tasks/kernelSettingsTask.h"
#include "dialog/tasks/moveKernelTask.h"
#include "dialog/tasks/removeKernelTask.h"
#include "dialog/tasks/undoCommands.h"
#include "dialog/tasks/undoEvents.h"
#include "framework/base/exceptions.h"
#include "framework/messages/messages.h"
#include "tests/store/traces/traceFixture.h"

#include <random>
#include <vector>

namespace Project
{

/// A list of thumbnails without pictures. Any call of it can fail.
class testView final : public PTaskView
{
public:
    explicit testView(const PKernelCollection &shown) : traces(shown) {}

    void CancelTool() override { Call(); }
    void InsertThumbnail(int index) override
    {
        Call();
        thumbnails.insert(thumbnails.begin() + index, traces.At(index));
    }
    void RemoveThumbnail(int index) override
    {
        Call();
        thumbnails.erase(thumbnails.begin() + index);
    }
    void MoveThumbnail(int from, int to) override
    {
        Call();
        const PKernel *moved = thumbnails[static_cast<std::size_t>(from)];
        thumbnails.erase(thumbnails.begin() + from);
        thumbnails.insert(thumbnails.begin() + to, moved);
    }
    void RebuildThumbnails() override
    {
        thumbnails.clear();
        for (int i = 0; i < traces.Count(); ++i)
            thumbnails.push_back(traces.At(i));
        selected = traces.SelectedIndex();
    }
    void SelectThumbnail(int index) override
    {
        Call();
        EXPECT_EQ(traces.SelectedIndex(), index);
        selected = index;
    }
    void RedrawThumbnail(int) override { Call(); }
    void EstimationsStopped() override { ++stops; }
    void SyncControls() override
    {
        Call();
        ++syncs;
    }
    void InvalidateDialog() override { Call(); }
    void RefreshMultiPreview() override { ++multiRefreshes; }
    void Focus(Sarnik::CObjID control) override { focus = control; }

    int failAt = 0; ///< this call fails, from 1; 0: none
    std::vector<const PKernel *> thumbnails;
    int selected = -1, stops = 0, syncs = 0, multiRefreshes = 0;
    Sarnik::CObjID focus;

private:
    void Call()
    {
        if (failAt > 0 && --failAt == 0)
            throw Sarnik::CError("no memory for a thumbnail");
    }

    const PKernelCollection &traces;
};

struct undoTestEvents final : PUndoEvents
{
    using PUndoEvents::SetRecorder;
    void TracesChanged() override { ++changes; }
    bool MultiPreview() const override { return multiPreview; }
    int changes = 0;
    bool multiPreview = false;
};

/// A blurred scene, its traces and their undo stack.
class undoTest : public ::testing::Test, public PTaskHost
{
protected:
    undoTest()
    {
        params.defaultSettings.size = 5;
        events.SetRecorder(this);
    }

    PKernelCollection &Traces() override { return traces; }
    PTaskStack &Tasks() override { return *stack; }
    PTaskView &View() override { return view; }

    template <class Task, class... Arguments> void Push(Arguments... arguments)
    {
        stack->Push(std::make_unique<Task>(*this, arguments...));
    }
    /// A trace with a kernel, in no list.
    std::unique_ptr<PKernel> Ready(PKernelKind kind, int left)
    {
        const Sarnik::CRect region{30 + left, -10, 70 + left, 30};
        KernelSettings settings;
        settings.size = 5;
        settings.noiseLevel = 1;
        if (kind == PKernelKind::Manual)
        {
            auto line = std::make_unique<PManualKernel>(traces, region, settings);
            line->SetLine({60.0f + static_cast<float>(left), 20.0f}, {68.0f + static_cast<float>(left), 25.5f});
            return line;
        }
        PTraceRecord record;
        record.region = region;
        record.settings = settings;
        record.kernel = TestSupport::shakeKernel(5, 5, static_cast<unsigned>(left));
        if (kind == PKernelKind::ReadOnly)
            return std::make_unique<PReadOnlyKernel>(traces, record);
        return std::make_unique<PEstimatedKernel>(traces, record);
    }
    PKernel &Add(PKernelKind kind, int left)
    {
        Push<PAddKernelTask>(Ready(kind, left).get(), -1);
        return *traces.At(traces.Count() - 1);
    }
    static PEstimatedKernel &Estimated(PKernel &trace) { return dynamic_cast<PEstimatedKernel &>(trace); }
    /// As the noise popup does.
    void ChangeNoise(PKernel &trace, std::uint32_t level, Sarnik::CObjID source)
    {
        trace.Settings().noiseLevel = level;
        Estimated(trace).StartEstimation(PEstimationRun::Background);
        trace.RecordSettingChange(kMaskNoiseLevel, source.Number());
    }
    void Nudge(PManualKernel &trace)
    {
        const PLinePoint start = trace.LineStart(), end = trace.LineEnd();
        RecordNudge(*this, trace);
        trace.SetLine({start.x - 0.5f, start.y}, {end.x + 0.5f, end.y});
    }
    void Command(const char *name)
    {
        EXPECT_TRUE(ReceiveUndoCommand(*this, Sarnik::CCommandMessage(Sarnik::CObjID(name))));
    }
    /// What a menu shows: the text, in brackets where the command is not enabled.
    std::string Entry(const char *name)
    {
        Sarnik::CCommandMessage message(Sarnik::CObjID(name), Sarnik::CCommandMessage::purpose::update);
        EXPECT_TRUE(UpdateUndoCommand(*this, message));
        return message.enabled ? message.text : "(" + message.text + ")";
    }

    testPicture picture{
        TestSupport::blurred(TestSupport::edgeScene(150, 200, 5), TestSupport::shakeKernel(9, 9, 5), 0.002f, 5), 30,
        -20};
    PParams params;
    undoTestEvents events;
    PKernelCollection traces{picture, params, events, ""};
    testView view{traces};
    std::unique_ptr<PTaskStack> stack = std::make_unique<PTaskStack>(); ///< goes before the traces
};

} // namespace Project
