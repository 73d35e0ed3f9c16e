#pragma once

#include "framework/icons/iconIndex.h"

namespace Sarnik
{

/// Makes an index and its stores out of PNGs. The same pictures in the same order give the same bytes.
class CIconPacker
{
public:
    struct picture
    {
        std::string name; ///< up to 47 bytes
        std::uint32_t state = 0;
        std::uint32_t width = 0, height = 0, hotX = 0, hotY = 0; ///< pixels of the low resolution
        std::vector<std::byte> png[2];                           ///< the low resolution and the high, twice as large
    };

    /// One state of an icon; all states of an icon agree on its size and hot spot. Throws CError with a line for the
    /// developer where something does not fit together.
    void Add(const picture &added);

    std::vector<std::byte> Index() const { return writeIconIndex(icons); }
    const std::vector<std::byte> &Store(EIconResolution resolution) const { return stores[resolution]; }

private:
    CIconMap icons;
    std::vector<std::byte> stores[2] = {emptyStore(), emptyStore()};

    static std::vector<std::byte> emptyStore();
};

} // namespace Sarnik
