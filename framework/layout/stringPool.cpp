#include "framework/layout/stringPool.h"

#include <algorithm>

namespace Sarnik
{

std::string_view CStringPool::Copy(std::string_view text)
{
    if (text.empty())
        return "";
    if (text.size() > left)
    {
        const std::size_t size = std::max(blockSize, text.size());
        blocks.push_back(std::make_unique<char[]>(size));
        next = blocks.back().get();
        left = size;
    }
    char *const copy = next;
    std::copy(text.begin(), text.end(), copy);
    next += text.size();
    left -= text.size();
    return {copy, text.size()};
}

} // namespace Sarnik
