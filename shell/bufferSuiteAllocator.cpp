#include "shell/bufferSuiteAllocator.h"

#include <cstdint>
#include <utility>

namespace Sarnik
{

CBufferSuiteAllocator::CBufferSuiteAllocator(const TNBufferSuite &table, std::function<void()> giveBack)
    : suite(table), release(std::move(giveBack))
{
}

CBufferSuiteAllocator::~CBufferSuiteAllocator()
{
    if (release)
        release();
}

void *CBufferSuiteAllocator::Allocate(std::size_t size)
{
    void *buffer = suite.allocate(suite.context, size);
    if (reinterpret_cast<std::uintptr_t>(buffer) % alignof(std::max_align_t) == 0)
        return buffer;
    suite.dispose(suite.context, buffer);
    return nullptr;
}

void CBufferSuiteAllocator::Free(void *memory) noexcept
{
    suite.dispose(suite.context, memory);
}

} // namespace Sarnik
