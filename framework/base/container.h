#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>
#include <vector>

namespace Sarnik
{

/// A seekable stream of bytes with typed reads and writes. Numbers are little-endian and unaligned, or big-endian while
/// SwapBytes is on. A read past the end throws CError and leaves the position where it was; nothing is ever sized by a
/// number that was read before the bytes that it promises are known to be there.
class CContainer
{
public:
    virtual ~CContainer() = default;

    virtual std::size_t Size() const = 0;
    virtual std::size_t Position() const = 0;
    /// Throws CError beyond the end.
    virtual void Seek(std::size_t position) = 0;
    virtual void ReadBytes(std::span<std::byte> out) = 0;
    /// Overwrites from the position on, and grows past the end.
    virtual void WriteBytes(std::span<const std::byte> bytes) = 0;

    std::size_t Remaining() const { return Size() - Position(); }
    void SetSwapBytes(bool on) { swapBytes = on; }
    bool SwapBytes() const { return swapBytes; }

    std::uint16_t ReadU16();
    std::uint32_t ReadU32();
    std::int32_t ReadI32() { return static_cast<std::int32_t>(ReadU32()); }
    /// Through the bits of a u32.
    float ReadF32();
    /// One byte; anything but 0 is true.
    bool ReadBool();
    /// Byte length (u32); unless that is 0, number of characters (u32) and the bytes, UTF-8. The number of characters
    /// is not looked at.
    std::string ReadString();

    void WriteU16(std::uint16_t value);
    void WriteU32(std::uint32_t value);
    void WriteI32(std::int32_t value) { WriteU32(static_cast<std::uint32_t>(value)); }
    void WriteF32(float value);
    void WriteBool(bool value);
    void WriteString(const std::string &text);

private:
    bool swapBytes = false;
};

/// A container in memory that grows in whole blocks of 4096 bytes.
class CMemoryContainer final : public CContainer
{
public:
    CMemoryContainer() = default;
    explicit CMemoryContainer(std::span<const std::byte> content) : bytes(content.begin(), content.end()) {}

    std::size_t Size() const override { return bytes.size(); }
    std::size_t Position() const override { return position; }
    void Seek(std::size_t to) override;
    void ReadBytes(std::span<std::byte> out) override;
    void WriteBytes(std::span<const std::byte> in) override;

    std::span<const std::byte> Content() const { return bytes; }

private:
    std::vector<std::byte> bytes;
    std::size_t position = 0;
};

} // namespace Sarnik
