#include "cli/commands.h"
#include "cli/jsonWriter.h"
#include "cli/photoAnalysis.h"
#include "platform/error.h"

namespace Stillmark
{
namespace
{

constexpr auto noise = CorvaneDeblur::noiseMode::automatic;

std::vector<rectangle> findRegions(const suggestOptions &options, const photo &picture, runContext &context)
{
    if (options.near && (options.near->first >= picture.width() || options.near->second >= picture.height()))
        throw Platform::fileError(picture.path() + ": the point " + std::to_string(options.near->first) + "," +
                                  std::to_string(options.near->second) + " does not lie within the picture");
    photoAnalysis analysis(picture, wholeOf(picture), context);
    const int size = options.size ? *options.size : analysis.blurSize(noise);
    return options.near ? analysis.regionNear(*options.near, size, noise)
                        : analysis.regions(options.count, size, noise).regions;
}

} // namespace

commandResult suggestRegions(const suggestOptions &options, runContext &context)
{
    const photo picture = openPhoto(options.photo, context);
    const std::vector<rectangle> regions = findRegions(options, picture, context);
    if (regions.empty())
        context.notes.push_back(picture.path() + ": no region found in which a blur could be seen well");
    else if (!options.near && static_cast<int>(regions.size()) < options.count)
        context.notes.push_back(picture.path() + ": no further region found");

    std::string text;
    std::vector<std::string> json;
    for (const rectangle &region : regions)
    {
        if (!text.empty())
            text += '\n';
        text += regionText(region);
        json.push_back(jsonRectangle(region));
    }
    return {0, text, jsonObject({{"regions", jsonArray(json)}})};
}

} // namespace Stillmark
