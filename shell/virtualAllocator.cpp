#include "shell/virtualAllocator.h"

#include <utility>

namespace Sarnik
{

namespace
{

std::shared_ptr<CVirtualAllocator> &installed() noexcept
{
    static std::shared_ptr<CVirtualAllocator> allocator;
    return allocator;
}

} // namespace

void CVirtualAllocator::Install(std::shared_ptr<CVirtualAllocator> allocator)
{
    installed() = std::move(allocator);
}

void CVirtualAllocator::Clear() noexcept
{
    installed().reset();
}

const std::shared_ptr<CVirtualAllocator> &CVirtualAllocator::Current() noexcept
{
    return installed();
}

} // namespace Sarnik
