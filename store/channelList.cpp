#include "store/channelList.h"

#include "store/scanNumber.h"

#include <algorithm>
#include <utility>

namespace Project
{

bool ParseChannels(const std::string &text, std::vector<std::uint32_t> &channels)
{
    std::vector<std::uint32_t> found;
    for (std::size_t begin = 0; begin <= text.size();)
    {
        const std::size_t end = std::min(text.find(',', begin), text.size());
        const auto number = ScanNumber(text.substr(begin, end - begin));
        if (!number)
            return false;
        found.push_back(static_cast<std::uint32_t>(*number) - 1); // 0 becomes a plane that no picture has
        begin = end + 1;
    }
    channels = std::move(found);
    return true;
}

std::string ChannelsText(const std::vector<std::uint32_t> &channels)
{
    std::string text;
    for (const std::uint32_t channel : channels)
        text += (text.empty() ? "" : ",") + std::to_string(static_cast<std::int32_t>(channel + 1));
    return text;
}

} // namespace Project
