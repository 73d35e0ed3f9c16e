#pragma once

#include "framework/base/exceptions.h"
#include "shell/virtualHeap.h"

#include <cstring>
#include <filesystem>
#include <gtest/gtest.h>
#include <random>
#include <string>
#include <vector>

namespace Sarnik
{

/// Tests with a folder of their own for page files, which is gone afterwards.
class heapTest : public ::testing::Test
{
protected:
    heapTest()
    {
        std::string name = (std::filesystem::temp_directory_path() / "heapTest.XXXXXX").string();
        EXPECT_NE(::mkdtemp(name.data()), nullptr);
        folder = name;
    }
    ~heapTest() override { std::filesystem::remove_all(folder); }

    std::vector<ScratchVolume> volume() const { return {ScratchVolume{folder.string()}}; }
    bool folderIsEmpty() const { return std::filesystem::is_empty(folder); }

    std::filesystem::path folder;
};

/// The text of the CError that the call ends with; empty when it ends well.
template <typename Call> std::string errorOf(const Call &call)
{
    try
    {
        call();
    }
    catch (const CError &error)
    {
        return error.ErrorText();
    }
    return {};
}

/// Bytes of its own for every seed.
inline std::vector<std::byte> patternOf(unsigned seed, std::size_t size)
{
    std::vector<std::byte> bytes(size);
    std::mt19937 random(seed);
    for (std::byte &b : bytes)
        b = static_cast<std::byte>(random());
    return bytes;
}

inline void fill(CVirtualHeap &heap, VirtualTile *tile, unsigned seed)
{
    const CPagePin pin = heap.Pin(tile, CPageAccess::overwrite);
    const auto pattern = patternOf(seed, pin.bytes().size());
    std::memcpy(pin.writableBytes().data(), pattern.data(), pattern.size());
}

inline bool holds(CVirtualHeap &heap, VirtualTile *tile, unsigned seed)
{
    const CPagePin pin = heap.Pin(tile, CPageAccess::read);
    const auto pattern = patternOf(seed, pin.bytes().size());
    return std::memcmp(pin.bytes().data(), pattern.data(), pattern.size()) == 0;
}

} // namespace Sarnik
