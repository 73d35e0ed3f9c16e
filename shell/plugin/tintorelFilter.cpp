#include "shell/plugin/tintorelFilter.h"

#include "framework/base/exceptions.h"
#include "platform/physicalMemory.h"
#include "shell/blockChannels.h"
#include "shell/bufferSuiteAllocator.h"
#include "shell/plugin/failureResult.h"
#include "shell/plugin/heapService.h"
#include "shell/plugin/hostAlerts.h"
#include "shell/plugin/memoryPlan.h"

#include <algorithm>
#include <atomic>
#include <memory>
#include <vector>

namespace Sarnik
{
namespace
{

std::atomic<CTintorelFilter *> current{nullptr};

std::vector<ScratchVolume> scratchVolumes(const TNFilterBlock &block)
{
    std::vector<ScratchVolume> volumes;
    constexpr std::uint32_t mostVolumes = 64;
    for (std::uint32_t i = 0; block.scratchFolders != nullptr && i < std::min(block.scratchFolderCount, mostVolumes);
         ++i)
        if (block.scratchFolders[i] != nullptr)
            volumes.push_back({block.scratchFolders[i]});
    return volumes;
}

} // namespace

CTintorelFilter::CTintorelFilter()
{
    current = this;
}

CTintorelFilter::~CTintorelFilter()
{
    current = nullptr;
}

CTintorelFilter *CTintorelFilter::Current() noexcept
{
    return current;
}

std::int16_t CTintorelFilter::OnAbout(const TNAboutBlock &about, std::intptr_t *hostData) noexcept
{
    data = hostData;
    currentSelector = TNSelectorAbout;
    pluginFlags = (pluginFlags & ~flagFilterBlock) | flagAbout;
    filterFlags &= ~1u;
    const CHostAlerts alerts(about.alerts);
    const std::int16_t result = resultOf([this] {
        DoAbout();
        return true;
    });
    currentSelector = -1;
    return result;
}

std::int16_t CTintorelFilter::Serve(int selector, TNFilterBlock &filterBlock, std::intptr_t *hostData,
                                    const std::function<bool()> &work) noexcept
{
    block = &filterBlock;
    data = hostData;
    currentSelector = static_cast<std::int16_t>(selector);
    pluginFlags |= flagFilterBlock;
    const CHostAlerts alerts(filterBlock.alerts);
    const std::int16_t result = resultOf(work);
    currentSelector = -1;
    return result;
}

std::int16_t CTintorelFilter::OnParameters(TNFilterBlock &filterBlock, std::intptr_t *hostData) noexcept
{
    filterFlags |= 1u;
    return Serve(TNSelectorParameters, filterBlock, hostData, [this] { return DoParameters(); });
}

std::int16_t CTintorelFilter::OnPrepare(TNFilterBlock &filterBlock, std::intptr_t *hostData) noexcept
{
    const std::int16_t result = Serve(TNSelectorPrepare, filterBlock, hostData, [this] {
        DoMemoryPlan();
        return DoPrepare();
    });
    if (result != TNNoError)
        filterFlags &= ~1u;
    return result;
}

std::int16_t CTintorelFilter::OnStart(TNFilterBlock &filterBlock, std::intptr_t *hostData) noexcept
{
    const std::int16_t result = Serve(TNSelectorStart, filterBlock, hostData, [this] {
        ReadWindowScale();
        DoHeapSetup();
        return DoRun();
    });
    if (result != TNNoError)
        filterFlags &= ~1u;
    return result;
}

std::int16_t CTintorelFilter::OnContinue(TNFilterBlock &filterBlock, std::intptr_t *hostData) noexcept
{
    return Serve(TNSelectorContinue, filterBlock, hostData, [this] { return DoContinue(); });
}

std::int16_t CTintorelFilter::OnFinish(TNFilterBlock &filterBlock, std::intptr_t *hostData) noexcept
{
    return Serve(TNSelectorFinish, filterBlock, hostData, [this] {
        DoFinish();
        return true;
    });
}

bool CTintorelFilter::SplitMemory(std::int64_t total, std::int64_t &first, std::int64_t &second)
{
    first = total / 2;
    second = total - first;
    return true;
}

void CTintorelFilter::DoMemoryPlan()
{
    const std::int64_t total = std::max<std::int64_t>(Block().maxSpace, 0);
    memoryShares wanted;
    wanted.buffers = total / 2;
    wanted.rest = total - wanted.buffers;
    if (!SplitMemory(total, wanted.buffers, wanted.rest))
        throw CError("$$$/Sarnik/TintorelPlugin/Error/NotEnoughMemory="
                     "This plugin requires more memory than the host can currently supply.");

    const memoryShares shares = limitShares(total, wanted);
    Block().maxSpace = shares.buffers + shares.rest;
    Block().bufferSpace = shares.buffers;
    DoHeapSetup();
    if (useBufferSuite)
    {
        // The buffers come through the suite: the host need not keep them back.
        Block().maxSpace = shares.rest;
        Block().bufferSpace = 0;
    }
}

void CTintorelFilter::DoHeapSetup()
{
    if (heapReady)
        return;
    CVirtualHeap &heap = *VirtualHeap();
    const std::uint64_t limit = heapLimit(Platform::physicalMemory(), Block().bufferSpace);

    CVirtualAllocator::Clear();
    if (useBufferSuite)
    {
        // Held by the allocator, so that the last block finds it still acquired.
        auto hold = std::make_shared<CSuiteHold>(Suites().Host(), TN_BUFFER_SUITE, 1);
        const TNBufferSuite *suite = hold->As<TNBufferSuite>();
        if (suite != nullptr && suite->allocate != nullptr && suite->dispose != nullptr)
            CVirtualAllocator::Install(
                std::make_shared<CBufferSuiteAllocator>(*suite, [hold = std::move(hold)] { hold->Release(); }));
    }
    heap.SetLimit(limit);
    if (!heap.IsOpen())
    {
        const std::vector<ScratchVolume> volumes = scratchVolumes(Block());
        if (volumes.empty())
            heap.Open();
        else
            heap.Open(volumes);
    }
    heapReady = true;
}

void CTintorelFilter::UseWideBounds()
{
    if (Block().bounds32 != nullptr)
        Block().bounds32->pluginUses = 1;
}

CRect CTintorelFilter::FilterBounds() const
{
    return ImageBounds(Block());
}

} // namespace Sarnik
