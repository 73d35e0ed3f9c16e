#pragma once

#include <cstddef>
#include <memory>
#include <string_view>
#include <vector>

namespace Sarnik
{

/// Keeps the names and strings of a layout in blocks, so that reading one asks for memory once in a few hundred tokens.
/// Nothing is given back before the pool ends.
class CStringPool
{
public:
    static constexpr std::size_t blockSize = 3900;

    CStringPool() = default;
    CStringPool(const CStringPool &) = delete;
    CStringPool &operator=(const CStringPool &) = delete;

    /// A copy that lives as long as the pool. A text longer than a block gets one of its own size.
    std::string_view Copy(std::string_view text);

private:
    std::vector<std::unique_ptr<char[]>> blocks;
    char *next = nullptr;
    std::size_t left = 0;
};

} // namespace Sarnik
