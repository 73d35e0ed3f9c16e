#include "framework/icons/iconPacker.h"

#include "framework/base/exceptions.h"
#include "framework/icons/pngFormat.h"

namespace Sarnik
{
namespace
{

void require(bool fits, const std::string &name, const char *otherwise)
{
    if (!fits)
        throw CError("icon \"" + name + "\": " + otherwise);
}

} // namespace

std::vector<std::byte> CIconPacker::emptyStore()
{
    const auto bytes = std::as_bytes(std::span(iconStoreHeader));
    return {bytes.begin(), bytes.end()};
}

void CIconPacker::Add(const picture &added)
{
    const auto &[name, state, width, height, hotX, hotY, png] = added;
    require(!name.empty() && name.size() < CIconRecord::nameBytes && name.find('\0') == std::string::npos, name,
            "a name has 1 to 47 characters");
    require(state < CIconRecord::states, name, "states go from 0 to 7");
    require(hotX < width && hotY < height, name, "the hot spot lies outside the picture");

    CIconRecord sizes;
    for (std::uint32_t r = 0; r < 2; ++r)
    {
        sizes.width[r] = width << r;
        sizes.height[r] = height << r;
        sizes.hotX[r] = hotX << r;
        sizes.hotY[r] = hotY << r;
        require(CPNGFormat::Size(png[r]) == CPNGFormat::size{sizes.width[r], sizes.height[r]}, name,
                "a picture is no PNG of its size");
    }

    CIconRecord &record = icons.try_emplace(name, sizes).first->second;
    require(record.width == sizes.width && record.height == sizes.height && record.hotX == sizes.hotX &&
                record.hotY == sizes.hotY,
            name, "its states differ in size or hot spot");
    require(record.length[0][state] == 0, name, "a state is there twice");
    for (std::size_t r = 0; r < 2; ++r)
    {
        record.offset[r][state] = static_cast<std::uint32_t>(stores[r].size());
        record.length[r][state] = static_cast<std::uint32_t>(png[r].size());
        stores[r].insert(stores[r].end(), png[r].begin(), png[r].end());
    }
}

} // namespace Sarnik
