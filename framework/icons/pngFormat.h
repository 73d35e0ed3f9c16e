#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>

namespace Sarnik
{

/// PNG, as far as its first bytes tell.
class CPNGFormat
{
public:
    struct size
    {
        std::uint32_t width, height;

        friend bool operator==(const size &, const size &) = default;
    };

    /// Whether a PNG's signature comes first.
    static bool Recognises(std::span<const std::byte> bytes);
    /// In pixels, as the header says it; none where the bytes do not begin as a PNG does.
    static std::optional<size> Size(std::span<const std::byte> bytes);
};

} // namespace Sarnik
