#pragma once

#include "framework/icons/iconIndex.h"

#include <functional>

namespace Sarnik
{

/// An icon's picture as it is stored.
struct CIconData
{
    std::span<const std::byte> png; ///< empty: there is no such picture
    int width = 0, height = 0;      ///< pixels
    int hotX = 0, hotY = 0;         ///< the pixel that points, within the picture

    explicit operator bool() const { return !png.empty(); }
};

/// Where the program's pictures come from.
class ResourceDataProvider
{
public:
    virtual ~ResourceDataProvider() = default;

    /// The stored picture, which lives as long as the provider's resources. state: 0 the normal one.
    virtual CIconData Find(std::string_view name, EIconResolution resolution, std::uint32_t state) const = 0;
    /// The name of a numbered icon.
    virtual void GetIconName(std::uint32_t id, std::string &out) const = 0;
};

/// Pictures out of an index and its stores (docs/files/icons.md). Nothing that these resources say is believed: an
/// entry that does not lie in its store or has no sensible size has no picture.
class CResourceDataProvider final : public ResourceDataProvider
{
public:
    /// What a resource is asked for by.
    static constexpr std::string_view Icons = "Icons";
    static constexpr std::string_view LowResolutionDataFile = "LowResolutionDataFile";
    static constexpr std::string_view HighResolutionDataFile = "HighResolutionDataFile";

    static constexpr std::uint32_t largestSide = 1024; ///< pixels, of any icon

    /// Without a resource.
    CResourceDataProvider() = default;
    /// `resource` answers a key with bytes that outlive the provider, or with none. A bad index leaves it without
    /// icons.
    explicit CResourceDataProvider(const std::function<std::span<const std::byte>(std::string_view key)> &resource);

    /// Takes the records of an index in place of the present ones; false, and no icons, where it is none.
    bool ParseIndex(const void *data, std::size_t size);
    std::size_t Count() const { return icons.size(); }

    CIconData Find(std::string_view name, EIconResolution resolution, std::uint32_t state) const override;
    /// "Alpha_26000", or "26000" where numbered icons have no prefix.
    void GetIconName(std::uint32_t id, std::string &out) const override;
    void SetNumberedIcons(bool on) { numberedIcons = on; }

private:
    bool numberedIcons = true; ///< whether the names of numbered icons have the prefix
    CIconMap icons;
    std::span<const std::byte> stores[CIconRecord::resolutions];
};

} // namespace Sarnik
