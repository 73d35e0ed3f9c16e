#pragma once

#include "framework/pixels/rect.h"
#include "shell/plugin/tintorelPlugin.h"

#include <cstdint>
#include <functional>

namespace Sarnik
{

/// What a filter plug-in needs: the host's block, the selectors, the heap. A filter derives from it and fills the Do
/// functions, which say whether the run goes on; false ends it without a message.
class CTintorelFilter : public CTintorelPlugin
{
public:
    CTintorelFilter();
    ~CTintorelFilter() override;

    static CTintorelFilter *Current() noexcept;

    // The selectors. Each answers with a result word (TNFilterBlock's comment); nothing is thrown. block and data stay
    // the host's and good until the call returns.
    std::int16_t OnAbout(const TNAboutBlock &about, std::intptr_t *hostData) noexcept;
    std::int16_t OnParameters(TNFilterBlock &filterBlock, std::intptr_t *hostData) noexcept;
    std::int16_t OnPrepare(TNFilterBlock &filterBlock, std::intptr_t *hostData) noexcept;
    std::int16_t OnStart(TNFilterBlock &filterBlock, std::intptr_t *hostData) noexcept;
    std::int16_t OnContinue(TNFilterBlock &filterBlock, std::intptr_t *hostData) noexcept;
    std::int16_t OnFinish(TNFilterBlock &filterBlock, std::intptr_t *hostData) noexcept;

    /// The host wants a dialog: the run began with Parameters.
    bool Interactive() const { return (filterFlags & 1u) != 0; }

    /// Divides the memory that the host grants, and opens the heap with its part. Throws CError when there is not
    /// enough.
    void DoMemoryPlan();

protected:
    /// How `total` bytes are to be shared; false when they are too few. Halves here.
    virtual bool SplitMemory(std::int64_t total, std::int64_t &first, std::int64_t &second);
    /// Limits and opens the virtual heap, the first time it is called.
    virtual void DoHeapSetup();
    virtual void DoAbout() {}
    virtual bool DoParameters() { return true; }
    virtual bool DoPrepare() { return true; }
    virtual bool DoRun() { return true; }
    virtual bool DoContinue() { return true; }
    virtual void DoFinish() {}

    /// The block of the current call. Only within a selector other than About.
    TNFilterBlock &Block() const { return *block; }
    /// From now on the block's 32-bit bounds count, where the host has them.
    void UseWideBounds();
    /// What is to be filtered, in picture coordinates.
    CRect FilterBounds() const;

    bool useBufferSuite = true; ///< the heap's memory comes from the host's buffers

private:
    std::int16_t Serve(int selector, TNFilterBlock &filterBlock, std::intptr_t *hostData,
                       const std::function<bool()> &work) noexcept;

    std::uint32_t filterFlags = 0;
    TNFilterBlock *block = nullptr;
    std::intptr_t *data = nullptr;
    std::int16_t currentSelector = -1;
    bool heapReady = false;
};

} // namespace Sarnik
