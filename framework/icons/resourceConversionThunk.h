#pragma once

#include "framework/controls/iconSource.h"
#include "framework/icons/resourceDataProvider.h"

#include <map>
#include <memory>
#include <string>
#include <tuple>

namespace Sarnik
{

/// A provider's pictures, decoded and kept, for those who draw. The provider outlives it. Interface thread.
class ResourceConversionThunk final : public CIconSource
{
public:
    explicit ResourceConversionThunk(const ResourceDataProvider &pictures) : provider(pictures) {}

    /// The low resolution for scales up to 1, the high one above; the other one where that is missing.
    CIcon Find(std::string_view name, double scale, std::uint32_t state) override;

    /// A picture of exactly the size that an icon has on a screen, for what the screen does not scale.
    struct screenPicture
    {
        std::shared_ptr<const Platform::raster> pixels; ///< null where there is no such icon
        int hotX = 0, hotY = 0;
    };
    /// `scale` pixels a view unit, taken to lie within 0.5 and 8. The same object for the same name and scale, as long
    /// as no other scale of that name was asked for.
    screenPicture OnScreen(std::string_view name, double scale);

private:
    struct scaledPicture
    {
        double scale = 0;
        screenPicture picture;
    };

    std::shared_ptr<const Platform::raster> Picture(const std::string &name, EIconResolution resolution,
                                                    std::uint32_t state);

    const ResourceDataProvider &provider;
    std::map<std::tuple<std::string, EIconResolution, std::uint32_t>, std::shared_ptr<const Platform::raster>> decoded;
    std::map<std::string, scaledPicture, std::less<>> scaled;
};

} // namespace Sarnik
