#pragma once

#include "shell/tintorel.h"
#include "shell/virtualAllocator.h"

#include <functional>

namespace Sarnik
{

/// Blocks in the host's buffers, so that its own accounts of memory stay right. Holds the suite until the last block
/// that came from it is freed.
class CBufferSuiteAllocator final : public CVirtualAllocator
{
public:
    /// release: gives the suite back, once nothing is wanted of it any more; may be empty.
    explicit CBufferSuiteAllocator(const TNBufferSuite &suite, std::function<void()> release = {});
    CBufferSuiteAllocator(const CBufferSuiteAllocator &) = delete;
    CBufferSuiteAllocator &operator=(const CBufferSuiteAllocator &) = delete;
    ~CBufferSuiteAllocator() override;

    /// Null, too, when the host's buffer is not aligned for samples: it is given back at once.
    void *Allocate(std::size_t size) override;
    void Free(void *memory) noexcept override;

private:
    const TNBufferSuite &suite;
    std::function<void()> release;
};

} // namespace Sarnik
