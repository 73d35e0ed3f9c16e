#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace Project
{

/// Reads planes as people write them, "1,3": decimal numbers from 1, parted by commas. They are stored from 0. Blanks
/// before a number and anything behind its digits do not count. False when an element has no number; channels is then
/// as it was.
bool ParseChannels(const std::string &text, std::vector<std::uint32_t> &channels);

/// The text that ParseChannels reads back.
std::string ChannelsText(const std::vector<std::uint32_t> &channels);

} // namespace Project
