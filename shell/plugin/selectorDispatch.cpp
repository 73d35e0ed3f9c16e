#include "shell/plugin/selectorDispatch.h"

#include "framework/base/service.h"
#include "shell/virtualAllocator.h"

#include <cstddef>

namespace Sarnik
{
namespace
{

std::unique_ptr<CTintorelFilter> live;

void EndRun() noexcept
{
    live.reset();
    CService::ShutdownAll();
    CVirtualAllocator::Clear();
}

/// The run that is going on, if any. About ends the life of all services, so a run that it came across has lost its
/// ground: what is left of it goes here, when the host calls again.
CTintorelFilter *LiveFilter() noexcept
{
    if (live != nullptr && CTintorelFilter::Current() != live.get())
        EndRun();
    return live.get();
}

template <class Block> Block *checked(void *block) noexcept
{
    auto *known = static_cast<Block *>(block);
    return known != nullptr && known->size >= sizeof(Block) ? known : nullptr;
}

std::unique_ptr<CTintorelFilter> build(CFilterFactory make, const TNPropertyProcs *properties,
                                       const TNSuiteProcs *suites, const TNHandleProcs *handles)
{
    CProcess::StoreMainThread();
    std::unique_ptr<CTintorelFilter> filter = make();
    filter->SetHost(properties, suites, handles);
    return filter;
}

std::int16_t About(CFilterFactory make, void *block, std::intptr_t *data)
{
    const TNAboutBlock *about = checked<TNAboutBlock>(block);
    if (about == nullptr)
        return TNErrParameter;
    std::unique_ptr<CTintorelFilter> filter = build(make, about->properties, about->suites, about->handles);
    const std::int16_t result = filter->OnAbout(*about, data);
    filter.reset();
    CService::ShutdownAll();
    CVirtualAllocator::Clear();
    return result;
}

std::int16_t Work(CFilterFactory make, int selector, TNFilterBlock &block, std::intptr_t *data)
{
    if (LiveFilter() == nullptr)
    {
        live = build(make, block.properties, block.suites, block.handles);
        live->ReadHostLook();
    }
    const std::int16_t result = selector == TNSelectorParameters ? live->OnParameters(block, data)
                                : selector == TNSelectorPrepare  ? live->OnPrepare(block, data)
                                                                 : live->OnStart(block, data);
    if (result != TNNoError)
        EndRun();
    return result;
}

std::int16_t Dispatch(CFilterFactory make, int selector, void *block, std::intptr_t *data)
{
    if (selector > TNSelectorFinish)
        return TNNoError;
    if (selector == TNSelectorAbout)
        return About(make, block, data);

    TNFilterBlock *filterBlock = checked<TNFilterBlock>(block);
    if (filterBlock == nullptr)
        return TNErrParameter;
    if (selector < TNSelectorContinue)
        return Work(make, selector, *filterBlock, data);
    if (LiveFilter() == nullptr)
        return TNNoError;
    if (selector == TNSelectorContinue)
        return live->OnContinue(*filterBlock, data);
    live->OnFinish(*filterBlock, data);
    EndRun();
    return TNNoError;
}

} // namespace

void DispatchSelector(CFilterFactory make, std::uint16_t selector, void *block, std::intptr_t *data,
                      std::int16_t *result) noexcept
{
    std::int16_t answer = TNUserHasBeenTold;
    try
    {
        answer = Dispatch(make, selector, block, data);
    }
    catch (...)
    {
        EndRun(); // building the object failed
    }
    if (result != nullptr)
        *result = answer;
}

} // namespace Sarnik
