#include "framework/icons/pngFormat.h"

#include <cstring>

namespace Sarnik
{
namespace
{

constexpr unsigned char signature[] = {0x89, 'P', 'N', 'G', '\r', '\n', 0x1a, '\n'};
/// The first chunk: its length, 13, and its name.
constexpr unsigned char headerChunk[] = {0, 0, 0, 13, 'I', 'H', 'D', 'R'};

std::uint32_t bigEndian(std::span<const std::byte> bytes)
{
    std::uint32_t number = 0;
    for (const std::byte b : bytes.first(4))
        number = number << 8 | std::to_integer<std::uint32_t>(b);
    return number;
}

} // namespace

bool CPNGFormat::Recognises(std::span<const std::byte> bytes)
{
    return bytes.size() >= sizeof signature && std::memcmp(bytes.data(), signature, sizeof signature) == 0;
}

std::optional<CPNGFormat::size> CPNGFormat::Size(std::span<const std::byte> bytes)
{
    if (!Recognises(bytes))
        return {};
    bytes = bytes.subspan(sizeof signature);
    if (bytes.size() < sizeof headerChunk + 8 || std::memcmp(bytes.data(), headerChunk, sizeof headerChunk) != 0)
        return {};
    bytes = bytes.subspan(sizeof headerChunk);
    return size{bigEndian(bytes), bigEndian(bytes.subspan(4))};
}

} // namespace Sarnik
