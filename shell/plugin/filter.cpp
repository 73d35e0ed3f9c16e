#include "shell/plugin/filter.h"

#include "dialog/tasks/undoCommands.h"
#include "framework/base/exceptions.h"
#include "shell/plugin/heapService.h"
#include "shell/plugin/memoryPlan.h"

#include <atomic>
#include <exception>

namespace Project
{
namespace
{

std::atomic<PFilter *> current{nullptr};

} // namespace

PFilter::PFilter()
{
    current = this;
    SetTimeLogOwner(this);
}

PFilter::~PFilter()
{
    // Estimations log until they are joined, which the collection's end would be too late for.
    if (kernels)
        kernels->Clear();
    SetRecorder(nullptr);
    taskStack.reset(); // holds traces of the collection
    SetTimeLogOwner(nullptr);
    timeLogFile.reset();
    imageHub.reset();
    kernels.reset(); // reads the parameters to its end
    params.reset();
    preferences.reset();
    current = nullptr;
}

PFilter *PFilter::Current() noexcept
{
    return current;
}

bool PFilter::SplitMemory(std::int64_t total, std::int64_t &first, std::int64_t &second)
{
    const Sarnik::memoryShares shares = Sarnik::fourFifths(total);
    first = shares.buffers;
    second = shares.rest;
    return true;
}

bool PFilter::DoParameters()
{
    UseWideBounds();
    return true;
}

Sarnik::CPageStore &PFilter::Pages()
{
    if (!pages)
        pages = std::make_unique<Sarnik::CHeapPageStore>(*Sarnik::VirtualHeap());
    return *pages;
}

PHostPicture &PFilter::Picture()
{
    if (!picture)
        picture = std::make_unique<PHostPicture>(*this, Block(), Suites().ChannelPorts());
    return *picture;
}

PImageHub *PFilter::GetImageHub()
{
    if (!imageHub)
        imageHub = std::make_unique<PImageHub>(Picture());
    return imageHub.get();
}

PParams *PFilter::GetParams()
{
    if (!params)
        params = std::make_unique<PParams>(Sarnik::imageFormat(Block().imageMode).planes);
    return params.get();
}

PKernelCollection *PFilter::GetKernels()
{
    if (!kernels)
    {
        const std::intptr_t threads =
            Properties().Number(Sarnik::threadLimitKey, Sarnik::threadLimitSignature).value_or(0);
        if (threads > 0)
            threadLimit = std::make_unique<tbb::global_control>(tbb::global_control::max_allowed_parallelism,
                                                                static_cast<std::size_t>(threads));
        kernels = std::make_unique<PKernelCollection>(Picture(), *GetParams(), static_cast<PTraceEvents &>(*this),
                                                      PreferencesFolder());
    }
    return kernels.get();
}

PTaskStack *PFilter::GetTaskStack()
{
    if (!taskStack)
    {
        taskStack = std::make_unique<PTaskStack>();
        SetRecorder(this);
    }
    return taskStack.get();
}

bool PFilter::ReceiveCommand(Sarnik::CCommandMessage &command)
{
    return ReceiveUndoCommand(*this, command);
}

bool PFilter::UpdateCommand(Sarnik::CCommandMessage &command)
{
    return UpdateUndoCommand(*this, command);
}

PPreferences *PFilter::GetPreferences()
{
    // The reset gesture is keys that a window would see.
    if (!preferences)
        preferences = LoadPreferences(ResetGesture::None);
    return preferences.get();
}

const std::string &PFilter::PreferencesFolder()
{
    if (!preferencesFolder)
    {
        try
        {
            preferencesFolder = PreferencesDirectory();
        }
        catch (const std::exception &)
        {
            preferencesFolder.emplace(); // nothing is kept then; saving tells why
        }
    }
    return *preferencesFolder;
}

void PFilter::MarkDirty(const PDirtyStages &stages)
{
    if (imageHub)
        imageHub->InvalidateResults(stages.rough, stages.scaled, stages.final);
}

void PFilter::RefreshPreview(bool keepRough)
{
    if (imageHub)
        imageHub->Refresh(keepRough);
}

bool PFilter::OutputLog() const
{
    return params && params->outputLog;
}

PTimeLogFile *PFilter::GetTimeLogFile()
{
    return timeLogFile.get();
}

} // namespace Project
