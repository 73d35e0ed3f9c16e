#include "framework/icons/resourceConversionThunk.h"

#include "framework/icons/pngDecoder.h"
#include "platform/canvas/canvas.h"

#include <algorithm>
#include <cmath>

namespace Sarnik
{
namespace
{

struct candidate
{
    EIconResolution resolution;
    double scale;
};

constexpr candidate low{kIconResolution_Low, 1}, high{kIconResolution_High, 2};

} // namespace

std::shared_ptr<const Platform::raster>
ResourceConversionThunk::Picture(const std::string &name, EIconResolution resolution, std::uint32_t state)
{
    const auto known = decoded.find({name, resolution, state});
    if (known != decoded.end())
        return known->second;
    const CIconData data = provider.Find(name, resolution, state);
    if (!data)
        return nullptr;
    // One that cannot be decoded is kept as null, so as not to be tried at every draw.
    Platform::raster pixels = CPNGDecoder(CResourceDataProvider::largestSide).Decode(data.png);
    auto picture = pixels.empty() ? nullptr : std::make_shared<const Platform::raster>(std::move(pixels));
    return decoded.emplace(std::tuple(name, resolution, state), std::move(picture)).first->second;
}

CIcon ResourceConversionThunk::Find(std::string_view name, double scale, std::uint32_t state)
{
    const std::string key(name);
    const candidate inOrder[] = {scale > 1 ? high : low, scale > 1 ? low : high};
    for (const std::uint32_t wanted : {state, std::uint32_t{0}})
        for (const candidate &one : inOrder)
            if (auto picture = Picture(key, one.resolution, wanted))
                return {std::move(picture), one.scale};
    return {};
}

ResourceConversionThunk::screenPicture ResourceConversionThunk::OnScreen(std::string_view name, double scale)
{
    scale = std::clamp(scale, 0.5, 8.0);
    const auto known = scaled.find(name);
    if (known != scaled.end() && known->second.scale == scale)
        return known->second.picture;

    const CIcon icon = Find(name, scale, 0);
    if (!icon)
        return {};
    const CIconData data = provider.Find(name, icon.scale == high.scale ? high.resolution : low.resolution, 0);
    const double factor = scale / icon.scale;
    screenPicture made{icon.pixels, data.hotX, data.hotY};
    if (factor != 1)
    {
        const auto size = [factor](int side) { return std::max(1, static_cast<int>(std::lround(side * factor))); };
        auto pixels = std::make_shared<Platform::raster>(size(data.width), size(data.height));
        Platform::canvas(*pixels).drawImage(
            *icon.pixels, icon.pixels->bounds(),
            {0, 0, static_cast<double>(pixels->width()), static_cast<double>(pixels->height())});
        made.hotX = std::min(static_cast<int>((data.hotX + 0.5) * factor), pixels->width() - 1);
        made.hotY = std::min(static_cast<int>((data.hotY + 0.5) * factor), pixels->height() - 1);
        made.pixels = std::move(pixels);
    }
    return scaled.insert_or_assign(std::string(name), scaledPicture{scale, made}).first->second.picture;
}

} // namespace Sarnik
