#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace Sarnik
{

/// The resolutions that an index has columns for. Pictures exist in the first two: high is twice low.
enum EIconResolution : std::uint32_t
{
    kIconResolution_Low = 0,
    kIconResolution_High = 1,
    kIconResolution_XLow = 2,
    kIconResolution_XHigh = 3
};

/// Where an icon's pictures lie and how large they are: a record of the index (docs/files/icons.md).
struct CIconRecord
{
    static constexpr std::size_t resolutions = 4;
    static constexpr std::size_t states = 8;
    static constexpr std::size_t nameBytes = 48; ///< the last of them a 0
    static constexpr std::size_t bytes = 368;

    using perResolution = std::array<std::uint32_t, resolutions>;
    using perState = std::array<std::uint32_t, states>;

    perResolution width{}, height{}, hotX{}, hotY{};      ///< pixels
    std::array<perState, resolutions> offset{}, length{}; ///< bytes of a store; length 0: no picture

    friend bool operator==(const CIconRecord &, const CIconRecord &) = default;
};

using CIconMap = std::map<std::string, CIconRecord, std::less<>>;

/// What an index begins with.
inline constexpr std::size_t iconHeaderBytes = 546;
/// What a store begins with.
inline constexpr std::string_view iconStoreHeader = "fdra";
/// In the order of the resolutions.
inline constexpr std::string_view iconStoreNames[] = {"IconsLowRes.dat", "IconsHighRes.dat", "IconsXLowRes.dat",
                                                      "IconsXHighRes.dat"};

/// The records of an index by their names. None where the header is another one, the length is not that of whole
/// records, or a name is empty, not ended, not padded with zeros or there twice. What the records say of their stores
/// is not looked at.
std::optional<CIconMap> readIconIndex(std::span<const std::byte> index);
/// The names are from 1 to 47 bytes long, without zeros.
std::vector<std::byte> writeIconIndex(const CIconMap &icons);

} // namespace Sarnik
