#include "dialog/tasks/undoEvents.h"

#include "dialog/tasks/addKernelTask.h"
#include "dialog/tasks/kernelSettingsTask.h"

namespace Project
{

std::unique_ptr<PPendingSettings> PUndoEvents::BeginSettingsChange(PKernel &trace, std::uint32_t sourceId)
{
    return recorder ? PKernelSettingsTask::Begin(*recorder, trace, Sarnik::CObjID(sourceId)) : nullptr;
}

std::uintptr_t PUndoEvents::UndoPosition() const
{
    return recorder ? recorder->Tasks().Position() : 0;
}

bool PUndoEvents::AddLoadedTrace(const PKernel &trace, int at)
{
    if (recorder)
        recorder->Tasks().Push(std::make_unique<PAddKernelTask>(*recorder, &trace, at));
    return recorder != nullptr;
}

void PUndoEvents::WorkspaceLoaded()
{
    if (recorder)
        recorder->Tasks().ClearAll();
}

} // namespace Project
