#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace Stillmark
{

/// Writes a grey PNG of 8 or 16 bits, atomically, from width * height samples. Throws Platform::fileError.
void writeGreyPng(const std::string &path, int width, int height, const std::vector<std::uint8_t> &samples);
void writeGreyPng(const std::string &path, int width, int height, const std::vector<std::uint16_t> &samples);

} // namespace Stillmark
