#include "framework/base/container.h"

#include "framework/base/exceptions.h"
#include "platform/utf8.h"

#include <algorithm>
#include <bit>

namespace Sarnik
{
namespace
{

constexpr std::size_t growth = 4096;

[[noreturn]] void throwEndOfData()
{
    throw CError("$$$/Sarnik/Container/Error/EndOfData=The end of data was reached while reading from a container.");
}

/// Whole numbers of N bytes, least significant first unless swapped.
template <std::size_t N> std::uint32_t numberOf(const std::byte (&bytes)[N], bool swapped)
{
    std::uint32_t value = 0;
    for (std::size_t i = 0; i < N; ++i)
        value |= std::to_integer<std::uint32_t>(bytes[swapped ? N - 1 - i : i]) << (8 * i);
    return value;
}

template <std::size_t N> void bytesOf(std::uint32_t value, bool swapped, std::byte (&bytes)[N])
{
    for (std::size_t i = 0; i < N; ++i)
        bytes[swapped ? N - 1 - i : i] = static_cast<std::byte>(value >> (8 * i));
}

} // namespace

std::uint16_t CContainer::ReadU16()
{
    std::byte bytes[2];
    ReadBytes(bytes);
    return static_cast<std::uint16_t>(numberOf(bytes, swapBytes));
}

std::uint32_t CContainer::ReadU32()
{
    std::byte bytes[4];
    ReadBytes(bytes);
    return numberOf(bytes, swapBytes);
}

float CContainer::ReadF32()
{
    return std::bit_cast<float>(ReadU32());
}

bool CContainer::ReadBool()
{
    std::byte value[1];
    ReadBytes(value);
    return value[0] != std::byte{0};
}

std::string CContainer::ReadString()
{
    const std::size_t start = Position();
    const std::uint32_t length = ReadU32();
    if (length == 0)
        return {};
    try
    {
        ReadU32();
        if (length > Remaining())
            throwEndOfData();
    }
    catch (...)
    {
        Seek(start);
        throw;
    }
    std::string text(length, '\0');
    ReadBytes(std::as_writable_bytes(std::span(text)));
    return text;
}

void CContainer::WriteU16(std::uint16_t value)
{
    std::byte bytes[2];
    bytesOf(value, swapBytes, bytes);
    WriteBytes(bytes);
}

void CContainer::WriteU32(std::uint32_t value)
{
    std::byte bytes[4];
    bytesOf(value, swapBytes, bytes);
    WriteBytes(bytes);
}

void CContainer::WriteF32(float value)
{
    WriteU32(std::bit_cast<std::uint32_t>(value));
}

void CContainer::WriteBool(bool value)
{
    const std::byte bytes[1] = {value ? std::byte{1} : std::byte{0}};
    WriteBytes(bytes);
}

void CContainer::WriteString(const std::string &text)
{
    WriteU32(static_cast<std::uint32_t>(text.size()));
    if (text.empty())
        return;
    WriteU32(static_cast<std::uint32_t>(Platform::characterCount(text)));
    WriteBytes(std::as_bytes(std::span(text)));
}

void CMemoryContainer::Seek(std::size_t to)
{
    if (to > bytes.size())
        throwEndOfData();
    position = to;
}

void CMemoryContainer::ReadBytes(std::span<std::byte> out)
{
    if (out.size() > Remaining())
        throwEndOfData();
    std::copy_n(bytes.begin() + static_cast<std::ptrdiff_t>(position), out.size(), out.begin());
    position += out.size();
}

void CMemoryContainer::WriteBytes(std::span<const std::byte> in)
{
    const std::size_t end = position + in.size();
    if (end > bytes.capacity()) // by half at least: a large kernel is written number by number
        bytes.reserve((std::max(end, bytes.capacity() / 2 * 3) + growth - 1) / growth * growth);
    if (end > bytes.size())
        bytes.resize(end);
    std::copy(in.begin(), in.end(), bytes.begin() + static_cast<std::ptrdiff_t>(position));
    position = end;
}

} // namespace Sarnik
