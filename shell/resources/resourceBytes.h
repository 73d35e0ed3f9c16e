#pragma once

#include "shell/tintorel.h"

#include <cstdint>
#include <string_view>
#include <vector>

namespace Project
{

/// Bytes of a resource that hosts read: words low byte first, codes with their first character last, texts of ASCII.
/// All of it works at compile time.
class resourceBytes
{
public:
    constexpr void byte(std::uint8_t value) { bytes.push_back(value); }
    constexpr void u16(std::uint16_t value)
    {
        byte(static_cast<std::uint8_t>(value & 0xFF));
        byte(static_cast<std::uint8_t>(value >> 8));
    }
    constexpr void u32(std::uint32_t value)
    {
        u16(static_cast<std::uint16_t>(value & 0xFFFF));
        u16(static_cast<std::uint16_t>(value >> 16));
    }
    /// Four characters.
    constexpr void code(std::string_view four) { u32(TN_CODE(four[0], four[1], four[2], four[3])); }
    constexpr void text(std::string_view characters)
    {
        for (const char c : characters)
            byte(static_cast<std::uint8_t>(c));
    }
    /// A byte of length, at most 255, and the characters.
    constexpr void pascal(std::string_view characters)
    {
        byte(static_cast<std::uint8_t>(characters.size()));
        text(characters);
    }
    constexpr void append(const resourceBytes &other)
    {
        bytes.insert(bytes.end(), other.bytes.begin(), other.bytes.end());
    }
    /// Zeros up to a multiple of four.
    constexpr void pad()
    {
        while (bytes.size() % 4 != 0)
            byte(0);
    }

    std::vector<std::uint8_t> bytes;
};

} // namespace Project
