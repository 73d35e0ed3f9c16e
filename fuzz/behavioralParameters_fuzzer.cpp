#include "fuzz/fuzzing.h"
#include "store/behavioralParameters.h"
#include "store/channelList.h"

#include <sstream>

using namespace Fuzzing;

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t *data, std::size_t size)
{
    std::istringstream lines(std::string(reinterpret_cast<const char *>(data), size));
    Project::PParams parameters;
    ReadBehavioralParameters(lines, parameters);
    require(parameters.pyramidSmooth <= 2);
    require(parameters.deconvChannels.size() <= 10); // no more fit into a line
    std::vector<std::uint32_t> channels;
    if (!parameters.deconvChannels.empty())
        require(Project::ParseChannels(Project::ChannelsText(parameters.deconvChannels), channels) &&
                channels == parameters.deconvChannels);
    return 0;
}
