#include "framework/icons/resourceDataProvider.h"

#include "framework/icons/pngFormat.h"

#include <algorithm>

namespace Sarnik
{

CResourceDataProvider::CResourceDataProvider(
    const std::function<std::span<const std::byte>(std::string_view key)> &resource)
{
    const auto index = resource(Icons);
    ParseIndex(index.data(), index.size());
    stores[kIconResolution_Low] = resource(LowResolutionDataFile);
    stores[kIconResolution_High] = resource(HighResolutionDataFile);

    // Offsets count from the store's first byte; a store of another kind has nothing that they could mean.
    const auto begins = std::as_bytes(std::span(iconStoreHeader));
    for (auto &store : stores)
        if (store.size() < begins.size() || !std::equal(begins.begin(), begins.end(), store.begin()))
            store = {};
}

bool CResourceDataProvider::ParseIndex(const void *data, std::size_t size)
{
    auto read = readIconIndex({static_cast<const std::byte *>(data), size});
    icons = read ? std::move(*read) : CIconMap{};
    return read.has_value();
}

CIconData CResourceDataProvider::Find(std::string_view name, EIconResolution resolution, std::uint32_t state) const
{
    const auto found = icons.find(name);
    if (found == icons.end() || resolution >= CIconRecord::resolutions || state >= CIconRecord::states)
        return {};
    const CIconRecord &record = found->second;
    const auto store = stores[resolution];
    const std::size_t offset = record.offset[resolution][state], length = record.length[resolution][state];
    if (length == 0 || offset > store.size() || length > store.size() - offset)
        return {};

    const std::uint32_t width = record.width[resolution], height = record.height[resolution];
    const std::uint32_t hotX = record.hotX[resolution], hotY = record.hotY[resolution];
    const auto png = store.subspan(offset, length);
    if (width > largestSide || height > largestSide || hotX >= width || hotY >= height ||
        CPNGFormat::Size(png) != CPNGFormat::size{width, height})
        return {};
    return {png, static_cast<int>(width), static_cast<int>(height), static_cast<int>(hotX), static_cast<int>(hotY)};
}

void CResourceDataProvider::GetIconName(std::uint32_t id, std::string &out) const
{
    out = (numberedIcons ? "Alpha_" : "") + std::to_string(id);
}

} // namespace Sarnik
